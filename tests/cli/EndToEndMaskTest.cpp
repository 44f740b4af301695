#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/PropertyListRecord.h"

#include <filesystem>

namespace pallax {
namespace {

class EndToEndMask : public EndToEnd {
protected:
    std::string attachWithSim() const {
        using std::chrono::milliseconds;
        return record("sim.pcap", {{milliseconds(0), registration(1)},
                                   {milliseconds(500), simFiles("kSimFile_AD = 1;")},
                                   {milliseconds(900), doubles::Record(0xABCD).u8(1).prefixed()}});
    }
    std::string decoded(const std::string& path) const { return run({"decode", path}).out; }
};

TEST_F(EndToEndMask, WritesACopyWithoutIdentitiesAndCounts) {
    const std::string copy = world.path("shared.pcap");
    const Run mask = run({"mask", attachWithSim(), "-o", copy});
    EXPECT_EQ(mask.status, 0);
    EXPECT_EQ(mask.out, "");
    EXPECT_EQ(mask.err, "pallax: " + copy +
                            ": 3 packets, 1 value masked; 1 packet that cannot be understood "
                            "zeroed.\n");
    std::string expected = decoded(attachWithSim());
    const std::string iccid = kIccid;
    ASSERT_NE(expected.find(iccid), std::string::npos);
    expected.replace(expected.find(iccid), iccid.size(), iccid.size(), '0');
    EXPECT_EQ(decoded(copy), expected);
}

TEST_F(EndToEndMask, CheckTellsWhereIdentitiesAre) {
    const std::string file = attachWithSim();
    const Run found = run({"mask", "--check", file});
    EXPECT_EQ(found.status, 1);
    EXPECT_EQ(found.err, "");
    EXPECT_EQ(found.out, file + ": packet 2, byte 33: ICCID in text\n" + file +
                             ": packet 2, byte 33: kSimFile_ICCID\n");
    const std::string copy = world.path("shared.pcap");
    ASSERT_EQ(run({"mask", file, "-o", copy}).status, 0);
    const Run clean = run({"mask", "--check", copy});
    EXPECT_EQ(clean.status, 0);
    EXPECT_EQ(clean.out, "");
}

TEST_F(EndToEndMask, KeepsAFieldOnRequest) {
    const std::string copy = world.path("shared.pcap");
    ASSERT_EQ(run({"mask", "--keep", "ef_iccid", attachWithSim(), "-o", copy}).status, 0);
    EXPECT_EQ(decoded(copy), decoded(attachWithSim()));
}

TEST_F(EndToEndMask, WrongUsageIsOneSentence) {
    const Run nothing = run({"mask", "x.pcap"});
    EXPECT_EQ(nothing.status, 2);
    EXPECT_EQ(nothing.err, "pallax: --output or --check is required (see pallax mask --help)\n");
    const Run output = run({"mask", "x.pcap", "-o", "-"});
    EXPECT_EQ(output.status, 2);
    EXPECT_EQ(output.err, "pallax: a masked copy is a file, not standard output (see pallax mask "
                          "--help)\n");
    const Run unknown = run({"mask", "--also", "nose", attachWithSim(), "-o", "y"});
    EXPECT_EQ(unknown.status, 2);
    EXPECT_EQ(unknown.err, "pallax: No field is named \"nose\" (see pallax fields).\n");
}

} // namespace
} // namespace pallax
