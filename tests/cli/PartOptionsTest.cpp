#include "tests/cli/ParsedOptions.h"

// Options that choose a part of a recording or file.

namespace pallax {
namespace {

TEST(Options, DecodeTakesAPartOfARecording) {
    const auto part =
        parsed<DecodeOptions>({"decode", "--from", "+90s", "--to", "14:03", "--select", "lte.*",
                               "--select", "gsm.?", "--typed", "--join", "a.pcap", "b.pcap"});
    EXPECT_TRUE(part.window.from && part.window.to);
    EXPECT_EQ(part.select, (std::vector<std::string>{"lte.*", "gsm.?"}));
    EXPECT_EQ(part.recordings, (std::vector<std::string>{"a.pcap", "b.pcap"}));
    EXPECT_EQ(parsed<DecodeOptions>({"decode", "--select", "a", "b.pcap", "c.pcap"}).recordings,
              (std::vector<std::string>{"b.pcap", "c.pcap"}));
    EXPECT_TRUE(part.typed);
    EXPECT_TRUE(part.join);
    EXPECT_FALSE(part.recordingColumn);
    const auto at = parsed<DecodeOptions>(
        {"decode", "--at", "-5m", "--format", "csv", "--recording-column", "a.pcap"});
    EXPECT_EQ(at.chosenEvery(), Every::End);
    EXPECT_TRUE(at.chosenWindow().to && !at.chosenWindow().from);
    EXPECT_TRUE(at.recordingColumn);
    const auto refused = [](std::vector<std::string> arguments) {
        arguments.insert(arguments.begin(), {"decode", "a.pcap"});
        const ParseEnd end = ended(arguments);
        EXPECT_EQ(end.status, kExitWrongUsage);
        return end.text;
    };
    EXPECT_EQ(refused({"--at", "noon"}),
              "pallax: --at: \"noon\" is not a time: expected 14:03, 2023-11-14T14:03, +90s, -5m, "
              "start or end (character 1) (see pallax decode --help)\n");
    EXPECT_EQ(refused({"--at", "end", "--every", "tick"}),
              "pallax: --every excludes --at (see pallax decode --help)\n");
    EXPECT_EQ(refused({"--at", "end", "--to", "end"}),
              "pallax: --to excludes --at (see pallax decode --help)\n");
    EXPECT_EQ(refused({"--recording-column"}),
              "pallax: --recording-column requires --format csv (see pallax decode --help)\n");
    EXPECT_EQ(refused({"--format", "csv", "--typed"}),
              "pallax: --typed requires --format json (see pallax decode --help)\n");
}

TEST(Options, DecodeWritesSamples) {
    const auto samples = parsed<DecodeOptions>({"decode", "--samples", "a.pcap"});
    EXPECT_EQ(samples.view, DecodeView::Samples);
    EXPECT_EQ(samples.chosenEvery(), Every::Tick);
    const auto refused = [](std::vector<std::string> arguments) {
        arguments.insert(arguments.begin(), {"decode", "a.pcap", "--samples"});
        return ended(arguments).text;
    };
    EXPECT_EQ(refused({"--every", "tick"}),
              "pallax: --every excludes --samples (see pallax decode --help)\n");
    EXPECT_EQ(refused({"--at", "end"}),
              "pallax: --samples excludes --at (see pallax decode --help)\n");
    EXPECT_EQ(refused({"--typed"}), "pallax: --typed writes displays, not values, columns or a "
                                    "table (see pallax decode --help)\n");
}

TEST(Options, DecodeWritesColumns) {
    const auto wide = parsed<DecodeOptions>({"decode", "--wide", "a.pcap"});
    EXPECT_EQ(wide.view, DecodeView::Wide);
    EXPECT_EQ(wide.chosenFormat(), DecodeFormat::Csv);
    EXPECT_EQ(wide.chosenEvery(), Every::Tick);
    EXPECT_EQ(parsed<DecodeOptions>({"decode", "--wide", "--join", "a", "b"}).recordings.size(),
              2U);
    const auto refused = [](std::vector<std::string> arguments) {
        arguments.insert(arguments.begin(), {"decode", "a.pcap", "--wide"});
        return ended(arguments).text;
    };
    EXPECT_EQ(refused({"b.pcap"}), "pallax: --wide takes one recording, or several with --join "
                                   "(see pallax decode --help)\n");
    EXPECT_EQ(refused({"--format", "json"}),
              "pallax: --wide requires --format csv (see pallax decode --help)\n");
    EXPECT_EQ(refused({"--samples"}),
              "pallax: --samples excludes --wide (see pallax decode --help)\n");
}

TEST(Options, DecodeWritesATable) {
    const auto table = parsed<DecodeOptions>({"decode", "--table", "Cell", "--at", "end", "a"});
    EXPECT_EQ(table.view, DecodeView::Table);
    EXPECT_EQ(table.table, "Cell");
    EXPECT_EQ(table.chosenEvery(), Every::End);
    for (const char* other : {"--samples", "--wide", "--every=end", "--format=json"}) {
        const std::string name(other,
                               std::min(std::string(other).find('='), std::string(other).size()));
        EXPECT_EQ(ended({"decode", "--table", "Cell", other, "a"}).text,
                  "pallax: " + name + " excludes --table (see pallax decode --help)\n");
    }
}

TEST(Options, TheNumberedPartsOfARecordingAreBrowsed) {
    const auto options = parsed<BrowseOptions>({"d-0002.pcap", "--print", "d-0001.pcap"});
    EXPECT_EQ(sourceName(options.source), "d-0001.pcap and 1 more");
    EXPECT_TRUE(options.print);
    EXPECT_EQ(ended({"a.pcap", "b.pcap"}).text,
              "pallax: RECORDING: a.pcap and b.pcap are not the numbered parts of one recording "
              "(see pallax --help)\n");
}

TEST(Options, SnapshotTakesAFile) {
    const auto log = parsed<SnapshotOptions>({"snapshot", "--dlf", "a.pallax"});
    EXPECT_EQ(log.file, "a.pallax");
    EXPECT_EQ(log.output, "-");
    EXPECT_TRUE(log.dlf);
    EXPECT_EQ(parsed<SnapshotOptions>({"snapshot", "--dlf", "a", "-o", "b"}).output, "b");
}

TEST(Options, ADifferenceIsOfTwoMoments) {
    const auto plain = parsed<DiffOptions>({"diff", "a@14:03", "b"});
    EXPECT_EQ(plain.before, "a@14:03");
    EXPECT_EQ(plain.after, "b");
    EXPECT_FALSE(plain.all);
    EXPECT_FALSE(plain.json);
    EXPECT_TRUE(plain.select.empty());
    const auto all = parsed<DiffOptions>({"diff", "--all", "--json", "--select", "lte.*",
                                          "--select", "gsm.*", "--technology", "lte", "a", "b"});
    EXPECT_TRUE(all.all);
    EXPECT_TRUE(all.json);
    EXPECT_EQ(all.select, (std::vector<std::string>{"lte.*", "gsm.*"}));
    EXPECT_EQ(all.technology->commandName, "lte");
    EXPECT_EQ(ended({"diff", "a", "b", "c"}).status, kExitWrongUsage);
}

TEST(Options, WatchTakesAConditionAndRecordings) {
    using namespace std::chrono_literals;
    const auto plain = parsed<WatchOptions>({"watch", "a > 1"});
    EXPECT_EQ(plain.condition, "a > 1");
    EXPECT_TRUE(plain.recordings.empty()) << "the live modem";
    EXPECT_EQ(plain.technology, nullptr);
    EXPECT_EQ(plain.needed, 0ns);
    EXPECT_EQ(plain.command, std::nullopt);
    EXPECT_FALSE(plain.once);
    const auto all =
        parsed<WatchOptions>({"watch", "--for", "10s", "--exec", "echo \"$X\"", "--once",
                              "--technology", "lte", "a > 1", "b.pcap", "-"});
    EXPECT_EQ(all.condition, "a > 1");
    EXPECT_EQ(all.recordings, (std::vector<std::string>{"b.pcap", "-"}));
    EXPECT_EQ(all.technology->commandName, "lte");
    EXPECT_EQ(all.needed, 10s);
    EXPECT_EQ(all.command, "echo \"$X\"");
    EXPECT_TRUE(all.once);
    EXPECT_EQ(parsed<WatchOptions>({"watch", "--for", "0.5", "a"}).needed, 500ms);
    const auto rule = parsed<WatchOptions>({"watch", "--rule", "weak", "b.pcap", "c.pcap"});
    EXPECT_EQ(rule.rule, "weak");
    EXPECT_EQ(rule.condition, "");
    EXPECT_EQ(rule.recordings, (std::vector<std::string>{"b.pcap", "c.pcap"}));
    EXPECT_TRUE(parsed<WatchOptions>({"watch", "--rule", "weak"}).recordings.empty());
    EXPECT_EQ(ended({"watch", "--rule", "weak", "--for", "10"}).status, kExitWrongUsage);
    EXPECT_EQ(ended({"watch"}).text, "pallax: CONDITION is required (see pallax watch --help)\n");
    for (const std::string wrong : {"10m", "s", "0s", "1ss"}) {
        const ParseEnd end = ended({"watch", "--for", wrong, "a"});
        EXPECT_EQ(end.status, kExitWrongUsage) << wrong;
        EXPECT_TRUE(end.text.starts_with("pallax: --for: \"")) << end.text;
    }
}

TEST(Options, TheLiveModemStandsForRecordings) {
    using namespace std::chrono_literals;
    EXPECT_FALSE(parsed<EventsOptions>({"events", "a"}).live);
    const auto events = parsed<EventsOptions>({"events", "--live"});
    EXPECT_TRUE(events.live);
    EXPECT_EQ(events.duration, std::nullopt);
    EXPECT_EQ(parsed<EventsOptions>({"events", "--live", "--for", "0.5"}).duration, 500ms);
    const auto sql = parsed<SqlOptions>({"sql", "--live", "--for", "60", "select 1"});
    EXPECT_TRUE(sql.live);
    EXPECT_EQ(sql.duration, 60s);
    EXPECT_EQ(sql.words, std::vector<std::string>{"select 1"});
    EXPECT_EQ(parsed<StatusOptions>({"status"}).recording, std::nullopt);
    EXPECT_EQ(parsed<StatusOptions>({"status"}).duration, 5s);
    EXPECT_EQ(parsed<StatusOptions>({"status", "--for", "2"}).duration, 2s);
    for (const char* command : {"events", "sql"}) {
        EXPECT_EQ(ended({command, "--for", "2", "a"}).status, kExitWrongUsage);
        EXPECT_EQ(ended({command, "--live", "--for", "x"}).status, kExitWrongUsage);
    }
}

TEST(Options, AStatusIsOfOneRecordingAtATime) {
    const auto plain = parsed<StatusOptions>({"status", "a"});
    EXPECT_EQ(plain.recording, "a");
    EXPECT_FALSE(plain.at);
    EXPECT_FALSE(plain.json);
    EXPECT_EQ(plain.profile, "android");
    EXPECT_EQ(plain.technology, nullptr);
    const auto all = parsed<StatusOptions>(
        {"status", "a", "--at", "14:03", "--json", "--profile", "own", "--technology", "lte"});
    EXPECT_TRUE(all.at);
    EXPECT_TRUE(all.json);
    EXPECT_EQ(all.profile, "own");
    EXPECT_EQ(all.technology->commandName, "lte");
    EXPECT_EQ(ended({"status", "a", "--at", "noon"}).status, kExitWrongUsage);
    EXPECT_EQ(ended({"status", "a", "b"}).status, kExitWrongUsage);
}

TEST(Options, InfoTakesFiles) {
    const auto info = parsed<InfoOptions>({"info", "a.pcap", "--json", "-"});
    EXPECT_EQ(info.files, (std::vector<std::string>{"a.pcap", "-"}));
    EXPECT_TRUE(info.json);
}

TEST(PartOptions, WhereTakesACondition) {
    EXPECT_EQ(parsed<DecodeOptions>({"decode", "--where", "a < -1", "a.pcap"}).where, "a < -1");
    EXPECT_EQ(parsed<EventsOptions>({"events", "--where", "kind = 'gap'", "a.pcap"}).where,
              "kind = 'gap'");
    EXPECT_EQ(parsed<DecodeOptions>({"decode", "a.pcap"}).where, std::nullopt);
    EXPECT_EQ(ended({"decode", "--where"}).text,
              "pallax: --where: 1 required CONDITION missing (see pallax decode --help)\n");
}

} // namespace
} // namespace pallax
