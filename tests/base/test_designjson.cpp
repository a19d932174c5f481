#include "Qvz_DesignJson.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <gtest/gtest.h>

namespace {

QByteArray Doc(const QByteArray& blocks, const QByteArray& extra = "") {
    return "{\"format\": \"velomux-design-data\", \"version\": 1, " + extra +
           "\"blocks\": [" + blocks + "]}";
}

QString LoadError(const QByteArray& text) {
    Qvz_WizData d;
    QString err;
    EXPECT_FALSE(Qvz_DesignJson::Load(text, "in.json", d, err)) << text.toStdString();
    return err;
}

const QByteArray kMinimalBlock = R"({"name": "B", "primitive": "GT10_CUSTOM"})";

} // namespace

TEST(DesignJson, MissingKeysTakeTheirDefaults) {
    Qvz_WizData d;
    QString err;
    const QByteArray text = Doc(R"({"name": "B", "primitive": "GT11_CUSTOM",
        "attributes": [{"name": "A", "value": "v"}],
        "pins": [{"name": "P", "direction": "INOUT"}]})",
                                R"("signals": [{"name": "S"}], )");
    ASSERT_TRUE(Qvz_DesignJson::Load(text, "in.json", d, err)) << err.toStdString();
    const Qvz_Target& t = d.Target();
    EXPECT_FALSE(t.supportsGT || t.supportsGT10 || t.supportsGT11);
    EXPECT_EQ(t.maxBondGT10, 0);
    EXPECT_EQ(t.fileName, "");
    const Qvz_Block* b = d.GetNamedBlock("B");
    ASSERT_NE(b, nullptr);
    EXPECT_TRUE(b->SupportsMGT11());
    EXPECT_FALSE(b->IsUsed());
    const Qvz_Attribute* a = b->GetNamedAttribute("A");
    EXPECT_EQ(a->GetDefaultValue(), "v");
    EXPECT_TRUE(a->IsEditable());
    EXPECT_FALSE(a->IsChanged());
    EXPECT_TRUE(a->GetLegalValues().IsEmpty());
    const Qvz_Pin* p = b->GetNamedPin("P");
    EXPECT_EQ(p->GetDirection(), "INOUT");
    EXPECT_EQ(p->GetWidth(), 1);
    EXPECT_FALSE(p->SupportsDataWidth() || p->IsGrounded() || p->IsVcc() || p->IsUsed());
    const Qvz_Signal* s = d.GetNamedSignal("S");
    EXPECT_EQ(s->GetWidth(), 1);
    EXPECT_EQ(s->GetDirection(), "");
    EXPECT_FALSE(s->IsBus() || s->IsExternal() || s->IsConst0() || s->IsUsed());
}

TEST(DesignJson, TargetFlagsAndMaxima) {
    Qvz_WizData d;
    QString err;
    ASSERT_TRUE(Qvz_DesignJson::Load(
        Doc("", R"("target": {"families": ["GT11", "GT"], "max_bond": {"GT11": 24}, "file_name": "top"}, )"),
        "in.json", d, err))
        << err.toStdString();
    EXPECT_TRUE(d.Target().supportsGT);
    EXPECT_FALSE(d.Target().supportsGT10);
    EXPECT_TRUE(d.Target().supportsGT11);
    EXPECT_EQ(d.Target().maxBondGT11, 24);
    EXPECT_EQ(d.Target().maxBondGT, 0);
    EXPECT_EQ(d.Target().fileName, "top");
}

TEST(DesignJson, RejectsMalformedInputNamingTheFault) {
    const struct {
        QByteArray text;
        const char* mustContain;
    } cases[] = {
        {"{\"format\": \"velomux-design-data\",\n  \"version\": 1,\n  \"blocks\": [}", "in.json:3:"},
        {"[1, 2]", "expected an object"},
        {"{\"version\": 1}", "missing required key \"format\""},
        {"{\"format\": \"other\", \"version\": 1}", "$.format"},
        {"{\"format\": \"velomux-design-data\", \"version\": 2}", "$.version"},
        {Doc(kMinimalBlock, "\"extra\": 1, "), "unknown key \"extra\""},
        {Doc(R"({"name": "B", "primitive": "GT10_CUSTOM", "colour": "red"})"),
         "$.blocks[0]: unknown key \"colour\""},
        {Doc(R"({"name": "B"})"), "missing required key \"primitive\""},
        {Doc(R"({"name": "B", "primitive": "XYZ"})"), "$.blocks[0].primitive"},
        {Doc(R"({"name": "B", "primitive": "XYZ", "family": "GT12"})"), "$.blocks[0].family"},
        {Doc(kMinimalBlock + "," + kMinimalBlock), "$.blocks[1].name: duplicate block name \"B\""},
        {Doc(R"({"name": "B", "primitive": "GT10_X", "attributes": [{"name": "A", "value": "1"}, {"name": "A", "value": "2"}]})"),
         "$.blocks[0].attributes[1].name: duplicate attribute"},
        {Doc(R"({"name": "B", "primitive": "GT10_X", "attributes": [{"name": "A", "value": 1}]})"),
         "$.blocks[0].attributes[0].value: expected a string"},
        {Doc(R"({"name": "B", "primitive": "GT10_X", "attributes": [{"name": "A", "value": "1", "legal": "1"}]})"),
         "legal: expected an array"},
        {Doc(R"({"name": "B", "primitive": "GT10_X", "pins": [{"name": "P", "direction": "IN"}, {"name": "P", "direction": "OUT"}]})"),
         "$.blocks[0].pins[1].name: duplicate pin name"},
        {Doc(R"({"name": "B", "primitive": "GT10_X", "pins": [{"name": "P", "direction": "IN", "width": -1}]})"),
         "$.blocks[0].pins[0].width"},
        {Doc(R"({"name": "B", "primitive": "GT10_X", "pins": [{"name": "P", "direction": "IN", "width": 1.5}]})"),
         "width"},
        {Doc(R"({"name": "B", "primitive": "GT10_X", "pins": [{"name": "P", "direction": "IN", "width": 1e300}]})"),
         "width"},
        {Doc(R"({"name": "B", "primitive": "GT10_X", "used": "yes"})"), "used: expected true or false"},
        {Doc("", R"("signals": [{"name": "S"}, {"name": "S"}], )"), "$.signals[1].name: duplicate signal"},
        {Doc("", R"("signals": [{"name": "S", "direction": "X"}], )"), "$.signals[0].direction"},
        {Doc("", R"("target": {"families": ["GT", "GT"]}, )"), "duplicate family"},
        {Doc("", R"("target": {"families": ["gt"]}, )"), "unknown family"},
        {Doc("", R"("target": {"max_bond": {"GT": -2}}, )"), "$.target.max_bond.GT"},
        {Doc("", R"("target": {"max_bond": {"GT9": 2}}, )"), "unknown key \"GT9\""},
        {"{\"format\": \"velomux-design-data\", \"version\": 1,\n \"version\": 1}", "in.json:2:2: duplicate key \"version\""},
        {Doc(R"({"name": "B", "primitive": "GT10_X", "attributes": [{"name": "A", "value": "a\u0000b"}]})"),
         "NUL"},
        {"", "in.json:1:1"},
    };
    for (const auto& c : cases) {
        const QString err = LoadError(c.text);
        EXPECT_TRUE(err.contains(c.mustContain))
            << "error: " << err.toStdString() << "\nexpected to contain: " << c.mustContain;
        EXPECT_TRUE(err.startsWith("in.json")) << err.toStdString();
    }
}

