#include "Qvz_WizData.h"

#include <algorithm>

namespace {

// Reads an optionally signed decimal integer filling [begin, end) exactly.
bool ParseWholeInt(const std::string& s, std::size_t begin, std::size_t end, int& out) {
    if (begin >= end)
        return false;
    std::size_t i = begin;
    if (s[i] == '-' || s[i] == '+')
        ++i;
    if (i >= end)
        return false;
    for (std::size_t k = i; k < end; ++k)
        if (!UT_STR::IsDigit(static_cast<unsigned char>(s[k])))
            return false;
    out = UT_STR::AToI(s.substr(begin, end - begin).c_str());
    return true;
}

template <typename T>
bool SameItems(const std::vector<std::unique_ptr<T>>& a, const std::vector<std::unique_ptr<T>>& b) {
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                      [](const auto& x, const auto& y) { return *x == *y; });
}

} // namespace

// ---------------------------------------------------------------- name/value

const Qvz_NameValue* Qvz_NameValueList::Find(const StringBase& name) const {
    for (const auto& nv : m_items)
        if (nv.name == name)
            return &nv;
    return nullptr;
}

StringBase Qvz_NameValueList::GetValue(const StringBase& name) const {
    const Qvz_NameValue* nv = Find(name);
    return nv ? nv->value : StringBase();
}

void Qvz_NameValueList::Set(const StringBase& name, const StringBase& value) {
    for (auto& nv : m_items)
        if (nv.name == name) {
            nv.value = value;
            return;
        }
    m_items.push_back({name, value});
}

void Qvz_NameValueList::Remove(const StringBase& name) {
    m_items.erase(std::remove_if(m_items.begin(), m_items.end(),
                                 [&](const Qvz_NameValue& nv) { return nv.name == name; }),
                  m_items.end());
}

// ---------------------------------------------------------------- attribute

bool Qvz_Attribute::IsValueRange(const StringBase& text) {
    int low = 0, high = 0;
    return GetRangeValues(text, low, high);
}

bool Qvz_Attribute::GetRangeValues(const StringBase& text, int& low, int& high) {
    const std::string& s = text.str();
    const std::size_t dots = s.find("..");
    if (dots == std::string::npos)
        return false;
    int lo = 0, hi = 0;
    if (!ParseWholeInt(s, 0, dots, lo) || !ParseWholeInt(s, dots + 2, s.size(), hi))
        return false;
    low = lo;
    high = hi;
    return true;
}

bool operator==(const Qvz_Attribute& a, const Qvz_Attribute& b) {
    return a.GetName() == b.GetName() && a.m_value == b.m_value && a.m_default == b.m_default &&
           a.m_editable == b.m_editable && a.m_changed == b.m_changed && a.m_legal == b.m_legal;
}

// ---------------------------------------------------------------- pin

void Qvz_Pin::ClearAllConnections() {
    m_signal = StringBase();
    m_grounded = false;
    m_vcc = false;
    RemoveAllPinSigBitProps();
}

void Qvz_Pin::SetPinSigBitProp(const StringBase& signal, int pinHigh, int pinLow, int sigHigh,
                               int sigLow) {
    StringBase name, value;
    name.Format("%s%d_%d", kBitMapPrefix, pinHigh, pinLow);
    value.Format("%s[%d:%d]", signal.c_str(), sigHigh, sigLow);
    m_attrs.Set(name, value);
}

bool Qvz_Pin::IsBitMapName(const StringBase& attrName) {
    return attrName.GetIndexOfString(kBitMapPrefix, Port::CompareSearch) == 0;
}

bool Qvz_Pin::HasPinSigBitProp() const {
    return std::any_of(m_attrs.Items().begin(), m_attrs.Items().end(),
                       [](const Qvz_NameValue& nv) { return IsBitMapName(nv.name); });
}

void Qvz_Pin::RemoveAllPinSigBitProps() {
    auto& items = m_attrs.Items();
    items.erase(std::remove_if(items.begin(), items.end(),
                               [](const Qvz_NameValue& nv) { return IsBitMapName(nv.name); }),
                items.end());
}

void Qvz_Pin::AddFlag(const StringBase& flag) {
    if (!m_flags.Contains(flag))
        m_flags.Add(flag);
}

