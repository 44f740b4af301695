#include "tests/cli/EndToEnd.h"
#include "tests/doubles/Files.h"

#include <nlohmann/json.hpp>

#include <csignal>
#include <filesystem>
#include <fstream>
#include <sys/stat.h>

namespace pallax {
namespace {

namespace fs = std::filesystem;

class EndToEndReport : public EndToEnd {
protected:
    std::string sampleDrive() const { return PALLAX_SOURCE_DIR "/samples/lte-drive.pcap"; }
    std::string page() const { return world.path("drive.html"); }
    std::string write(const std::string& name, const std::string& content) const {
        std::ofstream(world.path(name)) << content;
        return world.path(name);
    }
};

TEST_F(EndToEndReport, WritesAPageThatItsUserAloneCanRead) {
    const Run made = run({"report", sampleDrive(), "-o", page()});
    EXPECT_EQ(made.status, 0);
    EXPECT_EQ(made.out, "");
    EXPECT_EQ(made.err, "");
    const std::string html = doubles::contentOf(page());
    EXPECT_TRUE(html.starts_with("<!doctype html>"));
    EXPECT_NE(html.find("id=\"figures-0\""), std::string::npos);
    EXPECT_NE(html.find("Content-Security-Policy"), std::string::npos);
    EXPECT_EQ(fs::status(page()).permissions(), fs::perms::owner_read | fs::perms::owner_write);
    EXPECT_EQ(run({"report", sampleDrive(), "-o", "-"}).out, html) << "the same bytes";
}

TEST_F(EndToEndReport, IsDrawnFromAStore) {
    const std::string store = world.path("s.db");
    ASSERT_EQ(run({"store", "load", "--into", store, "--device", "car1", sampleDrive()}).status, 0);
    const Run made = run({"report", "--store", store, "--device", "car1", "-o", page()});
    EXPECT_EQ(made.status, 0) << made.err;
    EXPECT_EQ(made.err, "");
    EXPECT_TRUE(doubles::contentOf(page()).starts_with("<!doctype html>"));
    EXPECT_FALSE(fs::exists(store + "-wal")) << "nothing is left beside the store";
    const auto stored = nlohmann::json::parse(run({"report", "--json", "--store", store}).out);
    const auto recorded = nlohmann::json::parse(run({"report", "--json", sampleDrive()}).out);
    EXPECT_EQ(stored["cells"], recorded["cells"]);
    EXPECT_EQ(stored["events"], recorded["events"]);
    EXPECT_EQ(stored["head"]["recording"], "lte-drive.pcap");
    ASSERT_EQ(stored["measures"].size(), recorded["measures"].size());
    for (std::size_t place = 0; place < stored["measures"].size(); ++place) {
        EXPECT_EQ(stored["measures"][place]["seconds"], recorded["measures"][place]["seconds"]);
    }
}

TEST_F(EndToEndReport, WhatCannotBeDrawnFromAStoreIsASentence) {
    const std::string store = world.path("s.db");
    const auto refusal = [&](std::vector<std::string> arguments) {
        arguments.insert(arguments.begin(), {"report", "-o", page(), "--store"});
        const Run refused = run(arguments);
        EXPECT_EQ(refused.status, 1);
        EXPECT_EQ(refused.out, "");
        EXPECT_FALSE(fs::exists(page()));
        return refused.err;
    };
    EXPECT_EQ(refusal({store}),
              "pallax: There is no store " + store + " (see pallax store load).\n");
    EXPECT_EQ(refusal({sampleDrive()}), "pallax: " + sampleDrive() + " is no file of SQLite.\n");
    ASSERT_EQ(run({"store", "load", "--into", store, "--device", "car1", sampleDrive()}).status, 0);
    EXPECT_EQ(refusal({store, "--device", "car3"}),
              "pallax: The store has no device \"car3\". Did you mean \"car1\"?\n");
    EXPECT_EQ(refusal({store, "--from", "2030-01-01"}),
              "pallax: The store has nothing of car1 in that time.\n");
    EXPECT_EQ(refusal({"clickhouse://host"}),
              "pallax: \"clickhouse://host\" is not the address of a store, such as "
              "clickhouse://host/database.\n");
    const Run itself = run({"report", "--store", store, "-o", store});
    EXPECT_EQ(itself.status, 1);
    EXPECT_EQ(itself.err, "pallax: " + store + " would be replaced by its report.\n");
}

TEST_F(EndToEndReport, PrintsTheFiguresOfEachRecordingOnALine) {
    const Run made = run({"report", "--json", sampleDrive(), gsmAttach()});
    EXPECT_EQ(made.status, 0);
    EXPECT_EQ(made.err, "");
    const std::size_t end = made.out.find('\n');
    const auto first = nlohmann::json::parse(made.out.substr(0, end));
    const auto second = nlohmann::json::parse(made.out.substr(end + 1));
    EXPECT_EQ(first["head"]["recording"], "lte-drive.pcap");
    EXPECT_EQ(second["head"]["recording"], "gsm-attach.pcap");
    EXPECT_EQ(second["head"]["technology"], "GSM/UMTS");
}

TEST_F(EndToEndReport, ReadsTheNumberedPartsOfARecordingAsOne) {
    const std::string first =
        record("drive-0001.pcap", {{std::chrono::seconds(0), registration(1)}});
    const std::string second =
        record("drive-0002.pcap", {{std::chrono::seconds(9), registration(0)}});
    const Run made = run({"report", "--json", first, second});
    EXPECT_EQ(made.status, 0);
    const auto figures = nlohmann::json::parse(made.out);
    EXPECT_EQ(figures["head"]["recording"], "drive.pcap");
    EXPECT_EQ(figures["head"]["packets"], 2);
}

TEST_F(EndToEndReport, OfAPipeIsThatOfTheFile) {
    const Run piped = run({"report", "--json", "-"}, sampleDrive());
    EXPECT_EQ(piped.status, 0);
    auto figures = nlohmann::json::parse(piped.out);
    EXPECT_EQ(figures["head"]["recording"], "standard input");
    figures["head"]["recording"] = "lte-drive.pcap";
    EXPECT_EQ(figures, nlohmann::json::parse(run({"report", "--json", sampleDrive()}).out));
}

TEST_F(EndToEndReport, ACutRecordingGivesAReportThatSaysSo) {
    const std::string cut = world.path("cut.pcap");
    fs::copy_file(sampleDrive(), cut);
    fs::resize_file(cut, 40000);
    const Run made = run({"report", cut, "-o", page()});
    EXPECT_EQ(made.status, 1);
    EXPECT_EQ(made.err, "pallax: " + cut + " ends in the middle of a packet.\n");
    EXPECT_TRUE(fs::exists(page()));
}

TEST_F(EndToEndReport, AFatalRecordEndsIt) {
    const std::string fatal =
        record("fatal.pcap", {{std::chrono::seconds(0), registration(1)},
                              {std::chrono::seconds(9), unreadableSimFiles()}});
    const Run made = run({"report", "--json", "--with-identities", fatal});
    EXPECT_EQ(made.status, 70);
    EXPECT_TRUE(made.err.starts_with("pallax: Packet 2 cannot be read: ")) << made.err;
    EXPECT_EQ(nlohmann::json::parse(made.out)["head"]["packets"], 1);
}

TEST_F(EndToEndReport, WhatCannotBeWrittenLeavesNothing) {
    const std::string folder = world.path("missing");
    const Run made = run({"report", sampleDrive(), "-o", folder + "/drive.html"});
    EXPECT_EQ(made.status, 1);
    EXPECT_EQ(made.err,
              "pallax: " + folder + "/drive.html cannot be written: No such file or directory.\n");
    const std::string copy = world.path("copy.pcap");
    fs::copy_file(sampleDrive(), copy);
    const Run over = run({"report", copy, "-o", copy});
    EXPECT_EQ(over.status, 1);
    EXPECT_EQ(over.err, "pallax: " + copy + " would be replaced by its report.\n");
    EXPECT_EQ(doubles::contentOf(copy), doubles::contentOf(sampleDrive()));
}

TEST_F(EndToEndReport, AFullDeviceIsOneSentenceAndStaysADevice) {
    const std::string full = world.path("full");
    fs::create_symlink("/dev/full", full); // so that nothing is lost if it were replaced
    const Run made = run({"report", sampleDrive(), "-o", full});
    EXPECT_EQ(made.status, 1);
    EXPECT_EQ(made.err, "pallax: " + full + " cannot be written: No space left on device.\n");
    EXPECT_TRUE(fs::is_character_file(full));
    for (const char* argument : {"--json", "--output=-"}) {
        doubles::PallaxProcess process(world, {"report", argument, sampleDrive()}, "/dev/null",
                                       "/dev/full");
        EXPECT_EQ(process.wait(), 1);
        EXPECT_EQ(process.err(),
                  "pallax: Standard output cannot be written: No space left on device.\n");
    }
}

TEST_F(EndToEndReport, WhatIsNoWholeRecordingIsOneSentence) {
    const auto refused = [this](const std::string& recording) {
        const Run made = run({"report", recording, "-o", page()});
        EXPECT_EQ(made.status, 1);
        EXPECT_EQ(made.out, "");
        EXPECT_FALSE(fs::exists(page()));
        return made.err;
    };
    const std::string none = world.path("none.pcap");
    EXPECT_EQ(refused(none), "pallax: " + none + " cannot be opened: No such file or directory.\n");
    const std::string empty = write("empty.pcap", "");
    EXPECT_EQ(refused(empty), "pallax: " + empty + " is empty.\n");
    const std::string text = write("text", "This is a text.");
    EXPECT_EQ(refused(text),
              "pallax: " + text + " is not a recording: it is neither pcap nor pcapng.\n");
    const std::string folder = world.path("folder");
    fs::create_directory(folder);
    EXPECT_EQ(refused(folder), "pallax: " + folder + " cannot be opened: it is a folder.\n");
}

TEST_F(EndToEndReport, ATimeThatIsNotThereIsOneSentence) {
    const auto refused = [this](const char* from, const char* to) {
        const Run made = run({"report", "--from", from, "--to", to, sampleDrive(), "-o", page()});
        EXPECT_EQ(made.status, 1);
        EXPECT_FALSE(fs::exists(page()));
        return made.err;
    };
    EXPECT_EQ(refused("22:15", "22:14"),
              "pallax: lte-drive.pcap: the time of --from is later than that of --to.\n");
    EXPECT_EQ(refused("10:00", "end"),
              "pallax: lte-drive.pcap: \"10:00\" is no time of the recording, which lasts from "
              "2023-11-14 22:13:20 to 2023-11-14 22:15:19.\n");
}

TEST_F(EndToEndReport, EndsAtASignalAndLeavesNothing) {
    const std::string fifo = world.path("fifo");
    ASSERT_EQ(::mkfifo(fifo.c_str(), S_IRUSR | S_IWUSR), 0);
    doubles::PallaxProcess process(world, {"report", fifo, "-o", page()});
    std::ofstream writer(fifo, std::ios::binary); // waits for its reader
    const std::string drive = doubles::contentOf(sampleDrive());
    writer << drive.substr(0, drive.size() / 2) << std::flush;
    process.signal(SIGINT);
    EXPECT_EQ(process.wait(), -SIGINT);
    EXPECT_EQ(process.err(), "");
    for (const auto& entry : fs::directory_iterator(world.path())) {
        EXPECT_FALSE(entry.path().filename().string().starts_with("drive.html")) << entry.path();
    }
}

TEST_F(EndToEndReport, WrongUsageIsOneSentence) {
    const auto refused = [this](const std::vector<std::string>& arguments) {
        const Run run = this->run(arguments);
        EXPECT_EQ(run.status, 2) << run.err;
        return run.err;
    };
    EXPECT_EQ(refused({"report", sampleDrive()}),
              "pallax: --output or --json is required (see pallax report --help)\n");
    EXPECT_EQ(refused({"report", "-o", page()}),
              "pallax: RECORDING or --store is required (see pallax report --help)\n");
    EXPECT_EQ(refused({"report", "--profile", "none", sampleDrive(), "-o", page()}),
              "pallax: profile \"none\" is not one of android|field|operator "
              "(see pallax report --help)\n");
    EXPECT_EQ(refused({"report", sampleDrive(), gsmAttach(), sampleDrive(), "-o", page()}),
              "pallax: report takes one recording, or two to compare (see pallax report --help)\n");
    EXPECT_FALSE(fs::exists(page()));
}

} // namespace
} // namespace pallax
