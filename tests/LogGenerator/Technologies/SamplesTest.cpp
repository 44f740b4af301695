#include "host/Recording.h"
#include "plist/PropertyListCodec.h"
#include "tests/LogGenerator/Technologies/TechnologyDriver.h"
#include "tests/doubles/RecordingLog.h"

#include <exception>

namespace pallax {
namespace {

using doubles::Record;
using doubles::RecordingLog;
using Events = std::vector<std::string>;

TEST(Samples, OfAnLteRecordAreItsFieldsAndTheKeysThatNoLongerHold) {
    TechnologyDriver lte("Zorell_LTE");
    EXPECT_EQ(
        lte.samplesOf(
            Record(0xB0C2).padTo(14).u16(503).u16(1300).u16(19300).u8(50).u8(0).s32(-2).padTo(38)),
        (Events{"packet 1", "section Serving Cell Info", "removed UARFCN",
                "0 Physical Cell ID: 503 (raw 503)", "1 Download Frequency: 1300 (raw 1300)",
                "2 Upload Frequency: 19300 (raw 19300)", "3 Download Bandwidth: 10 MHz (raw 50)",
                "4 Upload Bandwidth: Unknown (raw 0)", "5 Cell Identity: -2 (raw -2)",
                "6 Tracking Area Code: 0 (raw 0)", "7 Freq Band Indicator: 0 (raw 0)",
                "end of packet"}));
}

TEST(Samples, OfLteListsAreTheirEntriesAndOfEmptiedOnesABeginAndAnEnd) {
    TechnologyDriver lte("Zorell_LTE");
    const Events serving = {
        "section Connected mode LTE Intra-frequency Measurement",
        "14 E-ARFCN: 0 (raw 0)",
        "15 Serving Physical Cell ID: 0 (raw 0)",
        "16 Subframe Number: 0 (raw 0)",
        "17 Serving Filtered RSRP: -140.00 dBm (raw 0)",
        "18 Serving Filtered RSRQ: -20.00 dB (raw 0)",
    };
    const auto around = [&serving](const char* packet, const Events& lists) {
        Events events = {packet};
        events.insert(events.end(), serving.begin(), serving.end());
        events.insert(events.end(), lists.begin(), lists.end());
        events.emplace_back("end of packet");
        return events;
    };
    EXPECT_EQ(
        lte.samplesOf(Record(0xB179).padTo(39).at(27, 1).at(28, 2).at(29, 7).at(37, 9)),
        around("packet 1",
               {"section Measured Neighbor Cells", "list  of 1", "entry 0",
                "19 Physical Cell ID: 7 (raw 7)", "20 Filtered RSRP: -140.00 dBm (raw 0)",
                "21 Filtered RSRQ: -20.00 dB (raw 0)", "end", "end of list",
                "section Detected Cells", "list  of 2", "entry 0", "22 Physical Cell ID: 0 (raw 0)",
                "end", "entry 1", "22 Physical Cell ID: 9 (raw 9)", "end", "end of list"}));
    EXPECT_EQ(lte.samplesOf(Record(0xB179).padTo(29)),
              around("packet 2", {"section Measured Neighbor Cells", "list  of 0", "end of list",
                                  "section Detected Cells", "list  of 0", "end of list"}));
}

TEST(Samples, OfAnUtranRecordThatIsReadAtOnceComeOnce) {
    TechnologyDriver utran("Zorell_UTRAN2");
    EXPECT_EQ(
        utran.samplesOf(Record(0xD0E0).u8(1).u8(3)),
        (Events{"packet 1", "section RRC Info", "0 State: Cell DCH (raw 3)", "end of packet"}));
}

TEST(Samples, OfAnUtranListThatIsNotDisplayedAreItsEntries) {
    TechnologyDriver utran("Zorell_UTRAN2");
    EXPECT_EQ(utran.samplesOf(
                  Record(0xD00E).padTo(16).u8(1).u8(0).u8(0x40).u8(5).u8(6).u16(512).s16(-80)),
              (Events{"packet 1", "section GSM Neighbor Cell List", "list  of 0", "end of list",
                      "list  of 1", "entry 0", "18 Cell ID: 0 (raw 0)",
                      "19 Band Indicator: 1 (raw 1)", "20 BSIC Valid: 0 (raw 0)",
                      "21 NCC: 5 (raw 5)", "22 BCC: 6 (raw 6)", "23 ARFCN: 512 (raw 512)",
                      "24 RSSI: -80 (raw -80)", "end", "end of list", "end of packet"}));
}

TEST(Samples, OfAGsmListOfPlainValuesHaveNoKey) {
    TechnologyDriver gsm("Zorell_GSM");
    EXPECT_EQ(gsm.samplesOf(Record(0x51F8).u8(17).u8(2).u16(62).u16(1023)),
              (Events{"packet 1", "section Mobile Allocation", "27 HSN: 17 (raw 17)",
                      "list ARFCNs of 2", "entry 0", "28 : 62 (raw 62)", "end", "entry 1",
                      "28 : 1023 (raw 1023)", "end", "end of list", "end of packet"}));
    EXPECT_EQ(gsm.samplesOf(Record(0x51F8).u8(18).u8(0)),
              (Events{"packet 2", "section Mobile Allocation", "27 HSN: 18 (raw 18)",
                      "list ARFCNs of 0", "end of list", "end of packet"}));
}

TEST(Samples, OfAPropertyListAreItsValues) {
    TechnologyDriver gsm("Zorell_GSM");
    const auto files = serializeBinary(Dictionary{{"kSimFile_HPPLMN", "6 min"}});
    const Events events = gsm.samplesOf(Record(kSimFilesLogCode).append(*files));
    ASSERT_EQ(events.size(), 4U);
    EXPECT_EQ(events[1], "section SIM Info");
    EXPECT_EQ(events[2].substr(events[2].find(' ')), " EF-HPPLMN SEARCH PERIOD: 6 min");
}

TEST(Samples, OfACdmaListByPilotAreItsEntriesUnderTheLookupName) {
    TechnologyDriver cdma("Zorell_CDMA");
    // At 512 of 512, and one that is locked to nothing.
    EXPECT_EQ(
        cdma.samplesOf(
            Record(0x108A).padTo(22).u8(2).u16(12).padTo(29).u16(512).padTo(37).u16(0xFFFF).padTo(
                51)),
        (Events{"packet 1", "list kFingerC2I of 2", "entry 0 named 12", "0 : +0.00 dB", "end",
                "end of list", "end of packet"}));
    EXPECT_EQ(cdma.samplesOf(Record(0x108A).padTo(23)),
              (Events{"packet 2", "list kFingerC2I of 0", "end of list", "end of packet"}));
}

ByteBuffer message(const PropertyList& object) {
    return *serializeBinary(object);
}

TEST(Samples, OfAnObjectStreamAreThePathsOfTheDisplay) {
    TechnologyDriver ifx("IFX");
    const Dictionary cell{{"ARFCN", "62"}, {"Rx Level", Dictionary{{"Value", "-96.0 dBm"}}}};
    EXPECT_EQ(ifx.samplesOf(message(Dictionary{
                  {"Serving Cell", cell},
                  {"Neighbour Cells", Array{"header", cell, "none"}},
                  {"Quality", "50%"},
                  {"PLMN", "001 01"},
              })),
              (Events{"packet 1", "0 /Serving Cell/ARFCN: 62 (number 62.00)",
                      "1 /Serving Cell/Rx Level: -96.0 dBm (number -96.00 in dBm)",
                      "list /Neighbour Cells of 2", "entry 0",
                      "3 /Neighbour Cells/*/ARFCN: 62 (number 62.00)",
                      "4 /Neighbour Cells/*/Rx Level: -96.0 dBm (number -96.00 in dBm)", "end",
                      "entry 1", "5 /Neighbour Cells/*: none", "end", "end of list",
                      "6 /Quality: 50% (number 50.00 in %)", "7 /PLMN: 001 01", "end of packet"}));
}

TEST(Samples, OfAnObjectStreamNameThePathsThatAreGoneAndEmptiedLists) {
    TechnologyDriver ifx("IFX");
    (void)ifx.samplesOf(message(Dictionary{
        {"A", "1"}, {"List", Array{"header", "x"}}, {"B", Dictionary{{"C", "2"}, {"D", "3"}}}}));
    EXPECT_EQ(ifx.samplesOf(message(Dictionary{{"A", "1"}, {"List", Array{"header"}}})),
              (Events{"packet 2", "0 /A: 1 (number 1.00)", "list /List of 0", "end of list",
                      "removed /B/C", "removed /B/D", "end of packet"}));
    EXPECT_EQ(ifx.samplesOf(message(Dictionary{{"A", "text"}})),
              (Events{"packet 3", "0 /A: text", "removed /List", "end of packet"}));
}

TEST(Samples, OfTextsOfAnObjectStreamHaveANumberWhereTheyAreOne) {
    TechnologyDriver ifx("IFX");
    const auto sampleOf = [&ifx](const char* text) {
        return ifx.samplesOf(message(Dictionary{{"A", text}})).at(1);
    };
    EXPECT_EQ(sampleOf("62"), "0 /A: 62 (number 62.00)");
    EXPECT_EQ(sampleOf("+1.5 dB"), "0 /A: +1.5 dB (number 1.50 in dB)");
    EXPECT_EQ(sampleOf("-3 km/h"), "0 /A: -3 km/h (number -3.00 in km/h)");
    EXPECT_EQ(sampleOf("7%"), "0 /A: 7% (number 7.00 in %)");
    for (const char* text :
         {"", "-", "dBm", "nan", "inf dB", "- 5", "3 of 8", "12:30", "1,5", "0x1F", "1e5 ", "5 ",
          "5  dB", "310 260", "5dB", "62 (hopping)", "-96.0 -97.0"}) {
        EXPECT_EQ(sampleOf(text), std::string("0 /A: ") + text);
    }
}

TEST(Samples, PathsBeyondTheMostAreLeftOut) {
    TechnologyDriver ifx("IFX");
    Dictionary many;
    for (int number = 0; number < 5000; ++number) {
        many.set(std::to_string(number), "1");
    }
    constexpr std::size_t kBeginAndEnd = 2;
    EXPECT_EQ(ifx.samplesOf(message(many)).size(), 4096 + kBeginAndEnd);
    EXPECT_EQ(ifx.samplesOf(message(Dictionary{{"0", "2"}, {"another", "1"}}))[1],
              "0 /0: 2 (number 2.00)");
}

TEST(Samples, APacketEndsAlsoWhereARecordThrows) {
    TechnologyDriver gsm("Zorell_GSM");
    gsm.driver.addSampleSink(gsm.recorder);
    EXPECT_THROW(gsm.update(Record(kSimFilesLogCode).u8(1).bytes()), std::exception);
    EXPECT_EQ(gsm.recorder.takeLines(), (Events{"packet 1", "section SIM Info", "end of packet"}));
}

TEST(Samples, OfARecordThatIsTooShortAreNone) {
    TechnologyDriver lte("Zorell_LTE");
    EXPECT_EQ(lte.samplesOf(Record(0xB0C2).padTo(37)), (Events{"packet 1", "end of packet"}));
    TechnologyDriver cdma("Zorell_CDMA");
    EXPECT_EQ(cdma.samplesOf(Record(0x108A).padTo(22)), (Events{"packet 1", "end of packet"}));
}

/// All that decoding a recording does, without the addresses.
struct Decoded {
    Events log;
    std::string saved;
    std::size_t failures = 0;
};

std::string withoutAddresses(const std::string& line) {
    const std::size_t address = line.find("0x");
    return address == std::string::npos ? line : line.substr(0, address);
}

Decoded decode(const std::string& path, const std::vector<SampleSink*>& sinks) {
    const auto recording = Recording::open(path);
    EXPECT_TRUE(recording) << path;
    RecordingLog log;
    TechnologyDriver technology((*recording)->technology()->identifier);
    for (SampleSink* sink : sinks) {
        technology.driver.addSampleSink(*sink);
    }
    Decoded decoded;
    for (std::size_t number = 1; const auto packet = (*recording)->next(); ++number) {
        technology.clock().set(packet->time);
        try {
            technology.driver.update(packet->data, {number, packet->time});
        } catch (const std::exception&) {
            ++decoded.failures;
        }
        constexpr std::size_t kPacketsOfATick = 97;
        if (number % kPacketsOfATick == 0) {
            (void)technology.driver.generate();
        }
    }
    (void)technology.driver.generate();
    decoded.saved = technology.driver.saveContents().description();
    for (const RecordingLog::Line& line : log.take()) {
        decoded.log.push_back(std::to_string(line.priority) + withoutAddresses(line.text));
    }
    return decoded;
}

TEST(Samples, AnyNumberOfSinksChangesNeitherLogNorDisplay) {
    for (const char* name :
         {"cdma-drive", "gsm-attach", "ifx-stream", "lte-drive", "umts-drive", "utran-drive"}) {
        const std::string path = std::string(PALLAX_SOURCE_DIR "/samples/") + name + ".pcap";
        const Decoded without = decode(path, {});
        doubles::SampleRecorder alone;
        doubles::SampleRecorder first;
        doubles::SampleRecorder second;
        for (const Decoded& with : {decode(path, {&alone}), decode(path, {&first, &second})}) {
            EXPECT_EQ(with.log, without.log) << name;
            EXPECT_EQ(with.saved, without.saved) << name;
            EXPECT_EQ(with.failures, without.failures) << name;
        }
        const Events samples = alone.takeLines();
        EXPECT_GT(samples.size(), 100U) << name;
        EXPECT_EQ(first.takeLines(), samples) << name;
        EXPECT_EQ(second.takeLines(), samples) << name;
    }
}

} // namespace
} // namespace pallax
