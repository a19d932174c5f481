// Starts from the sample targets and lets the input bytes choose edits of the
// kind a host or a hand-edited file makes: attribute values, legal-value
// lists, pin widths, the bonding maxima and which block is active. Every
// edited design stays loadable, so each run must also save and reload.

#include "FuzzCommon.h"

#include <QDir>
#include <QStringList>

#include <fuzzer/FuzzedDataProvider.h>

#include <climits>
#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace {

// The designs every input starts from, in file-name order so that a finding
// replays the same way.
std::vector<Qvz_WizData>& Bases() {
    static std::vector<Qvz_WizData> bases;
    return bases;
}

void LoadBases() {
    const QByteArray env = qgetenv("VELOMUX_FUZZ_TARGETS");
    const QDir dir(env.isEmpty() ? QString(VELOMUX_TARGETS) : QString::fromLocal8Bit(env));
    const QStringList files = dir.entryList({"*.json"}, QDir::Files, QDir::Name);
    for (const QString& f : files) {
        Qvz_WizData data;
        QString error;
        if (!Qvz_DesignJson::LoadFile(dir.filePath(f), data, error)) {
            std::fprintf(stderr, "fuzz_mutate_targets: %s\n", qPrintable(error));
            std::abort();
        }
        Bases().push_back(std::move(data));
    }
    if (Bases().empty()) {
        std::fprintf(stderr, "fuzz_mutate_targets: no design data in %s\n", qPrintable(dir.path()));
        std::abort();
    }
}

// Values that the pages' parsing and checks treat specially.
const char* const kValues[] = {"",
                               "0",
                               "1",
                               "-1",
                               "2",
                               "3",
                               "4",
                               "8",
                               "16",
                               "20",
                               "31",
                               "32",
                               "63",
                               "64",
                               "2147483647",
                               "2147483648",
                               "-2147483648",
                               "-2147483649",
                               "99999999999999999999",
                               " 7",
                               "+3",
                               "0x1F",
                               "1e3",
                               "TRUE",
                               "FALSE",
                               "NONE",
                               "A",
                               "B",
                               "DUAL",
                               "MASTER",
                               "SLAVE_1_HOP",
                               "SLAVE_2_HOPS",
                               "OFF",
                               "1_32",
                               "0_32",
                               "2_32",
                               "REFCLK1",
                               "REFCLK2",
                               "GREFCLK",
                               "BREFCLK2",
                               "STATIC",
                               "8B10B",
                               "64B66B",
                               "0101111100",
                               "1010000011",
                               "10'b0101111100",
                               "10'h17C",
                               "'b",
                               "'h",
                               "4'h",
                               "8'hZZ",
                               "00000000000",
                               "11111111111",
                               "1111",
                               "0000",
                               "0",
                               "..",
                               "1..",
                               "..1",
                               "5..1",
                               "1..5",
                               "-3..3",
                               "0..2147483647",
                               "X",
                               "_",
                               "INST",
                               "GT10_CUSTOM_INST",
                               "GT11_CUSTOM_INST",
                               "TXDATA_IN[15:0]",
                               "[",
                               "]",
                               ":",
                               "%s%n%d"};

const int kWidths[] = {1, 2, 3, 4, 7, 8, 10, 16, 20, 32, 40, 64, 65, 128, 1024, 65536};
const int kBonds[] = {0, 1, 2, 3, 4, 5, 8, 16, 20, 21, 24, 32, 1023, 1024};
constexpr int kMaxLoadableWidth = 65536;
constexpr int kMaxLoadableBond = 1024;

std::string Value(FuzzedDataProvider& in) {
    switch (in.ConsumeIntegralInRange(0, 3)) {
    case 0:
        return in.ConsumeRandomLengthString(48);
    case 1:
        return std::to_string(in.ConsumeIntegral<int>());
    case 2:
        return std::string(in.ConsumeIntegralInRange<std::size_t>(0, 300),
                           in.ConsumeBool() ? '1' : '0');
    default:
        return in.PickValueInArray(kValues);
    }
}

// A value from the attribute's own world: a legal entry, a range end or just
// past it.
std::string LegalishValue(FuzzedDataProvider& in, const Qvz_Attribute& a) {
    const Qvz_StrArray& legal = a.GetLegalValues();
    if (legal.IsEmpty())
        return Value(in);
    const Port::StringBase entry = legal.GetAt(in.ConsumeIntegralInRange(0, legal.GetSize() - 1));
    int low = 0, high = 0;
    if (!Qvz_Attribute::GetRangeValues(entry, low, high))
        return entry.str();
    const long long pick[] = {low, high, (long long)low - 1, (long long)high + 1,
                              low + (static_cast<long long>(high) - low) / 2};
    return std::to_string(in.PickValueInArray(pick));
}

// Strings read from a design-data file are valid UTF-8 without NUL; edits
// keep to that so the edited design could have been loaded.
Port::StringBase Clean(const std::string& s) {
    QString q = QString::fromUtf8(s.data(), qsizetype(s.size()));
    q.replace(QChar(0), QChar(' '));
    return Port::StringBase::FromQString(q);
}

Qvz_Block* PickBlock(FuzzedDataProvider& in, Qvz_WizData& data) {
    const auto& blocks = data.GetBlocks();
    if (blocks.empty())
        return nullptr;
    // Most edits go to the active block: it is the one the pages work on.
    if (Qvz_Block* active = data.GetActiveBlock(); active && in.ConsumeIntegralInRange(0, 3) != 0)
        return active;
    return blocks[in.ConsumeIntegralInRange<std::size_t>(0, blocks.size() - 1)].get();
}