TEST(DesignJson, FailedLoadLeavesTheTargetUntouched) {
    Qvz_WizData d;
    d.AddBlock(std::make_unique<Qvz_Block>("KEEP", "GT_CUSTOM", Qvz_Family::GT));
    QString err;
    EXPECT_FALSE(Qvz_DesignJson::Load(Doc(R"({"name": "B"})"), "x", d, err));
    ASSERT_NE(d.GetNamedBlock("KEEP"), nullptr);
}

TEST(DesignJson, LoadSaveLoadIsStableAndLossless) {
    QDir dir(VELOMUX_TARGETS);
    const auto files = dir.entryList({"*.json"});
    ASSERT_FALSE(files.isEmpty());
    for (const QString& f : files) {
        Qvz_WizData first;
        QString err;
        ASSERT_TRUE(Qvz_DesignJson::LoadFile(dir.filePath(f), first, err)) << err.toStdString();
        const QByteArray saved = Qvz_DesignJson::Save(first);
        Qvz_WizData second;
        ASSERT_TRUE(Qvz_DesignJson::Load(saved, f, second, err)) << err.toStdString();
        EXPECT_TRUE(first == second) << f.toStdString();
        EXPECT_EQ(Qvz_DesignJson::Save(second), saved) << f.toStdString();
    }
}

TEST(DesignJson, SaveKeepsOrderEscapesAndBitMaps) {
    Qvz_WizData d;
    auto b = std::make_unique<Qvz_Block>("Z_INST", "GT10_CUSTOM", Qvz_Family::GT10);
    b->AddAttribute("Z", "quote \" back \\ tab \t nl \n ctl \x01 utf8 \xc3\xa9");
    b->AddAttribute("A", "second");
    Qvz_Pin* p = b->AddPin("TXDATA", "IN");
    p->SetPinSigBitProp("TXDATA_IN", 15, 8, 17, 10);
    p->AddFlag("DATAWIDTH");
    d.AddBlock(std::move(b));
    d.AddBlock(std::make_unique<Qvz_Block>("A_INST", "GT10_CUSTOM", Qvz_Family::GT10));
    Qvz_Signal* s = d.AddSignal("S2", true, "O");
    s->SetAttributeValue("BUS_ONLY_USE_BITS", "16");
    d.AddSignal("S1", false, "");

    const QByteArray text = Qvz_DesignJson::Save(d);
    Qvz_WizData back;
    QString err;
    ASSERT_TRUE(Qvz_DesignJson::Load(text, "saved", back, err)) << err.toStdString();
    EXPECT_TRUE(back == d);
    EXPECT_EQ(back.GetBlocks()[0]->GetName(), "Z_INST");
    EXPECT_EQ(back.GetBlocks()[0]->GetAttributes()[0]->GetName(), "Z");
    EXPECT_EQ(back.GetSignals()[0]->GetName(), "S2");
    EXPECT_TRUE(text.contains("\"QVZX_ONLY_PIN_SIG_BIT_15_8\", \"value\": \"TXDATA_IN[17:10]\""));
    for (const char* key : {"\"default\"", "\"editable\"", "\"changed\"", "\"legal\"", "\"width\"",
                            "\"data_width\"", "\"grounded\"", "\"vcc\"", "\"flags\"", "\"const0\"",
                            "\"const1\"", "\"max_bond\"", "\"file_name\""})
        EXPECT_TRUE(text.contains(key)) << key;
}

TEST(DesignJson, UnreadableFilesAndDirectoriesFailClearly) {
    QTemporaryDir tmp;
    Qvz_WizData d;
    QString err;
    EXPECT_FALSE(Qvz_DesignJson::LoadFile(tmp.filePath("missing.json"), d, err));
    EXPECT_TRUE(err.contains("missing.json")) << err.toStdString();
    EXPECT_FALSE(Qvz_DesignJson::LoadFile(tmp.path(), d, err));
    EXPECT_TRUE(err.contains("directory")) << err.toStdString();
}
