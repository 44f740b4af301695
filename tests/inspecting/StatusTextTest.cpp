#include "inspecting/StatusText.h"

#include "knowledge/Networks.h"
#include "tests/doubles/Property.h"
#include "tests/timeline/TimelineFixture.h"

#include <algorithm>
#include <sstream>

namespace pallax {
namespace {

constexpr Time kNow{std::chrono::seconds(1700000000)};

StatusValue value(const char* name, const std::string& text, int age = 0) {
    return {name, "", text, 0.0, Grade::Good, kNow - std::chrono::seconds(age)};
}

std::string textOf(const Status& status) {
    std::string text;
    appendStatusText(text, {"a.pcap", "lte", "LTE"}, status);
    return text;
}

std::ptrdiff_t columnsIn(const std::string& line) {
    return std::count_if(line.begin(), line.end(), [](char byte) {
        return (static_cast<unsigned char>(byte) & 0xC0U) != 0x80U;
    });
}

Status emptyStatus() {
    Status status;
    status.time = kNow;
    status.profile = "field";
    return status;
}

TEST(StatusText, AValueThatIsOldSaysSo) {
    Status status = emptyStatus();
    status.cells.push_back(
        {"LTE", "", {value("PCI", "1", 10)}, value("EARFCN", "1850", 11), "", {}, {}});
    EXPECT_EQ(textOf(status), "LTE · 2023-11-14 22:13:20 · a.pcap\n"
                              "cell        PCI 1 · EARFCN 1850 · 11 s ago\n");
    status.cells.front().channel->read = kNow - std::chrono::seconds(119);
    EXPECT_NE(textOf(status).find("119 s ago\n"), std::string::npos);
    status.cells.front().channel->read = kNow - std::chrono::seconds(179);
    EXPECT_NE(textOf(status).find("2 min ago\n"), std::string::npos);
    using std::chrono::hours;
    status.cells.front().channel->read = kNow - hours(2) + std::chrono::seconds(1);
    EXPECT_NE(textOf(status).find("119 min ago\n"), std::string::npos);
    status.cells.front().channel->read = kNow - hours(47);
    EXPECT_NE(textOf(status).find("47 h ago\n"), std::string::npos);
    status.cells.front().channel->read = kNow - hours(49);
    EXPECT_NE(textOf(status).find("2 days ago\n"), std::string::npos);
}

TEST(StatusText, FitsTenLinesOfEightyColumnsAndKeepsTheProfile) {
    Status status = emptyStatus();
    const std::string wide = "ä long text of a modem that goes on and on";
    status.network =
        StatusOperator{NetworkCode{"262", "42"}, wide, "Germany", NameSource::Sim, true};
    for (const char* system : {"GSM", "UMTS"}) {
        status.cells.push_back({system,
                                wide,
                                {value("PCI", wide), value("TAC", wide)},
                                value("EARFCN", wide),
                                wide,
                                1870.0,
                                {value("RSRP", wide), value("RSRQ", wide)}});
        status.neighbours.push_back({system, wide, value("RSRP", wide)});
    }
    status.states = {value("MM", wide), value("GMM", wide), value("RR", wide)};
    status.contexts = {{wide, wide}, {wide, wide}, {"b", ""}};
    const std::string text = textOf(status);
    EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 10) << text;
    std::istringstream lines(text);
    for (std::string line; std::getline(lines, line);) {
        EXPECT_LE(columnsIn(line), 80) << line;
        EXPECT_GT(columnsIn(line), 12) << line;
    }
    EXPECT_NE(text.find("levels      profile field · GSM RSRP"), std::string::npos) << text;
    EXPECT_NE(text.find("…\n"), std::string::npos) << text;
}

TEST(StatusText, OfSeveralCellsTheStrengthsComeFirst) {
    Status status = emptyStatus();
    for (const char* system : {"LTE", "NR"}) {
        status.cells.push_back({system,
                                "",
                                {value("PCI", "1")},
                                {},
                                "",
                                {},
                                {value("RSRP", "-90 dBm"), value("RSRQ", "-9 dB")}});
    }
    EXPECT_EQ(textOf(status), "LTE · 2023-11-14 22:13:20 · a.pcap\n"
                              "LTE cell    PCI 1\n"
                              "NR cell     PCI 1\n"
                              "levels      profile field · LTE RSRP -90 dBm good · NR RSRP -90 dBm "
                              "good\n"
                              "            LTE RSRQ -9 dB good · NR RSRQ -9 dB good\n");
    status.cells.pop_back();
    EXPECT_EQ(textOf(status), "LTE · 2023-11-14 22:13:20 · a.pcap\n"
                              "cell        PCI 1\n"
                              "levels      profile field · RSRP -90 dBm good · RSRQ -9 dB good\n");
}

TEST(StatusText, TellsHowManyCellsItLeavesOut) {
    Status status = emptyStatus();
    status.network = StatusOperator{NetworkCode{"262", "42"}, "Net", "", NameSource::Sim, false};
    for (const char* pci : {"1", "2", "3", "4"}) {
        status.cells.push_back(
            {"LTE", "", {value("PCI", pci)}, {}, "", {}, {value("RSRP", "-90")}});
    }
    status.states = {value("modem", "registered")};
    status.neighbours.push_back({"LTE", "PCI 9", value("RSRP", "1")});
    status.contexts = {{"ims", ""}};
    EXPECT_NE(textOf(status).find("LTE cell    PCI 4\nlevels "), std::string::npos);
    for (int more = 0; more < 60; ++more) {
        status.cells.push_back(status.cells.front());
    }
    const std::string text = textOf(status);
    EXPECT_NE(text.find("LTE cell    PCI 3\ncells       61 more\nlevels "), std::string::npos)
        << text;
    EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 10) << text;
}

