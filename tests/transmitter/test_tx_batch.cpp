// Batch runs of the program on transmitter fixtures of each family.

#include "TxTestSupport.h"

using namespace txtest;

namespace {

const char* const kDeleted = "<deleted>";

// Every attribute of the input, with the value it must have afterwards; any
// attribute not listed in changes must come out as it went in.
void ExpectOnlyChanges(const BatchRun& r, const std::map<std::string, std::string>& changes) {
    ASSERT_EQ(r.exitCode, 0);
    const auto before = Attributes(r.input);
    const auto after = Attributes(r.output);
    for (const auto& [name, value] : before) {
        auto change = changes.find(name);
        const std::string expected = change != changes.end() ? change->second : value;
        auto it = after.find(name);
        const std::string actual = it != after.end() ? it->second : kDeleted;
        EXPECT_EQ(actual, expected) << name;
    }
    for (const auto& [name, value] : after)
        EXPECT_TRUE(before.count(name)) << "added: " << name;
}

} // namespace

TEST(TransmitterBatch, GtCustomWritesItsAttributes) {
    BatchRun r = RunBatchOn("gt_custom.json");
    // Dynamic encoding reads as static on the first family; the buffer is
    // forced on; the old encoder flag goes.
    ExpectOnlyChanges(r, {{"TX_BUFFER_USE", "TRUE"},
                          {"QVZX_ONLY_ENCODING", "STATIC"},
                          {"QVZX_ONLY_TX_8B10B_USE", kDeleted}});
    EXPECT_TRUE(r.messages.empty());
    EXPECT_TRUE(r.report["ok"].toBool());
}

TEST(TransmitterBatch, FibreChannelNeverTouchesThePacketCharacters) {
    // Empty packet characters would be written from the page's initial values
    // on any other primitive (see the GT10 run below).
    BatchRun r = RunBatchOn("gt_fibre_chan.json");
    ExpectOnlyChanges(r, {});
    EXPECT_TRUE(r.messages.empty());
}

TEST(TransmitterBatch, Gt10ReadsAndWritesCrcAndTapSettings) {
    BatchRun r = RunBatchOn("gt10_custom.json");
    // General Setup prunes the primitive's own CRC attributes on GT10 before
    // this page reads (their reading is checked on the page alone); the
    // wizard's CRC settings stay; a bare DAC gets its size. TX_PREEMPHASIS and
    // TX_DIFF_CTRL belong to the first family and stay as they are.
    ExpectOnlyChanges(r, {{"TX_CRC_USE", kDeleted},
                          {"CRC_FORMAT", kDeleted},
                          {"CRC_START_OF_PKT", kDeleted},
                          {"CRC_END_OF_PKT", kDeleted},
                          {"TX_CRC_FORCE_VALUE", kDeleted},
                          {"TXDAT_TAP_DAC", "5'b10101"}});
    EXPECT_TRUE(r.messages.empty());
}

TEST(TransmitterBatch, Gt11BypassDisablesEncodingAndSizesLiterals) {
    BatchRun r = RunBatchOn("gt11_custom.json");
    // The transmit CRC is switched off by General Setup's PCS bypass resets.
    ExpectOnlyChanges(r, {{"TX_CRC_USE", "FALSE"},
                          {"QVZX_ONLY_ENCODING", "DISABLE"},
                          {"QVZX_ONLY_TX_8B10B_USE", kDeleted},
                          {"TX_BUFFER_USE", "TRUE"},
                          {"TXCRCINITVAL", "12'hABC"},
                          {"TXPOST_TAP_DAC", "1'b1"}});
}