bool operator==(const Qvz_Pin& a, const Qvz_Pin& b) {
    return a.GetName() == b.GetName() && a.m_direction == b.m_direction &&
           a.m_signal == b.m_signal && a.m_width == b.m_width && a.m_dataWidth == b.m_dataWidth &&
           a.m_used == b.m_used && a.m_grounded == b.m_grounded && a.m_vcc == b.m_vcc &&
           a.m_flags == b.m_flags && a.m_attrs == b.m_attrs;
}

// ---------------------------------------------------------------- signal

bool operator==(const Qvz_Signal& a, const Qvz_Signal& b) {
    return a.GetName() == b.GetName() && a.m_width == b.m_width && a.m_bus == b.m_bus &&
           a.m_external == b.m_external && a.m_direction == b.m_direction &&
           a.m_const0 == b.m_const0 && a.m_const1 == b.m_const1 && a.m_used == b.m_used &&
           a.m_attrs == b.m_attrs;
}

// ---------------------------------------------------------------- block

Qvz_Family Qvz_FamilyOfPrimitive(const StringBase& primitive) {
    if (primitive.GetIndexOfString("GT11_", Port::CompareSearch) == 0)
        return Qvz_Family::GT11;
    if (primitive.GetIndexOfString("GT10_", Port::CompareSearch) == 0)
        return Qvz_Family::GT10;
    if (primitive.GetIndexOfString("GT_", Port::CompareSearch) == 0)
        return Qvz_Family::GT;
    return Qvz_Family::Unknown;
}

const char* Qvz_FamilyName(Qvz_Family f) {
    switch (f) {
    case Qvz_Family::GT:
        return "GT";
    case Qvz_Family::GT10:
        return "GT10";
    case Qvz_Family::GT11:
        return "GT11";
    case Qvz_Family::Unknown:
        break;
    }
    return "";
}

Qvz_Block::Qvz_Block(const StringBase& name, const StringBase& primitive, Qvz_Family family)
    : Qvz_Named(name), m_primitive(primitive), m_family(family) {}

Qvz_Attribute* Qvz_Block::GetNamedAttribute(const StringBase& name) const {
    return m_attrs.Find(name);
}

StringBase Qvz_Block::GetAttributeValue(const StringBase& name) const {
    const Qvz_Attribute* a = GetNamedAttribute(name);
    return a ? a->GetValue() : StringBase();
}

void Qvz_Block::SetAttributeValue(const StringBase& name, const StringBase& value) {
    AddAttribute(name, value);
}

Qvz_Attribute* Qvz_Block::AddAttribute(const StringBase& name, const StringBase& value) {
    if (Qvz_Attribute* a = GetNamedAttribute(name)) {
        a->SetValue(value);
        return a;
    }
    return m_attrs.Append(std::make_unique<Qvz_Attribute>(name, value));
}

void Qvz_Block::RemoveAttribute(const StringBase& name) {
    DeleteAttribute(GetNamedAttribute(name));
}

void Qvz_Block::DeleteAttribute(Qvz_Attribute* attr) {
    m_attrs.Erase(attr);
}

bool Qvz_Block::HasAttrWPrefix(const StringBase& prefix) const {
    return std::any_of(m_attrs.All().begin(), m_attrs.All().end(), [&](const auto& a) {
        return a->GetName().GetIndexOfString(prefix, Port::CompareSearch) == 0;
    });
}

Qvz_Pin* Qvz_Block::GetNamedPin(const StringBase& name) const {
    return m_pins.Find(name);
}

Qvz_Pin* Qvz_Block::AddPin(const StringBase& name, const StringBase& direction) {
    if (Qvz_Pin* p = GetNamedPin(name))
        return p;
    return m_pins.Append(std::make_unique<Qvz_Pin>(name, direction));
}

void Qvz_Block::DeletePin(Qvz_Pin* pin) {
    m_pins.Erase(pin);
}

void Qvz_Block::ClearAllPinSignals() {
    for (const auto& p : m_pins.All()) {
        p->SetSigName(StringBase());
        p->RemoveAllPinSigBitProps();
    }
}

void Qvz_Block::CopyContentsFrom(const Qvz_Block& other) {
    if (&other == this)
        return;
    m_attrs = other.m_attrs;
    m_pins = other.m_pins;
}