Qvz_Attribute* PickAttribute(FuzzedDataProvider& in, Qvz_Block* block) {
    if (!block || block->GetAttributes().empty())
        return nullptr;
    const auto& attrs = block->GetAttributes();
    return attrs[in.ConsumeIntegralInRange<std::size_t>(0, attrs.size() - 1)].get();
}

Qvz_Pin* PickPin(FuzzedDataProvider& in, Qvz_Block* block) {
    if (!block || block->GetPins().empty())
        return nullptr;
    const auto& pins = block->GetPins();
    return pins[in.ConsumeIntegralInRange<std::size_t>(0, pins.size() - 1)].get();
}

int& MaxBond(Qvz_Target& t, int family) {
    return family == 0 ? t.maxBondGT : family == 1 ? t.maxBondGT10 : t.maxBondGT11;
}

void Edit(FuzzedDataProvider& in, Qvz_WizData& data) {
    Qvz_Block* block = PickBlock(in, data);
    switch (in.ConsumeIntegralInRange(0, 13)) {
    case 0:
        if (Qvz_Attribute* a = PickAttribute(in, block))
            a->SetValue(Clean(LegalishValue(in, *a)));
        break;
    case 1:
        if (Qvz_Attribute* a = PickAttribute(in, block))
            a->SetValue(Clean(Value(in)));
        break;
    case 2: // an attribute the block lacks, as an older design would carry it
        if (block)
            block->SetAttributeValue(Clean(in.ConsumeBool() ? in.PickValueInArray(kValues)
                                                            : in.ConsumeRandomLengthString(24)),
                                     Clean(Value(in)));
        break;
    case 3:
        if (Qvz_Attribute* a = PickAttribute(in, block); a && block)
            block->RemoveAttribute(Port::StringBase(a->GetName()));
        break;
    case 4:
        if (Qvz_Attribute* a = PickAttribute(in, block); a && !a->GetLegalValues().IsEmpty())
            a->GetLegalValues().RemoveAt(
                in.ConsumeIntegralInRange(0, a->GetLegalValues().GetSize() - 1));
        break;
    case 5:
        if (Qvz_Attribute* a = PickAttribute(in, block)) {
            std::string entry = Value(in);
            if (in.ConsumeBool())
                entry = std::to_string(in.ConsumeIntegral<int>()) + ".." +
                        std::to_string(in.ConsumeIntegral<int>());
            a->GetLegalValues().Add(Clean(entry));
        }
        break;
    case 6:
        if (Qvz_Attribute* a = PickAttribute(in, block))
            a->GetLegalValues().RemoveAll();
        break;
    case 7:
        if (Qvz_Attribute* a = PickAttribute(in, block)) {
            a->SetDefaultValue(Clean(LegalishValue(in, *a)));
            a->SetEditable(in.ConsumeBool());
            a->SetChanged(in.ConsumeBool());
        }
        break;
    case 8:
        if (Qvz_Pin* p = PickPin(in, block))
            p->SetWidth(in.ConsumeBool() ? in.PickValueInArray(kWidths)
                                         : in.ConsumeIntegralInRange(1, kMaxLoadableWidth));
        break;
    case 9:
        if (Qvz_Pin* p = PickPin(in, block)) {
            p->SetSupportsDataWidth(in.ConsumeBool());
            p->SetIsGrounded(in.ConsumeBool());
            p->SetIsVcc(in.ConsumeBool());
            if (in.ConsumeBool())
                p->SetSigName(Clean(in.ConsumeRandomLengthString(16)));
        }
        break;
    case 10: {
        int& bond = MaxBond(data.Target(), in.ConsumeIntegralInRange(0, 2));
        bond = in.ConsumeBool() ? in.PickValueInArray(kBonds)
                                : in.ConsumeIntegralInRange(0, kMaxLoadableBond);
        break;
    }
    case 11: {
        Qvz_Target& t = data.Target();
        switch (in.ConsumeIntegralInRange(0, 2)) {
        case 0:
            t.supportsGT = !t.supportsGT;
            break;
        case 1:
            t.supportsGT10 = !t.supportsGT10;
            break;
        default:
            t.supportsGT11 = !t.supportsGT11;
        }
        break;
    }
    case 12: // another block (or none) becomes the active one
        data.SetAllBlksIsActive(false);
        if (block && in.ConsumeIntegralInRange(0, 7) != 0)
            block->SetIsUsed(true);
        break;
    default: {
        const auto& sigs = data.GetSignals();
        if (sigs.empty())
            break;
        Qvz_Signal* s = sigs[in.ConsumeIntegralInRange<std::size_t>(0, sigs.size() - 1)].get();
        if (in.ConsumeBool())
            s->SetWidth(in.PickValueInArray(kWidths));
        else
            data.DeleteSignal(s);
    }
    }
}

} // namespace

extern "C" int LLVMFuzzerInitialize(int* argc, char*** argv) {
    VelomuxFuzz::InitApplication(argc, argv);
    LoadBases();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    FuzzedDataProvider in(bytes, size);
    const auto& bases = Bases();
    Qvz_WizData data = bases[in.ConsumeIntegralInRange<std::size_t>(0, bases.size() - 1)];
    for (int edits = 0; edits < 64 && in.remaining_bytes() > 0; ++edits)
        Edit(in, data);
    VelomuxFuzz::RunAndRoundTrip(data);
    return 0;
}