TEST(TransmitterBatch, EncodingResolutionTable) {
    const std::string prefix = "The previous selection ";
    auto Msg = [&](const char* from, const char* to) {
        return prefix + from +
               " is no longer a valid choice, based on the current PMA_SPEED setting.  The "
               "encoding setting has been changed to " +
               to + ".";
    };
    struct Row {
        const char* encoding;
        const char* staticValue;
        const char* speed;
        bool pmaUnchanged; // PMA_SPEED's default is set to the speed
        const char* writtenEncoding;
        const char* writtenStatic;
        std::string message; // "" none
    };
    const Row rows[] = {
        // DISABLE
        {"DISABLE", "64B66B", "SPD_NONE_ONLY", false, "DISABLE", "64B66B", ""},
        {"DISABLE", "64B66B", "SPD_8_64", false, "STATIC", "8B10B",
         Msg("to Disable Encoding", "Static 8B/10B Encoding")},
        {"DISABLE", "64B66B", "SPD_8_64", true, "STATIC", "8B10B", ""},
        {"DISABLE", "8B10B", "SPD_64_ONLY", false, "STATIC", "64B66B",
         Msg("to Disable Encoding", "Static 64B/66B Encoding")},
        {"DISABLE", "8B10B", "SPD_64_ONLY", true, "STATIC", "64B66B", ""},
        // DYNAMIC on GT10
        {"DYNAMIC", "8B10B", "SPD_8_64", false, "DYNAMIC", "8B10B", ""},
        {"DYNAMIC", "8B10B", "SPD_NONE_ONLY", false, "DISABLE", "8B10B",
         Msg("Dynamic Encoding control", "Disable Encoding")},
        {"DYNAMIC", "8B10B", "SPD_NONE_ONLY", true, "DISABLE", "8B10B", ""},
        {"DYNAMIC", "64B66B", "SPD_NONE_8", false, "STATIC", "8B10B",
         Msg("Dynamic Encoding control", "Static 8B/10B Encoding")},
        {"DYNAMIC", "64B66B", "SPD_NONE_8", true, "STATIC", "8B10B", ""},
        {"DYNAMIC", "8B10B", "SPD_64_ONLY", false, "STATIC", "64B66B",
         Msg("Dynamic Encoding control", "Static 64B/66B Encoding")},
        {"DYNAMIC", "8B10B", "SPD_64_ONLY", true, "STATIC", "64B66B", ""},
        // Static settings (any other value)
        {"STATIC", "8B10B", "SPD_NOTHING", false, "DISABLE", "8B10B",
         Msg("Static Encoding control", "Disable encoding")},
        {"STATIC", "8B10B", "SPD_NOTHING", true, "DISABLE", "8B10B", ""},
        {"STATIC", "8B10B", "SPD_64_ONLY", false, "STATIC", "64B66B",
         Msg("Static 8B/10B Encoding control", "Static 64B/66B Encoding control")},
        {"STATIC", "8B10B", "SPD_NONE_64", true, "STATIC", "64B66B",
         Msg("Static 8B/10B Encoding control", "Static 64B/66B Encoding control")},
        {"STATIC", "64B66B", "SPD_8_ONLY", false, "STATIC", "8B10B",
         Msg("Static 64B/66B Encoding control", "Static 8B/10B Encoding control")},
        {"STATIC", "64B66B", "SPD_NONE_8", true, "STATIC", "8B10B",
         Msg("Static 64B/66B Encoding control", "Static 8B/10B Encoding control")},
        {"STATIC", "64B66B", "SPD_ALL", false, "STATIC", "64B66B", ""},
        {"STATIC", "8B10B", "SPD_8_ONLY", false, "STATIC", "8B10B", ""},
        // An unknown value is a static setting too, and is written as one.
        {"SOMETHING", "64B66B", "SPD_8_64", false, "STATIC", "64B66B", ""},
    };
    for (const Row& row : rows) {
        const std::string label = std::string(row.encoding) + "/" + row.staticValue + "/" +
                                  row.speed + (row.pmaUnchanged ? " (default)" : "");
        BatchRun r = RunBatch(
            EditFixture("gt10_custom.json",
                        {{"QVZX_ONLY_ENCODING", row.encoding, nullptr},
                         {"QVZX_ONLY_ENC_STATIC", row.staticValue, nullptr},
                         {"PMA_SPEED", row.speed, row.pmaUnchanged ? row.speed : "SPD_ALL"}}));
        ASSERT_EQ(r.exitCode, 0) << label;
        const auto after = Attributes(r.output);
        EXPECT_EQ(after.at("QVZX_ONLY_ENCODING"), row.writtenEncoding) << label;
        EXPECT_EQ(after.at("QVZX_ONLY_ENC_STATIC"), row.writtenStatic) << label;
        if (row.message.empty()) {
            EXPECT_TRUE(r.messages.empty()) << label;
        } else {
            ASSERT_EQ(r.messages.size(), 1u) << label;
            EXPECT_EQ(r.messages[0], row.message) << label;
            const QJsonArray flags =
                r.report["messages"].toArray().at(0).toObject()["flags"].toArray();
            EXPECT_EQ(flags, QJsonArray({false, false, false})) << label;
        }
    }
}

TEST(TransmitterBatch, BypassOverridesEveryEncodingSetting) {
    // Whatever the encoding setting and whatever the speed allows, a bypassed
    // PCS reads as disabled encoding, silently.
    for (const char* enc : {"DYNAMIC", "STATIC", "DISABLE"}) {
        BatchRun r =
            RunBatch(EditFixture("gt10_custom.json", {{"QVZX_ONLY_ENCODING", enc, nullptr},
                                                      {"PMA_SPEED", "SPD_NOTHING", nullptr},
                                                      {"QVZX_ONLY_BYPASS_PCS", "TRUE", nullptr}}));
        ASSERT_EQ(r.exitCode, 0) << enc;
        EXPECT_EQ(Attributes(r.output).at("QVZX_ONLY_ENCODING"), "DISABLE") << enc;
        EXPECT_TRUE(r.messages.empty()) << enc;
    }
}
