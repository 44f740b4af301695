#include "tests/cli/ParsedOptions.h"

#include <gtest/gtest.h>

#include <regex>
#include <sstream>

namespace pallax {
namespace {

TEST(Options, WithoutArgumentsTheLiveModemIsBrowsed) {
    const auto options = parsed<BrowseOptions>({});
    EXPECT_TRUE(std::holds_alternative<ServiceModem>(options.source));
    EXPECT_EQ(options.play.speed, 1.0);
    EXPECT_FALSE(options.play.loop);
    EXPECT_FALSE(options.keepGoing);
    EXPECT_EQ(options.logLevel, std::nullopt);
}

TEST(Options, ARecordingIsBrowsed) {
    const auto options = parsed<BrowseOptions>(
        {"drive.pcap", "--print", "--speed", "2.5", "--loop", "--keep-going", "--log-level", "4"});
    EXPECT_EQ(recordingPath(options.source), "drive.pcap");
    EXPECT_TRUE(options.print);
    EXPECT_FALSE(options.plain);
    EXPECT_TRUE(parsed<BrowseOptions>({"drive.pcap", "--plain"}).plain);
    const ParsedOptions both = parseOptions({"drive.pcap", "--plain", "--print"});
    EXPECT_EQ(std::get<ParseEnd>(both).status, kExitWrongUsage);
    EXPECT_EQ(options.play.speed, 2.5);
    EXPECT_TRUE(options.play.loop);
    EXPECT_TRUE(options.keepGoing);
    EXPECT_EQ(options.logLevel, 4);
    EXPECT_EQ(parsed<BrowseOptions>({"--speed", "max", "-"}).play.speed,
              PlayOptions::kAsFastAsTaken);
    EXPECT_EQ(recordingPath(parsed<BrowseOptions>({"-"}).source), "-");
}

TEST(Options, ColourAndMouseAreTheTerminalsUnlessToldOtherwise) {
    const auto plain = std::get<BrowseOptions>(parseOptions({"a.pcap"}));
    EXPECT_EQ(plain.color, terminal::ColorUse::Auto);
    EXPECT_TRUE(plain.mouse);
    const auto told =
        std::get<BrowseOptions>(parseOptions({"a.pcap", "--color=never", "--no-mouse"}));
    EXPECT_EQ(told.color, terminal::ColorUse::Never);
    EXPECT_FALSE(told.mouse);
    const auto always = std::get<BrowseOptions>(parseOptions({"--color", "always"}));
    EXPECT_EQ(always.color, terminal::ColorUse::Always);
    const auto wrong = std::get<ParseEnd>(parseOptions({"--color", "blue"}));
    EXPECT_EQ(wrong.status, kExitWrongUsage);
    EXPECT_EQ(wrong.text,
              "pallax: --color: \"blue\" is not one of auto|always|never (see pallax --help)\n");
}

TEST(Options, TheProfileOfTheScreenIsThatOfTheSettingsUnlessToldOtherwise) {
    EXPECT_EQ(parsed<BrowseOptions>({"a.pcap"}).profile, std::nullopt);
    EXPECT_EQ(parsed<BrowseOptions>({"a.pcap", "--profile", "field"}).profile, "field");
    EXPECT_EQ(parsed<BrowseOptions>({"demo", "--profile=survey"}).profile, "survey");
}

TEST(Options, ARecordingNamedLikeACommandIsGivenWithItsFolder) {
    EXPECT_EQ(recordingPath(parsed<BrowseOptions>({"./decode"}).source), "./decode");
}

TEST(Options, DecodeWritesTheLastDisplayAsJsonUnlessToldOtherwise) {
    const auto plain = parsed<DecodeOptions>({"decode", "a.pcap", "b.pcap"});
    EXPECT_EQ(plain.recordings, (std::vector<std::string>{"a.pcap", "b.pcap"}));
    EXPECT_EQ(plain.technology, nullptr);
    EXPECT_EQ(plain.chosenEvery(), Every::End);
    EXPECT_EQ(plain.chosenFormat(), DecodeFormat::Json);
    EXPECT_EQ(plain.systemLog, std::nullopt);
    EXPECT_FALSE(plain.strict);

    const auto csv = parsed<DecodeOptions>({"decode", "--format", "csv", "a.pcap"});
    EXPECT_EQ(csv.chosenEvery(), Every::Tick) << "CSV shows changes";

    const auto told =
        parsed<DecodeOptions>({"decode", "--technology", "lte", "--every", "tick", "--format",
                               "csv", "--system-log", "-", "--strict", "a.pcap"});
    EXPECT_EQ(told.technology->identifier, "Zorell_LTE");
    EXPECT_EQ(told.every, Every::Tick);
    EXPECT_EQ(told.format, DecodeFormat::Csv);
    EXPECT_EQ(told.systemLog, "-");
    EXPECT_TRUE(told.strict);
}

TEST(Options, DecodeTakesEveryTechnology) {
    for (const char* name : {"ifx", "gsm", "cdma", "lte", "utran"}) {
        EXPECT_EQ(
            parsed<DecodeOptions>({"decode", "--technology", name, "a"}).technology->commandName,
            name);
    }
}

TEST(Options, ServicePlaysARecording) {
    const auto options =
        parsed<ServiceOptions>({"service", "--play", "a.pcap", "--speed", "max", "--loop"});
    EXPECT_EQ(recordingPath(options.source), "a.pcap");
    EXPECT_EQ(options.play.speed, PlayOptions::kAsFastAsTaken);
    EXPECT_TRUE(options.play.loop);
}

TEST(Options, ServiceRelaysStandardInput) {
    const auto options = parsed<ServiceOptions>({"service", "--relay", "-"});
    EXPECT_EQ(recordingPath(options.source), "-");
    EXPECT_TRUE(options.relay);
    EXPECT_EQ(options.relayPatience, std::chrono::seconds(10));
    EXPECT_FALSE(parsed<ServiceOptions>({"service", "--play", "-"}).relay);
}

TEST(Options, ServiceRelaysAfterSoLongAWait) {
    using std::chrono::milliseconds;
    const auto patience = [](const char* wait) {
        return parsed<ServiceOptions>({"service", "--relay", "-", "--wait", wait}).relayPatience;
    };
    EXPECT_EQ(patience("0"), milliseconds(0));
    EXPECT_EQ(patience("2.5"), milliseconds(2500));
    EXPECT_EQ(patience("1000000"), std::chrono::seconds(1'000'000));
}

TEST(Options, ServiceTellsItsStatus) {
    (void)parsed<ServiceStatusOptions>({"service", "--status"});
}

TEST(Options, RecordWritesOneFileAndKeepsWhatExistsUnlessToldOtherwise) {
    const auto plain = parsed<RecordOptions>({"record", "a.pcapng"});
    EXPECT_EQ(plain.files.path, "a.pcapng");
    EXPECT_EQ(plain.files.existing, PcapNgWriter::Existing::Keep);
    EXPECT_FALSE(plain.files.rotates());
    EXPECT_EQ(plain.technology, nullptr);
    EXPECT_EQ(plain.logLevel, std::nullopt);

    const auto told = parsed<RecordOptions>({"record", "--technology", "utran", "--rotate-size",
                                             "64k", "--rotate-seconds", "1.5", "--overwrite",
                                             "--log-level", "6", "a.pcapng"});
    EXPECT_EQ(told.technology->identifier, "Zorell_UTRAN2");
    EXPECT_EQ(told.files.rotateSize, 65536U);
    EXPECT_EQ(told.files.rotateAfter, std::chrono::milliseconds(1500));
    EXPECT_EQ(told.files.existing, PcapNgWriter::Existing::Overwrite);
    EXPECT_EQ(told.logLevel, 6);
}

TEST(Options, ServiceSimulatesAModem) {
    const auto options = parsed<ServiceOptions>(
        {"service", "--simulate", "lte", "--seed", "18446744073709551615", "--rate", "50"});
    const auto& optionsDrive = std::get<SimulationOptions>(options.source);
    EXPECT_EQ(optionsDrive.technology->commandName, "lte");
    EXPECT_EQ(optionsDrive.seed, 18446744073709551615U);
    EXPECT_EQ(optionsDrive.packetsPerSecond, 50U);
    EXPECT_EQ(optionsDrive.duration, std::nullopt);
    EXPECT_EQ(options.play.speed, 1.0);
    EXPECT_EQ(ended({"service", "--simulate", "lte", "--play", "a"}).status, kExitWrongUsage);
    const auto brief = parsed<ServiceOptions>(
        {"service", "--simulate", "ifx", "--seconds", "60", "--speed", "max"});
    EXPECT_EQ(std::get<SimulationOptions>(brief.source).duration, std::chrono::seconds(60));
    EXPECT_EQ(brief.play.speed, PlayOptions::kAsFastAsTaken);
}

TEST(Options, DemoBrowsesASimulatedModemOfLteUnlessAnotherIsNamed) {
    const auto plain = parsed<BrowseOptions>({"demo"});
    const auto& plainDrive = std::get<SimulationOptions>(plain.source);
    EXPECT_EQ(plainDrive.technology->commandName, "lte");
    EXPECT_EQ(plainDrive.seed, 1U);
    EXPECT_EQ(plainDrive.packetsPerSecond, 40U);
    EXPECT_EQ(plainDrive.duration, std::nullopt) << "it never ends";
    const auto told =
        parsed<BrowseOptions>({"demo", "gsm", "--seed", "7", "--speed", "max", "--seconds", "60",
                               "--print", "--no-mouse", "--keep-going", "--log-level", "3"});
    const auto& toldDrive = std::get<SimulationOptions>(told.source);
    EXPECT_EQ(toldDrive.technology->commandName, "gsm");
    EXPECT_EQ(toldDrive.seed, 7U);
    EXPECT_EQ(toldDrive.duration, std::chrono::seconds(60));
    EXPECT_EQ(told.play.speed, PlayOptions::kAsFastAsTaken);
    EXPECT_TRUE(told.print);
    EXPECT_FALSE(told.mouse);
    EXPECT_TRUE(told.keepGoing);
    EXPECT_EQ(told.logLevel, 3);
}

TEST(Options, SimulateWritesARecordingOfSomeSeconds) {
    const auto options = parsed<SimulateOptions>(
        {"simulate", "cdma", "--seconds", "5", "--seed", "9", "--rate", "20", "-o", "a.pcap"});
    EXPECT_EQ(options.simulation.technology->commandName, "cdma");
    EXPECT_EQ(options.simulation.duration, std::chrono::seconds(5));
    EXPECT_EQ(options.simulation.seed, 9U);
    EXPECT_EQ(options.simulation.packetsPerSecond, 20U);
    EXPECT_EQ(options.file, "a.pcap");
}

TEST(Options, ASimulationThatCannotBeIsWrongUsage) {
    const auto sentence = [](std::vector<std::string> arguments) {
        const ParseEnd end = ended(std::move(arguments));
        EXPECT_EQ(end.status, kExitWrongUsage);
        return end.text;
    };
    EXPECT_EQ(sentence({"demo", "wimax"}), "pallax: TECHNOLOGY: \"wimax\" is not one of "
                                           "ifx|gsm|cdma|lte|utran (see pallax demo --help)\n");
    EXPECT_EQ(sentence({"demo", "--seconds", "0"}),
              "pallax: --seconds: \"0\" is no whole number from 1 to 31622400 (see pallax demo "
              "--help)\n");
    EXPECT_EQ(
        sentence({"demo", "--rate", "x"}),
        "pallax: --rate: \"x\" is no whole number from 5 to 1000000 (see pallax demo --help)\n");
    EXPECT_EQ(sentence({"simulate", "lte", "-o", "a"}),
              "pallax: --seconds is required (see pallax simulate --help)\n");
    EXPECT_EQ(sentence({"service", "--seed", "3"}),
              "pallax: --seed requires --simulate (see pallax service --help)\n");
    EXPECT_EQ(sentence({"service", "--play", "a", "--seconds", "3"}),
              "pallax: --seconds requires --simulate (see pallax service --help)\n");
    EXPECT_EQ(sentence({"service", "--relay", "-", "--speed", "2"}),
              "pallax: --speed excludes --relay (see pallax service --help)\n");
    EXPECT_EQ(sentence({"service", "--play", ""}),
              "pallax: the service needs --play, --simulate, --relay, --modem, --status or --list "
              "(see pallax "
              "service --help)\n");
    EXPECT_EQ(sentence({"service", "--speed", "2"}),
              "pallax: the service needs --play, --simulate, --relay, --modem, --status or --list "
              "(see pallax "
              "service --help)\n");
}

TEST(Options, FieldsAreOfEveryTechnologyUnlessOneIsNamed) {
    const auto plain = parsed<FieldsOptions>({"fields"});
    EXPECT_EQ(plain.technology, nullptr);
    EXPECT_FALSE(plain.json);
    const auto told = parsed<FieldsOptions>({"fields", "cdma", "--json"});
    ASSERT_NE(told.technology, nullptr);
    EXPECT_EQ(told.technology->commandName, "cdma");
    EXPECT_TRUE(told.json);
    EXPECT_EQ(ended({"fields", "lte", "gsm"}).status, kExitWrongUsage);
}

TEST(Options, ExplainTakesWordsNegativeNumbersAmongThem) {
    const auto plain = parsed<ExplainOptions>({"explain", "rsrp", "-97"});
    EXPECT_EQ(plain.words, (std::vector<std::string>{"rsrp", "-97"}));
    EXPECT_EQ(plain.profile, "android");
    EXPECT_FALSE(plain.json);
    const auto told =
        parsed<ExplainOptions>({"explain", "--json", "rsrp", "-97.5", "--profile", "mine"});
    EXPECT_EQ(told.words, (std::vector<std::string>{"rsrp", "-97.5"}));
    EXPECT_EQ(told.profile, "mine");
    EXPECT_TRUE(told.json);
    EXPECT_EQ(ended({"explain"}).status, kExitWrongUsage);
}

TEST(Options, TheHelpOfExplainNamesEveryTopic) {
    const std::string help = ended({"explain", "--help"}).text;
    for (const std::string& topic : topicNames()) {
        EXPECT_NE(help.find(topic), std::string::npos) << topic;
    }
    for (const BuiltInProfile& profile : builtInProfiles()) {
        EXPECT_NE(help.find(profile.name), std::string::npos) << profile.name;
    }
}

TEST(Options, EventsAreOfRecordings) {
    const auto told = parsed<EventsOptions>({"events", "a", "--json", "b", "--technology", "gsm"});
    EXPECT_EQ(told.recordings, (std::vector<std::string>{"a", "b"}));
    EXPECT_TRUE(told.json);
    EXPECT_EQ(told.technology->commandName, "gsm");
    EXPECT_EQ(ended({"events"}).status, kExitWrongUsage);
}

TEST(Options, AReportIsOfAPartAndHasAProfile) {
    const auto told = parsed<ReportOptions>(
        {"report", "a",         "b",        "-o",      "c.html", "--from",       "14:02", "--to",
         "end",    "--profile", "field",    "--title", "T",      "--label",      "A",     "--label",
         "B",      "--where",   "rsrp < 1", "--track", "w.gpx",  "--technology", "gsm"});
    EXPECT_EQ(told.recordings, (std::vector<std::string>{"a", "b"}));
    EXPECT_EQ(told.output, "c.html");
    EXPECT_TRUE(told.from && told.to && told.to->isEnd());
    EXPECT_EQ(told.profile, "field");
    EXPECT_EQ(told.title, "T");
    EXPECT_EQ(told.labels, (std::vector<std::string>{"A", "B"}));
    EXPECT_EQ(told.where, "rsrp < 1");
    EXPECT_EQ(told.track, "w.gpx");
    EXPECT_EQ(told.technology->commandName, "gsm");
    EXPECT_FALSE(told.json);
    EXPECT_FALSE(told.withIdentities);
    EXPECT_TRUE(parsed<ReportOptions>({"report", "a", "--json", "--with-identities"}).json);
    EXPECT_EQ(ended({"report", "a"}).status, kExitWrongUsage);
}

TEST(Options, AReportCanBeOfAStore) {
    const auto told = parsed<ReportOptions>({"report", "--store", "s.db", "--device", "car1",
                                             "--technology", "lte", "--from", "start", "-o", "a"});
    EXPECT_EQ(told.store, "s.db");
    EXPECT_EQ(told.device, "car1");
    EXPECT_EQ(told.technology->commandName, "lte");
    EXPECT_TRUE(told.from);
    const auto refusal = [](std::vector<std::string> arguments) {
        arguments.insert(arguments.begin(), {"report", "-o", "a.html"});
        const ParseEnd end = ended(std::move(arguments));
        EXPECT_EQ(end.status, kExitWrongUsage);
        return end.text;
    };
    EXPECT_EQ(refusal({}), "pallax: RECORDING or --store is required (see pallax report --help)\n");
    EXPECT_EQ(refusal({"--device", "car1", "a.pcap"}),
              "pallax: --device requires --store (see pallax report --help)\n");
    EXPECT_EQ(refusal({"--store", "s.db", "a.pcap"}),
              "pallax: --store excludes RECORDING (see pallax report --help)\n");
    EXPECT_EQ(refusal({"--store", "s.db", "--where", "x"}),
              "pallax: --where excludes --store (see pallax report --help)\n");
    EXPECT_EQ(refusal({"--store", "s.db", "--with-identities"}),
              "pallax: --with-identities excludes --store (see pallax report --help)\n");
}

TEST(Options, HelpAndVersionGoToStandardOutputEverywhere) {
    for (const char* command :
         {"",       "decode",  "record", "service",  "demo",       "simulate", "events",
          "fields", "explain", "info",   "snapshot", "sql",        "status",   "diff",
          "watch",  "report",  "mask",   "verify",   "completion", "manual",   "store"}) {
        std::vector<std::string> arguments;
        if (*command != '\0') {
            arguments.emplace_back(command);
        }
        arguments.emplace_back("--version");
        const ParseEnd version = ended(arguments);
        EXPECT_EQ(version.status, kExitSuccess);
        EXPECT_TRUE(version.text.starts_with("pallax ")) << version.text;
        EXPECT_EQ(version.text.find('\n'), version.text.size() - 1);
        arguments.back() = "--help";
        const ParseEnd help = ended(arguments);
        EXPECT_EQ(help.status, kExitSuccess);
        const std::size_t examples = help.text.find("\nExamples:\n  ");
        const std::size_t options = help.text.find("\nOptions:\n  ");
        EXPECT_LT(examples, options) << help.text;
        const std::string statuses = "\nExit status:\n";
        const std::size_t end = help.text.find(statuses + "  0   ");
        EXPECT_LT(options, end) << help.text;
        ASSERT_NE(end, std::string::npos) << help.text;
        EXPECT_TRUE(std::regex_match(help.text.substr(end + statuses.size()),
                                     std::regex("(  [0-9]+ +[^\n]+\n)+")))
            << help.text;
        std::istringstream lines(help.text);
        for (std::string line; std::getline(lines, line);) {
            EXPECT_TRUE(line.size() <= 80 || line.starts_with("  PAGE ")) << line;
        }
    }
    EXPECT_NE(ended({"decode", "--help"}).text.find("--every end|tick|packet"), std::string::npos);
}

TEST(Options, CompletionAndManualAreTextsThatTheHelpDoesNotName) {
    const ParseEnd script = ended({"completion", "bash"});
    EXPECT_EQ(script.status, kExitSuccess);
    EXPECT_NE(script.text.find("complete -F _pallax pallax\n"), std::string::npos);
    EXPECT_EQ(refusalOf({"completion", "csh"}),
              "pallax: SHELL: \"csh\" is not one of bash|zsh|fish. Did you mean \"zsh\"? (see "
              "pallax completion --help)\n");
    EXPECT_EQ(refusalOf({"manual"}), "pallax: PAGE is required (see pallax manual --help)\n");
    const std::string help = ended({"--help"}).text;
    EXPECT_EQ(help.find("completion"), std::string::npos);
    EXPECT_EQ(help.find("manual"), std::string::npos);
}

} // namespace
} // namespace pallax
