#include "Qvz_MGTWizPage.h"

#include <algorithm>

Qvz_MGTWizPage::Qvz_MGTWizPage(Qvz_WizMain* main) : Qvz_WizPage(main) {}

Qvz_MGTWizPage::~Qvz_MGTWizPage() = default;

Port::StringBase Qvz_MGTWizPage::GetSizedLiteral(const Port::StringBase& digits, int radix) {
    // Digit counts beyond the int range cannot occur in attribute text, but
    // keep the bit count from overflowing anyway.
    const long long n = static_cast<long long>(std::min<std::size_t>(digits.GetLength(), 1u << 28));
    Port::StringBase out;
    if (radix == 0)
        out.Format("%lld'b%s", n, digits.c_str());
    else
        out.Format("%lld'h%s", 4 * n, digits.c_str());
    return out;
}

Port::StringBase Qvz_MGTWizPage::StripSizedLiteral(const Port::StringBase& value, int radix) {
    const char* marker = radix == 1 ? "'h" : "'b";
    const std::size_t pos = value.GetIndexOfString(marker, Port::CompareSearch);
    if (pos == Port::StringBase::npos)
        return value;
    return value.Mid(pos + 2);
}

bool Qvz_MGTWizPage::ValidateSeqMask(const Port::StringBase& mask,
                                     const Port::StringBase& seqLength) {
    const auto zeros = std::count(mask.str().begin(), mask.str().end(), '0');
    return zeros <= static_cast<long long>(UT_STR::AToI(seqLength));
}

bool Qvz_MGTWizPage::GetGT10EncodingChoices(Qvz_Block* block, bool& allowNone, bool& allow8B10B,
                                            bool& allow64B66B) {
    allowNone = allow8B10B = allow64B66B = true;
    const Qvz_Attribute* speed = block ? block->GetNamedAttribute("PMA_SPEED") : nullptr;
    if (!speed)
        return false;
    const Port::StringBase value = speed->GetValue();
    const bool unchanged = value.Compare(speed->GetDefaultValue(), Port::CompareExact) == 0;
    const struct {
        const char* attr;
        bool& flag;
    } encodings[] = {{"QVZ_PMASPD_ENC_NONE", allowNone},
                     {"QVZ_PMASPD_ENC_8B10B", allow8B10B},
                     {"QVZ_PMASPD_ENC_64B66B", allow64B66B}};
    for (const auto& e : encodings) {
        if (const Qvz_Attribute* a = block->GetNamedAttribute(e.attr))
            e.flag = a->GetLegalValues().Contains(value);
    }
    return unchanged;
}

bool Qvz_MGTWizPage::IsTrue(const Port::StringBase& value) {
    return value.Compare("TRUE", Port::CompareExact) == 0;
}

bool Qvz_MGTWizPage::IsTrue(const Qvz_Block* block, const char* name) {
    return block && IsTrue(block->GetAttributeValue(name));
}

void Qvz_MGTWizPage::SetIfPresent(Qvz_Block* block, const char* name,
                                  const Port::StringBase& value) {
    if (Qvz_Attribute* a = block ? block->GetNamedAttribute(name) : nullptr)
        a->SetValue(value);
}

bool Qvz_MGTWizPage::IsAllDigits(const Port::StringBase& s) {
    if (s.IsEmpty())
        return false;
    for (char c : s.str())
        if (!UT_STR::IsDigit(static_cast<unsigned char>(c)))
            return false;
    return true;
}

Port::StringBase Qvz_MGTWizPage::GetBinaryValue(const Qvz_Attribute* attr) {
    if (!attr)
        return Port::StringBase();
    const Port::StringBase& value = attr->GetValue();
    const std::size_t pos = value.GetIndexOfString("'b", Port::CompareSearch);
    if (pos == Port::StringBase::npos)
        return value;
    // The size says how many trailing digits count. A size that is no number,
    // or one larger than the digits present, would take part of the size and
    // marker (or read before the text): keep the digits after the marker.
    const Port::StringBase digits = value.Mid(pos + 2);
    const Port::StringBase size = value.Left(pos);
    if (!IsAllDigits(size))
        return digits;
    const int n = UT_STR::AToI(size);
    if (static_cast<std::size_t>(n) > digits.GetLength())
        return digits;
    return TextFrom(value, value.GetLength() - static_cast<std::size_t>(n));
}

Port::StringBase Qvz_MGTWizPage::TextFrom(const Port::StringBase& value, std::size_t pos) {
    const std::string& s = value.str();
    // UTF-8 continuation bytes are 10xxxxxx.
    while (pos < s.size() && (static_cast<unsigned char>(s[pos]) & 0xC0) == 0x80)
        ++pos;
    return pos < s.size() ? Port::StringBase(s.substr(pos)) : Port::StringBase();
}

void Qvz_MGTWizPage::SetBinaryValue(Qvz_Attribute* attr, const Port::StringBase& digits,
                                    bool sized) {
    if (attr)
        attr->SetValue(sized ? GetSizedLiteral(digits, 0) : digits);
}

bool Qvz_MGTWizPage::FinishGuiCreation(bool created) {
    if (created)
        return true;
    IssueMessage("Internal error: unable to create GUI object", true, false, false);
    return false;
}
