#include "tests/simulator/Drives.h"

// Checks that drives are plausible: values in range, smooth movements, sensible neighbours. LTE has
// its own test.

namespace pallax {
namespace {

using std::chrono::seconds;

/// Reports of a kind then come less than two scenario steps apart.
constexpr unsigned kPacketsPerSecond = 10;

/// The greatest change of a level in two scenario steps, with the noise of two measurements and the
/// rounding to whole decibels.
constexpr double kLevelStepDb = 6;
/// The same when a hill comes between the phone and its cells.
constexpr double kHillStepDb = 10;

TEST(Smoothness, GsmLevelsAreInRangeMoveSmoothlyAndNeighboursAreTheStrongest) {
    constexpr double kNoiseDb = 6; // the greatest noise of two measurements, rounded
    Curve serving("serving level", 35, 110, kLevelStepDb);
    Curve neighbour("neighbour level", 35, 110, kLevelStepDb);
    Curve cost("C1", 0, 70, kLevelStepDb);
    std::map<std::string, std::string> bsics;
    std::uint64_t seed = 0;
    inEveryDrive({"gsm", seconds(60), kPacketsPerSecond}, [&](const DriveMoment& moment) {
        if (moment.seed != seed) {
            bsics.clear();
            seed = moment.seed;
        }
        if (moment.code != 0x5137) {
            return;
        }
        const DecodedDisplay& decoded = moment.decoded;
        const std::string cell = decoded.text("GSM Serving Cell", "ARFCN");
        serving.see(moment, cell, decoded.text("GSM Serving Cell", "RSSI"));
        cost.see(moment, cell, decoded.text("GSM Serving Cell", "C1 Value"));
        const auto channels = decoded.texts("Neighboring Cells", "ARFCN");
        auto levels = decoded.texts("Neighboring Cells", "RSSI");
        const auto codes = decoded.texts("Neighboring Cells", "BSIC");
        for (std::size_t index = 0; index < channels.size(); ++index) {
            neighbour.see(moment, channels[index], levels[index]);
            levels[index].insert(0, "-"); // shown without its sign
            if (codes[index] != "(absent)") {
                EXPECT_EQ(bsics.emplace(channels[index], codes[index]).first->second, codes[index])
                    << "a cell changes its code";
            }
        }
        expectStrongestFirst(levels, kNoiseDb);
    });
    EXPECT_GT(serving.compared(), PALLAX_DRIVES);
    EXPECT_GT(neighbour.compared(), PALLAX_DRIVES);
}

TEST(Smoothness, UmtsLevelsAndPowersAreInRangeAndMoveSmoothly) {
    Curve level("RSCP", -125, -30, kHillStepDb);
    Curve quality("Ec/No", -22, -1, kLevelStepDb);
    Curve power("transmit power", -50, 23, kHillStepDb);
    inEveryDrive({"gsm", seconds(60), kPacketsPerSecond}, [&](const DriveMoment& moment) {
        const DecodedDisplay& decoded = moment.decoded;
        if (moment.code == 0x417A) {
            const auto codes = decoded.texts("Active Set", "Scrambling Code");
            const auto levels = decoded.texts("Active Set", "RSCP");
            const auto qualities = decoded.texts("Active Set", "Energy Per Chip");
            for (std::size_t index = 0; index < codes.size(); ++index) {
                level.see(moment, codes[index], levels[index]);
                quality.see(moment, codes[index], qualities[index]);
            }
        } else if (moment.code == 0x4031) {
            power.see(moment, decoded.text("UMTS RR Info", "Cell ID"),
                      decoded.text("UMTS RR Info", "Transmit Power"));
        }
    });
    EXPECT_GT(level.compared(), 100U * PALLAX_DRIVES);
    EXPECT_GT(power.compared(), 10U * PALLAX_DRIVES);
}

TEST(Smoothness, NoMoreUmtsBlocksAreLostThanSent) {
    inEveryDrive({"gsm", seconds(40), kPacketsPerSecond}, [&](const DriveMoment& moment) {
        const DecodedDisplay& decoded = moment.decoded;
        const auto expectNoMore = [](const PropertyList* list, const char* part,
                                     const char* whole) {
            if (list == nullptr) {
                return; // one carrier
            }
            for (const PropertyList& entry : *list->array()) {
                EXPECT_LE(numberOf(DecodedDisplay::textIn(entry, part)),
                          numberOf(DecodedDisplay::textIn(entry, whole)));
            }
        };
        if (moment.code == 0x4116) {
            const DictionaryRef blocks = decoded.section("BLER").dictionary();
            expectNoMore(blocks->find("Transport Channels"), "CRC Received in Error",
                         "CRC Received");
        } else if (moment.code == 0x4221) {
            const DictionaryRef link = decoded.section("HSDPA Info").dictionary();
            expectNoMore(link->find("Primary HARQ Process"), "Block Errors", "New Tx");
            expectNoMore(link->find("Secondary HARQ Process"), "Block Errors", "New Tx");
        }
    });
}

TEST(Smoothness, UtranLevelsAndQualitiesAreInRangeAndMoveSmoothly) {
    constexpr double kStepOfTheRecord = 0.3 * 256; // the decibels of one unit in the record
    constexpr double kNoise = 6 / kStepOfTheRecord;
    Curve level("RSCP", 0.01, 1, kLevelStepDb / kStepOfTheRecord);
    Curve errors("block errors", 0, 60, 18);
    Curve ratio("signal to interference", 0, 63, 15);
    inEveryDrive({"utran", seconds(30), kPacketsPerSecond}, [&](const DriveMoment& moment) {
        const DecodedDisplay& decoded = moment.decoded;
        const std::string serving = decoded.text("Serving Cell Info", "Cell ID");
        if (moment.code == 0xD00A) {
            const auto cells = decoded.texts("Neighbor Cell List", "Cell ID");
            auto levels = decoded.texts("Neighbor Cell List", "Filter RSCP");
            for (std::size_t index = 0; index < cells.size(); ++index) {
                level.see(moment, cells[index], levels[index]);
            }
            levels.erase(levels.begin()); // the serving cell, which others may just have passed
            expectStrongestFirst(levels, kNoise);
        } else if (moment.code == 0xD00C) {
            for (const std::string& each : decoded.texts("TRCH BLER", "TRCH BLER Measurement")) {
                errors.see(moment, serving, each);
            }
            for (const PropertyList& channel : *decoded.section("CCTRCH SIR").array()) {
                for (const PropertyList& each : *channel.dictionary()->find("SIR")->array()) {
                    ratio.see(moment, serving, std::string(each.string().value_or("")));
                }
            }
        }
    });
    EXPECT_GT(level.compared(), 100U * PALLAX_DRIVES);
    EXPECT_GT(ratio.compared(), 10U * PALLAX_DRIVES);
}

/// Adds each pilot of a list whose keys have the form "0;168".
void seePilots(Curve& curve, const DriveMoment& moment, const PropertyList& list) {
    for (const Dictionary::Entry& entry : *list.dictionary()) {
        const std::string key(entry.key.view());
        const auto separator = key.find(';');
        if (separator == std::string::npos) {
            continue; // "_sorted"
        }
        std::string part = entry.value.string().value_or("");
        constexpr std::string_view kReference = "(ref pilot) ";
        part.erase(0, part.starts_with(kReference) ? kReference.size() : 0);
        curve.see(moment, key.substr(separator), part);
    }
}

TEST(Smoothness, CdmaLevelsAndPilotsAreInRangeAndMoveSmoothly) {
    Curve receive("receive level", -106, -25, kLevelStepDb);
    Curve transmit("transmit level", -50, 23, kLevelStepDb);
    Curve pilots("Ec/Io", -15.1, -0.4, kLevelStepDb);
    Curve evdoReceive("EV-DO receive level", -106, -25, kLevelStepDb);
    Curve evdoTransmit("EV-DO transmit level", -50, 23, kLevelStepDb);
    Curve evdoPilots("EV-DO Ec/Io", -15.1, -0.4, kLevelStepDb);
    inEveryDrive({"cdma", seconds(30), 2 * kPacketsPerSecond}, [&](const DriveMoment& moment) {
        const DecodedDisplay& decoded = moment.decoded;
        const auto seeShown = [&](Curve& curve, const std::string& shown) {
            if (shown != "N/A" && shown != "(absent)") {
                curve.see(moment, "the carrier", shown);
            }
        };
        if (moment.code == 0x119C) {
            const DictionaryRef oneX = decoded.section("1x").dictionary();
            seeShown(receive, DecodedDisplay::textIn(*oneX->find("Receiver 0"), "AGC"));
            seeShown(transmit, decoded.text("1x", "Transmit AGC"));
            seePilots(pilots, moment, *oneX->find("Active Set"));
        } else if (moment.code == 0x1183) {
            seeShown(evdoReceive, decoded.text("EV-DO", "Receive AGC 0"));
            seeShown(evdoTransmit, decoded.text("EV-DO", "Transmit AGC"));
        } else if (moment.code == 0x12B6) {
            seePilots(evdoPilots, moment,
                      *decoded.section("EV-DO").dictionary()->find("Active Set"));
        }
    });
    for (const Curve* curve :
         {&receive, &transmit, &pilots, &evdoReceive, &evdoTransmit, &evdoPilots}) {
        EXPECT_GT(curve->compared(), 10U * PALLAX_DRIVES);
    }
}

TEST(Smoothness, CdmaDataRatesAreThoseOfALink) {
    Curve forward("forward rate", 0, 2458, 2458); // kbit/s, the greatest rate
    Curve reverse("reverse rate", 0, 1800, 1800);
    inEveryDrive({"cdma", seconds(60), kPacketsPerSecond}, [&](const DriveMoment& moment) {
        if (moment.code == 0x1192) {
            forward.see(moment, "", moment.decoded.text("Data Rates", "Forward Link"));
        } else if (moment.code == 0x127E) {
            reverse.see(moment, "", moment.decoded.text("Data Rates", "Reverse Link"));
        }
    });
    EXPECT_GT(forward.seen(), 10U * PALLAX_DRIVES);
    EXPECT_GT(reverse.seen(), 10U * PALLAX_DRIVES);
}

TEST(Smoothness, IfxLevelsAreInRangeMoveSmoothlyAndNeighboursAreTheStrongest) {
    constexpr double kNoiseDb = 5.2; // the greatest noise of two measurements, rounded
    Curve serving("serving level", -110, -35, kLevelStepDb);
    Curve cost("C1", -5, 70, kLevelStepDb);
    Curve neighbour("neighbour level", -110, -35, kLevelStepDb);
    Curve power("transmit power", 5, 33, kLevelStepDb);
    Curve quality("quality", 0, 7, 5);
    Curve advance("timing advance", 0, 4, 1);
    std::map<std::string, std::string> bsics;
    std::uint64_t seed = 0;
    inEveryDrive({"ifx", seconds(20), kPacketsPerSecond / 2}, [&](const DriveMoment& moment) {
        if (moment.seed != seed) {
            bsics.clear();
            seed = moment.seed;
        }
        const DecodedDisplay& decoded = moment.decoded;
        const auto expectSameCode = [&](const std::string& channel, const std::string& code) {
            EXPECT_EQ(bsics.emplace(channel, code).first->second, code);
        };
        const std::string cell = decoded.text("Serving Cell", "ARFCN");
        expectSameCode(cell, decoded.text("Serving Cell", "BSIC"));
        serving.see(moment, cell, decoded.text("Serving Cell", "Rx Level"));
        cost.see(moment, cell, decoded.text("Serving Cell", "C1"));
        std::vector<std::string> levels;
        for (const PropertyList& each : *decoded.section("Neighbour Cells").array()) {
            if (each.dictionary() == nullptr) {
                continue; // a weak one has only a channel
            }
            levels.push_back(DecodedDisplay::textIn(each, "Rx Level"));
            const std::string channel = DecodedDisplay::textIn(each, "ARFCN");
            neighbour.see(moment, channel, levels.back());
            expectSameCode(channel, DecodedDisplay::textIn(each, "BSIC"));
        }
        expectStrongestFirst(levels, kNoiseDb);
        if (decoded.text("Dedicated Channel", "Tx Power") != "(absent)") {
            power.see(moment, cell, decoded.text("Dedicated Channel", "Tx Power"));
            quality.see(moment, cell, decoded.text("Dedicated Channel", "Rx Quality"));
            advance.see(moment, cell, decoded.text("Dedicated Channel", "Timing Advance"));
        }
    });
    EXPECT_GT(neighbour.compared(), 100U * PALLAX_DRIVES);
    EXPECT_GT(power.compared(), 10U * PALLAX_DRIVES);
}

} // namespace
} // namespace pallax