bool operator==(const Qvz_Block& a, const Qvz_Block& b) {
    return a.GetName() == b.GetName() && a.m_primitive == b.m_primitive &&
           a.m_family == b.m_family && a.m_used == b.m_used &&
           SameItems(a.m_attrs.All(), b.m_attrs.All()) && SameItems(a.m_pins.All(), b.m_pins.All());
}

// ---------------------------------------------------------------- design data

bool operator==(const Qvz_Target& a, const Qvz_Target& b) {
    return a.supportsGT == b.supportsGT && a.supportsGT10 == b.supportsGT10 &&
           a.supportsGT11 == b.supportsGT11 && a.maxBondGT == b.maxBondGT &&
           a.maxBondGT10 == b.maxBondGT10 && a.maxBondGT11 == b.maxBondGT11 &&
           a.fileName == b.fileName;
}

Qvz_Block* Qvz_WizData::AddBlock(std::unique_ptr<Qvz_Block> block) {
    if (!block || GetNamedBlock(block->GetName()))
        return nullptr;
    return m_blocks.Append(std::move(block));
}

Qvz_Block* Qvz_WizData::AppendNewBlock(std::unique_ptr<Qvz_Block> block) {
    return m_blocks.Append(std::move(block));
}

Qvz_Block* Qvz_WizData::GetActiveBlock() const {
    for (const auto& b : m_blocks.All())
        if (b->IsUsed())
            return b.get();
    return nullptr;
}

Qvz_Block* Qvz_WizData::GetNamedBlock(const StringBase& name) const {
    return m_blocks.Find(name);
}

Qvz_Block* Qvz_WizData::GetPrimitiveBlock(const StringBase& primitive) const {
    for (const auto& b : m_blocks.All())
        if (b->GetPrimitiveName() == primitive)
            return b.get();
    return nullptr;
}

Qvz_Block* Qvz_WizData::CopyBlock(const Qvz_Block* block, const StringBase& name) {
    if (!block)
        return nullptr;
    if (Qvz_Block* existing = GetNamedBlock(name)) {
        existing->CopyContentsFrom(*block);
        return existing;
    }
    auto copy = std::make_unique<Qvz_Block>(*block);
    copy->SetName(name);
    return m_blocks.Append(std::move(copy));
}

void Qvz_WizData::DeleteBlock(Qvz_Block* block) {
    m_blocks.Erase(block);
}

void Qvz_WizData::SetAllBlksIsActive(bool b) {
    for (const auto& blk : m_blocks.All())
        blk->SetIsUsed(b);
}

Qvz_Signal* Qvz_WizData::GetNamedSignal(const StringBase& name) const {
    return m_signals.Find(name);
}

Qvz_Signal* Qvz_WizData::AddSignal(const StringBase& name, bool external,
                                   const StringBase& direction) {
    if (Qvz_Signal* s = GetNamedSignal(name)) {
        s->SetIsUsed(true);
        return s;
    }
    auto s = std::make_unique<Qvz_Signal>(name);
    s->SetIsExternal(external, direction);
    s->SetIsUsed(true);
    return m_signals.Append(std::move(s));
}

Qvz_Signal* Qvz_WizData::AddSignal(const Qvz_Signal& signal) {
    if (Qvz_Signal* s = GetNamedSignal(signal.GetName())) {
        s->SetIsUsed(true);
        return s;
    }
    return m_signals.Append(std::make_unique<Qvz_Signal>(signal));
}

Qvz_Signal* Qvz_WizData::AppendNewSignal(std::unique_ptr<Qvz_Signal> signal) {
    return m_signals.Append(std::move(signal));
}

void Qvz_WizData::DeleteSignal(Qvz_Signal* signal) {
    m_signals.Erase(signal);
}

void Qvz_WizData::SetAllSigsIsActive(bool b) {
    for (const auto& s : m_signals.All())
        s->SetIsUsed(b);
}

bool operator==(const Qvz_WizData& a, const Qvz_WizData& b) {
    return a.m_target == b.m_target && SameItems(a.m_blocks.All(), b.m_blocks.All()) &&
           SameItems(a.m_signals.All(), b.m_signals.All());
}
