#include "tests/cli/ParsedOptions.h"

// Options that name a telephony service.

namespace pallax {
namespace {

constexpr const char* kRule = " is no name of 1 to 32 letters, digits, \"-\", \"_\" and \".\" that "
                              "begins with neither \"-\" nor \".\" (see pallax ";

TEST(Options, AServiceCanHaveAName) {
    EXPECT_EQ(parsed<ServiceOptions>({"service", "--simulate", "lte"}).name, "");
    EXPECT_EQ(parsed<ServiceOptions>({"service", "--name", "car1", "--simulate", "lte"}).name,
              "car1");
    EXPECT_EQ(parsed<ServiceStatusOptions>({"service", "--status"}).name, "");
    EXPECT_EQ(parsed<ServiceStatusOptions>({"service", "--status", "--name", "car1"}).name, "car1");
    (void)parsed<ServiceListOptions>({"service", "--list"});
    EXPECT_EQ(ended({"service", "--name", "a/b", "--simulate", "lte"}).text,
              std::string("pallax: --name: \"a/b\"") + kRule + "service --help)\n");
    for (const std::vector<std::string>& further :
         {std::vector<std::string>{"--simulate", "lte"}, std::vector<std::string>{"--status"},
          std::vector<std::string>{"--name", "car1"}, std::vector<std::string>{"--relay", "-"}}) {
        std::vector<std::string> arguments{"service", "--list"};
        arguments.insert(arguments.end(), further.begin(), further.end());
        EXPECT_EQ(ended(arguments).status, kExitWrongUsage) << further.front();
    }
    EXPECT_EQ(
        ended({"service", "--name", "car1"}).text,
        "pallax: the service needs --play, --simulate, --relay, --modem, --status or --list (see "
        "pallax service --help)\n");
}

TEST(Options, CommandsAboutTheLiveModemCanNameItsService) {
    EXPECT_EQ(parsed<RecordOptions>({"record", "--connect", "car1", "a.pcapng"}).service, "car1");
    EXPECT_EQ(parsed<StatusOptions>({"status", "--connect", "car1"}).service, "car1");
    EXPECT_EQ(parsed<WatchOptions>({"watch", "--connect", "car1", "1"}).service, "car1");
    EXPECT_EQ(parsed<EventsOptions>({"events", "--live", "--connect", "car1"}).service, "car1");
    EXPECT_EQ(parsed<SqlOptions>({"sql", "--live", "--connect", "car1", "select 1"}).service,
              "car1");
    const auto browsed = parsed<BrowseOptions>({"--connect", "car1"});
    EXPECT_EQ(std::get<ServiceModem>(browsed.source).name, "car1");
}

TEST(Options, SeveralModemsCanBeBrowsed) {
    const auto three =
        parsed<BrowseOptions>({"--connect", "a", "--connect", "b", "--connect", "c"});
    EXPECT_EQ(std::get<ServiceModem>(three.source).name, "a");
    ASSERT_EQ(three.further.size(), 2U);
    EXPECT_EQ(three.further[0].name, "b");
    EXPECT_EQ(three.further[1].name, "c");
    EXPECT_TRUE(parsed<BrowseOptions>({"--connect", "a"}).further.empty());
    EXPECT_EQ(ended({"--connect", "a", "--connect", "a"}).text,
              "pallax: --connect: \"a\" is given twice (see pallax --help)\n");
    std::vector<std::string> arguments;
    for (const char* name : {"1", "2", "3", "4", "5", "6", "7", "8", "9"}) {
        arguments.insert(arguments.end(), {"--connect", name});
    }
    EXPECT_EQ(parsed<BrowseOptions>(arguments).further.size(), 8U);
    arguments.insert(arguments.end(), {"--connect", "10"});
    EXPECT_EQ(ended(arguments).text,
              "pallax: --connect: at most nine modems can be shown (see pallax --help)\n");
}

TEST(Options, AServiceIsNamedOnlyForTheLiveModem) {
    for (const std::vector<std::string>& arguments :
         {std::vector<std::string>{"--connect", "car1", "a.pcap"},
          std::vector<std::string>{"status", "--connect", "car1", "a.pcap"},
          std::vector<std::string>{"watch", "--connect", "car1", "1", "a.pcap"},
          std::vector<std::string>{"events", "--connect", "car1"},
          std::vector<std::string>{"sql", "--connect", "car1", "select 1"}}) {
        EXPECT_EQ(ended(arguments).status, kExitWrongUsage) << arguments.front();
    }
    EXPECT_EQ(ended({"--connect", "car1", "a.pcap"}).text,
              "pallax: RECORDING excludes --connect (see pallax --help)\n");
    EXPECT_EQ(ended({"record", "--connect", ".x", "a.pcapng"}).text,
              std::string("pallax: --connect: \".x\"") + kRule + "record --help)\n");
}

} // namespace
} // namespace pallax
