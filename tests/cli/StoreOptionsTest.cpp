#include "tests/cli/ParsedOptions.h"

namespace pallax {
namespace {

std::string refusal(std::vector<std::string> arguments) {
    const ParseEnd end = ended(std::move(arguments));
    EXPECT_EQ(end.status, kExitWrongUsage);
    return end.text;
}

TEST(StoreOptions, LoadTakesRecordings) {
    const auto usual = parsed<StoreLoadOptions>({"store", "load", "a.pcap", "b.pcap"});
    EXPECT_EQ(usual.recordings, (std::vector<std::string>{"a.pcap", "b.pcap"}));
    EXPECT_EQ(usual.loading.store, "");
    EXPECT_EQ(usual.loading.device, std::nullopt);
    EXPECT_EQ(usual.loading.resolution, Resolution::Tick);
    EXPECT_EQ(usual.loading.keyFile, "");
    EXPECT_EQ(usual.jobs, std::nullopt);
    const auto told =
        parsed<StoreLoadOptions>({"store", "load", "--into", "fleet.db", "--device", "car1",
                                  "--every", "packet", "--pseudonyms", "key", "--jobs", "3", "a"});
    EXPECT_EQ(told.loading.store, "fleet.db");
    EXPECT_EQ(told.loading.device, "car1");
    EXPECT_EQ(told.loading.resolution, Resolution::Packet);
    EXPECT_EQ(told.loading.keyFile, "key");
    EXPECT_EQ(told.jobs, 3U);
}

TEST(StoreOptions, QueryTakesAQuestion) {
    const auto series = parsed<StoreAskOptions>({"store", "query", "series", "rsrp", "--device",
                                                 "car1", "--every", "6h", "--entry", "PCI 1",
                                                 "--store", "fleet.db", "--format", "csv"});
    EXPECT_EQ(series.question, StoreQuestion::Series);
    EXPECT_EQ(series.words, std::vector<std::string>{"rsrp"});
    EXPECT_EQ(series.device, "car1");
    EXPECT_EQ(series.every, std::chrono::hours(6));
    EXPECT_EQ(series.entry, "PCI 1");
    EXPECT_EQ(series.store, "fleet.db");
    EXPECT_EQ(series.format, RowFormat::Csv);
    const auto cells = parsed<StoreAskOptions>(
        {"store", "query", "cells", "--below", "-110", "--level", "rsrp", "--profile", "field"});
    EXPECT_EQ(cells.question, StoreQuestion::Cells);
    EXPECT_EQ(cells.below, -110.0);
    EXPECT_EQ(cells.levels, "rsrp");
    EXPECT_EQ(cells.profile, "field");
    EXPECT_EQ(parsed<StoreAskOptions>({"store", "query", "compare", "a", "b"}).words,
              (std::vector<std::string>{"a", "b"}));
    const auto section = parsed<StoreAskOptions>(
        {"store", "query", "section", "lte.x", "--entry", "PCI 1", "--from", "start"});
    EXPECT_EQ(section.question, StoreQuestion::Section);
    EXPECT_EQ(section.words, std::vector<std::string>{"lte.x"});
    EXPECT_EQ(parsed<StoreAskOptions>({"store", "query", "devices"}).question,
              StoreQuestion::Devices);
    EXPECT_EQ(parsed<StoreAskOptions>({"store", "query", "recordings"}).question,
              StoreQuestion::Recordings);
    EXPECT_EQ(parsed<StoreAskOptions>({"store", "query", "coverage"}).question,
              StoreQuestion::Coverage);
    const auto sql = parsed<StoreAskOptions>({"store", "query", "--sql", "select 1"});
    EXPECT_EQ(sql.question, StoreQuestion::Sql);
    EXPECT_EQ(sql.words, std::vector<std::string>{"select 1"});
}

TEST(StoreOptions, TimesLimitQuestions) {
    for (const char* question : {"cells", "coverage"}) {
        const auto limited = parsed<StoreAskOptions>(
            {"store", "query", question, "--from", "2026-11-20T14:00Z", "--to", "end"});
        EXPECT_TRUE(limited.from && limited.from->isAbsolute());
        EXPECT_TRUE(limited.to && limited.to->isEnd());
    }
    EXPECT_EQ(refusal({"store", "query", "cells", "--from", "noon"}).substr(0, 23),
              "pallax: --from: \"noon\" ");
}

TEST(StoreOptions, WhatAnActionDoesNotTakeIsRefused) {
    const auto says = [](std::vector<std::string> arguments, const std::string& expected) {
        arguments.insert(arguments.begin(), "store");
        EXPECT_EQ(refusal(std::move(arguments)),
                  "pallax: " + expected + " (see pallax store --help)\n");
    };
    says({"load", "a", "--format", "csv"}, "load takes no --format");
    says({"load", "a", "--below", "-110"}, "load takes no --below");
    says({"load", "a", "--from", "start"}, "load takes no --from");
    says({"load", "a", "--sql"}, "load takes no --sql");
    says({"load", "a", "--every", "1m"}, "load: --every takes tick or packet");
    says({"watch", "a", "--jobs", "2"}, "watch takes no --jobs");
    says({"watch", "a", "--timeout", "2"}, "watch takes no --timeout");
    says({"setup", "fleet", "--device", "car1"}, "setup takes no --device");
    says({"query", "devices", "--jobs", "2"}, "devices takes no --jobs");
    says({"query", "devices", "--to", "end"}, "devices takes no --to");
    says({"query", "recordings", "--profile", "field"}, "recordings takes no --profile");
    says({"query", "cells", "--pseudonyms", "key"}, "cells takes no --pseudonyms");
    says({"query", "cells", "--entry", "PCI 1"}, "cells takes no --entry");
    says({"query", "cells", "--every", "1m"}, "cells takes no --every");
    says({"query", "series", "rsrp", "--every", "packet"},
         "series: --every takes a time (30s, 1m, 6h, 1d)");
    says({"query", "series", "rsrp", "--level", "rsrp"}, "series takes no --level");
    says({"query", "coverage", "--below", "-110"}, "coverage takes no --below");
    says({"query", "--sql", "select 1", "--device", "car1"}, "--sql takes no --device");
}

TEST(StoreOptions, WatchTakesAFolder) {
    const auto watch = parsed<StoreWatchOptions>({"store", "watch", "--into", "s.db", "arriving"});
    EXPECT_EQ(watch.folder, "arriving");
    EXPECT_EQ(watch.loading.store, "s.db");
    EXPECT_EQ(refusal({"store", "watch"}),
              "pallax: watch takes one folder (see pallax store --help)\n");
}

TEST(StoreOptions, SetupTakesAnAddressAndClusters) {
    const auto one = parsed<StoreSetupOptions>({"store", "setup", "--into", "clickhouse://a/b"});
    EXPECT_EQ(one.store, "clickhouse://a/b");
    EXPECT_EQ(one.layout.cluster, "");
    EXPECT_EQ(one.layout.servers, "");
    const auto several = parsed<StoreSetupOptions>(
        {"store", "setup", "--into", "clickhouse://a/b", "fleet", "servers"});
    EXPECT_EQ(several.layout.cluster, "fleet");
    EXPECT_EQ(several.layout.servers, "servers");
    EXPECT_EQ(refusal({"store", "setup", "a", "b", "c"}),
              "pallax: setup takes one or two clusters (see pallax store --help)\n");
}

TEST(StoreOptions, WrongOnesAreToldInASentence) {
    EXPECT_EQ(refusal({"store", "load"}),
              "pallax: load takes recordings (see pallax store --help)\n");
    EXPECT_EQ(refusal({"store", "load", "--device", "", "a"}),
              "pallax: a device has a name (see pallax store --help)\n");
    EXPECT_EQ(
        refusal({"store", "query"}),
        "pallax: query takes a question (devices|recordings|cells|series|section|compare|coverage) "
        "or --sql (see pallax store --help)\n");
    EXPECT_EQ(
        refusal({"store", "query", "cell"}),
        "pallax: query: \"cell\" is not one of "
        "devices|recordings|cells|series|section|compare|coverage. Did you mean \"cells\"? (see "
        "pallax store --help)\n");
    EXPECT_EQ(refusal({"store", "query", "series"}),
              "pallax: series takes a field (see pallax store --help)\n");
    EXPECT_EQ(refusal({"store", "query", "section"}),
              "pallax: section takes the name of a section (see pallax store --help)\n");
    EXPECT_EQ(refusal({"store", "query", "compare", "a"}),
              "pallax: compare takes two words (see pallax store --help)\n");
    EXPECT_EQ(refusal({"store", "query", "devices", "a"}),
              "pallax: devices takes no words (see pallax store --help)\n");
    EXPECT_EQ(refusal({"store", "query", "--sql"}),
              "pallax: --sql takes one query (see pallax store --help)\n");
    EXPECT_EQ(refusal({"store", "query", "series", "rsrp", "--every", "often"}),
              "pallax: --every: \"often\" is not tick, packet or a time (30s, 1m, 6h, 1d) (see "
              "pallax store --help)\n");
}

} // namespace
} // namespace pallax
