#include "cli/ModemOptions.h"

#include "tests/cli/ParsedOptions.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

LocalModem modemOf(const Source& source) {
    const auto* modem = std::get_if<LocalModem>(&source);
    return modem != nullptr ? *modem : LocalModem{"none"};
}

TEST(ModemOptions, AModemIsTheFirstOneOrNamed) {
    EXPECT_EQ(modemOf(parsed<BrowseOptions>({"modem"}).source).wanted, "auto");
    EXPECT_EQ(modemOf(parsed<BrowseOptions>({"modem", "AT-9"}).source).wanted, "AT-9");
    EXPECT_FALSE(modemOf(parsed<BrowseOptions>({"modem"}).source).withIdentities);
    EXPECT_TRUE(
        modemOf(parsed<BrowseOptions>({"modem", "--with-identities"}).source).withIdentities);
    EXPECT_EQ(modemOf(parsed<ServiceOptions>({"service", "--modem"}).source).wanted, "auto");
    EXPECT_EQ(modemOf(parsed<ServiceOptions>({"service", "--modem", "1"}).source).wanted, "1");
    EXPECT_EQ(parsed<RecordOptions>({"record", "--modem", "a.pcapng"}).modem->wanted, "auto");
    EXPECT_EQ(parsed<RecordOptions>({"record", "--modem", "a.pcapng"}).files.path, "a.pcapng");
    EXPECT_EQ(parsed<RecordOptions>({"record", "--modem", "1", "a.pcapng"}).modem->wanted, "1");
    EXPECT_EQ(parsed<RecordOptions>({"record", "a.pcapng", "--modem"}).modem->wanted, "auto");
    EXPECT_FALSE(parsed<RecordOptions>({"record", "a.pcapng"}).modem);
    (void)parsed<ModemListOptions>({"modem", "--list"});
    (void)parsed<ModemPolicyOptions>({"modem", "--policy"});
}

TEST(ModemOptions, AModemHasNoOtherSource) {
    EXPECT_EQ(refusalOf({"modem", "--list", "--policy"}),
              "pallax: --list excludes --policy (see pallax modem --help)\n");
    EXPECT_EQ(refusalOf({"service", "--with-identities"}),
              "pallax: --with-identities requires --modem (see pallax service --help)\n");
    EXPECT_EQ(refusalOf({"service", "--modem", "--play", "a"}),
              "pallax: --play excludes --modem (see pallax service --help)\n");
}

} // namespace
} // namespace pallax