TEST(StatusText, OfAnyPacketsFits) {
    const NetworkNames names;
    const QualityProfile profile = *builtInProfile(kDefaultProfile);
    EXPECT_TRUE(doubles::holds([&] {
        TimelineFixture fixture(doubles::any::elementOf(technologyNames()));
        fixture.anyPackets(30);
        const auto timeline = fixture.indexed();
        const Status status =
            statusOf(timeline->valuesAt(timeline->packets()), kNow, names, profile);
        const std::string text = textOf(status);
        RC_ASSERT(std::count(text.begin(), text.end(), '\n') <= 10);
        std::istringstream lines(text);
        for (std::string line; std::getline(lines, line);) {
            RC_ASSERT(columnsIn(line) <= 80);
        }
        std::string json;
        appendStatusJson(json, {"a.pcap", "lte", "LTE"}, status);
        RC_ASSERT(std::count(json.begin(), json.end(), '\n') == 1);
    }));
}

TEST(StatusText, TextsOfAModemStayInTheirLine) {
    Status status = emptyStatus();
    status.contexts = {{"a\nb\x1B[2J", "c"}};
    EXPECT_EQ(textOf(status), "LTE · 2023-11-14 22:13:20 · a.pcap\n"
                              "contexts    a\\x0Ab\\x1B[2J c\n");
}

TEST(StatusText, AStateNamesItsMachineOnce) {
    Status status = emptyStatus();
    status.states = {value("MM", "MM_IDLE"), value("RRC", "Disconnected"), value("RR", "RRC_X")};
    EXPECT_NE(textOf(status).find("state       MM_IDLE · RRC Disconnected · RR RRC_X\n"),
              std::string::npos);
}

TEST(StatusText, WithoutGradesNoProfileIsNamed) {
    Status status = emptyStatus();
    status.cells.push_back({"LTE", "", {}, {}, "", {}, {value("RSRP", "-90 dBm")}});
    EXPECT_NE(textOf(status).find("levels      profile field · RSRP -90 dBm good\n"),
              std::string::npos);
    status.cells.front().levels.front().grade = std::nullopt;
    EXPECT_NE(textOf(status).find("levels      RSRP -90 dBm\n"), std::string::npos);
}

TEST(StatusText, OnlyThreeNeighboursAreShown) {
    Status status = emptyStatus();
    for (const char* cell : {"A", "B", "C", "D"}) {
        status.neighbours.push_back({"LTE", cell, value("RSRP", "1")});
    }
    EXPECT_NE(textOf(status).find("neighbours  A 1 · B 1 · C 1\n"), std::string::npos);
    std::string json;
    appendStatusJson(json, {"a.pcap", "lte", "LTE"}, status);
    EXPECT_NE(json.find(R"("cell":"D")"), std::string::npos) << "JSON has all";
}

} // namespace
} // namespace pallax
