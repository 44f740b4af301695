#include "masking/PacketMask.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "masking/ListMask.h"
#include "monitor/DisplayDriver.h"
#include "plist/PropertyListCodec.h"
#include "samples/Samples.h"
#include "simulator/Simulation.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/PropertyListRecord.h"
#include "tests/doubles/TextPropertyList.h"
#include "tests/masking/MaskFixture.h"

#include <exception>

namespace pallax {
namespace {

using doubles::Record;
namespace any = doubles::any;

constexpr LogCode kContexts = 0xFF0002;
constexpr LogCode kEvdoStatus = 0x1183;

TEST(PacketMask, ZeroesTheIdentifierOfEvdoAndNothingElse) {
    ByteBuffer packet(50, 0x5A);
    packet[0] = 1;
    packet[3] = 0x83;
    packet[4] = 0x11;
    ByteBuffer expected = packet;
    expected[38] = expected[39] = expected[40] = 0;

    const MaskedPacket result = masked("cdma", packet);

    EXPECT_EQ(result.bytes, expected);
    EXPECT_EQ(result.report.text(false), "1 packet, 1 value masked");
    EXPECT_EQ(masked("cdma", packet, {.keep = {"uati24"}}).bytes, packet);
}

TEST(PacketMask, WorksBehindTheTransportPrefix) {
    ByteBuffer packet(52, 0x5A);
    packet[0] = 0x81;
    packet[2] = 1;
    packet[5] = 0x83;
    packet[6] = 0x11;
    ByteBuffer expected = packet;
    expected[40] = expected[41] = expected[42] = 0;
    EXPECT_EQ(masked("cdma", packet).bytes, expected);
}

TEST(PacketMask, MasksTheFilesOfASimInXml) {
    const auto record = [](std::string_view list) {
        return doubles::textRecord(kSimFiles, list).bytes();
    };
    const MaskedPacket result =
        masked("gsm", record(R"(<plist version="1.0"><!-- +4915112345678 --><dict>
<key>kSimFile_ICCID</key><string>8949&#48;20000012345678</string>
<key>kSimFile_LOCI</key><data>AQID
BAU=</data>
<key>kSimFile_HPPLMN</key><data>AQID</data>
<key>kSimFile_IMSI</key><integer>262011234567890</integer>
</dict></plist>)"));
    EXPECT_EQ(textOfBytes(result.bytes),
              textOfBytes(record(R"(<plist version="1.0"><!--                --><dict>
<key>kSimFile_ICCID</key><string>00000000000000000000000</string>
<key>kSimFile_LOCI</key><data>AAAA
AAA=</data>
<key>kSimFile_HPPLMN</key><data>AQID</data>
<key>kSimFile_IMSI</key><integer>000000000000000</integer>
</dict></plist>)")));
    EXPECT_EQ(result.report.values, 3U);
}

TEST(PacketMask, MasksTheFilesOfASimInTheTextForm) {
    const auto record = [](std::string_view list) {
        return doubles::textRecord(kSimFiles, list).bytes();
    };
    EXPECT_EQ(textOfBytes(masked("lte", record("{kSimFile_ICCID = 894902; /* x */ "
                                               "\"kSimFile_MSISDN\" = \"+49\\\"1\"; "
                                               "kSimFile_PSLOCI = <01 02ff>; "
                                               "kSimFile_AD = <01>;}"))
                              .bytes),
              textOfBytes(record("{kSimFile_ICCID = 000000; /*   */ "
                                 "\"kSimFile_MSISDN\" = \"000000\"; "
                                 "kSimFile_PSLOCI = <00 0000>; "
                                 "kSimFile_AD = <01>;}")));
}

TEST(PacketMask, MasksTheFilesOfASimInBinaryFormInPlace) {
    const ByteBuffer packet =
        doubles::propertyListRecord(kSimFiles,
                                    Dictionary{{"kSimFile_ICCID", "89490200000123456789"},
                                               {"kSimFile_MSISDN", "\u00fcber"}, // in UTF-16
                                               {"kSimFile_LOCI", PropertyList::data({1, 2, 3})},
                                               {"kSimFile_FPLMN", PropertyList::data({4, 5, 6})}})
            .bytes();
    const MaskedPacket result = masked("utran", packet);
    ASSERT_EQ(result.bytes.size(), packet.size());
    const auto list = LogRecord(result.bytes).payloadAsPropertyList();
    ASSERT_TRUE(list);
    EXPECT_EQ(*list, (Dictionary{{"kSimFile_ICCID", "00000000000000000000"},
                                 {"kSimFile_MSISDN", "0000"},
                                 {"kSimFile_LOCI", PropertyList::data({0, 0, 0})},
                                 {"kSimFile_FPLMN", PropertyList::data({4, 5, 6})}}));
}

TEST(PacketMask, AValueThatSharesItsBytesWithAnotherChangesAlone) {
    const ByteBuffer packet =
        doubles::propertyListRecord(kSimFiles,
                                    Dictionary{{"kSimFile_ACC", PropertyList::data({1, 2})},
                                               {"kSimFile_AD", PropertyList::data({1, 2})}})
            .bytes();
    const auto list = LogRecord(masked("gsm", packet).bytes).payloadAsPropertyList();
    ASSERT_TRUE(list);
    EXPECT_EQ(*list, (Dictionary{{"kSimFile_ACC", PropertyList::data({0, 0})},
                                 {"kSimFile_AD", PropertyList::data({1, 2})}}));
}

TEST(PacketMask, MasksEveryValueOfAContext) {
    const ByteBuffer packet =
        doubles::propertyListRecord(
            kContexts, Array{Dictionary{{"Address", "10.20.30.40"}, {"APN", "internet"}}, "x"})
            .bytes();
    const auto list = LogRecord(masked("gsm", packet).bytes).payloadAsPropertyList();
    ASSERT_TRUE(list);
    EXPECT_EQ(*list, (PropertyList(
                         Array{Dictionary{{"Address", "00000000000"}, {"APN", "00000000"}}, "0"})));
}

TEST(PacketMask, MasksWhatAnObjectStreamCallsAnIdentityAndWhatLooksLikeOne) {
    const auto packet =
        bytesOfText("{ \"Subscriber\" = (x, { IMSI = 26201; }); Cell = { ARFCN = 17; }; "
                    "Note = \"IMSI 262011234567890 seen\"; }");
    const MaskedPacket result = masked("ifx", packet);
    EXPECT_EQ(textOfBytes(result.bytes),
              "{ \"Subscriber\" = (0, { IMSI = 00000; }); Cell = { ARFCN = 17; }; "
              "Note = \"0000000000000000000000000\"; }");
}

TEST(PacketMask, WhatCannotBeUnderstoodBecomesZerosButForItsHeader) {
    const ByteBuffer unknown = Record(0xABCD).append({1, 2, 3}).bytes();
    ByteBuffer expected = unknown;
    std::fill(expected.end() - 3, expected.end(), std::uint8_t{0});
    const MaskedPacket result = masked("lte", unknown);
    EXPECT_EQ(result.bytes, expected);
    EXPECT_EQ(result.report.text(false),
              "1 packet, 0 values masked; 1 packet that cannot be understood zeroed");

    const MaskedPacket kept = masked("lte", unknown, {.keepUnknown = true});
    EXPECT_EQ(kept.bytes, unknown);
    EXPECT_EQ(kept.report.text(true),
              "1 packet, 0 values masked; 1 packet that cannot be understood kept");
}

TEST(PacketMask, RecordsOfAnotherLengthAndBrokenListsAreNotUnderstood) {
    const ByteBuffer tooShort = Record(kEvdoStatus).append({9, 9, 9}).bytes();
    const MaskedPacket shortResult = masked("cdma", tooShort);
    EXPECT_EQ(shortResult.report.unknownPackets, 1U);
    EXPECT_EQ(shortResult.bytes.back(), 0);

    const MaskedPacket broken =
        masked("gsm", doubles::textRecord(kSimFiles, "{ICCID = 8949").bytes());
    EXPECT_EQ(broken.report.unknownPackets, 1U);
    EXPECT_EQ(textOfBytes(Bytes(broken.bytes).subspan(13)), std::string(13, '\0'));

    EXPECT_EQ(masked("ifx", bytesOfText("{1234")).bytes, ByteBuffer(5, 0));
}

TEST(PacketMask, OtherFieldsAreMaskedOnRequestAlsoInLists) {
    const MaskChoice also{.also = {"lte.neighbor_cells_list.physical_cell_id"}};
    const MaskPlan plan = planFor("lte", also);
    const Replacements replacements{Replacement(), keyed(7)};
    std::uint64_t values = 0;
    for (const TimedPacket& packet : lteDrivePackets()) {
        MaskReport report;
        ByteBuffer bytes = packet.data;
        PacketMask(plan, replacements).mask(bytes, report);
        EXPECT_EQ(bytes.size(), packet.data.size());
        values += report.values;
    }
    EXPECT_GT(values, 100U);
}

TEST(PacketMask, TheSameValueHasTheSamePseudonymInEveryForm) {
    const std::string number = "89490200000123456789";
    const auto iccidOf = [](const ByteBuffer& packet) {
        const auto list = LogRecord(packet).payloadAsPropertyList();
        return *list->dictionary()->find("kSimFile_ICCID")->string();
    };
    const auto pseudonym = [&](const ByteBuffer& packet, std::string_view technology,
                               std::uint8_t seed) {
        return iccidOf(masked(technology, packet, {}, keyed(seed)).bytes);
    };
    const ByteBuffer binary =
        doubles::propertyListRecord(kSimFiles, Dictionary{{"kSimFile_ICCID", number}}).bytes();
    const ByteBuffer text =
        doubles::textRecord(kSimFiles, "{kSimFile_ICCID = " + number + ";}").bytes();
    const ByteBuffer xml =
        doubles::textRecord(kSimFiles, "<plist><dict><key>kSimFile_ICCID</key><string>" + number +
                                           "</string></dict></plist>")
            .bytes();
    const std::string first = pseudonym(binary, "gsm", 1);
    EXPECT_EQ(first.size(), number.size());
    EXPECT_EQ(first.find_first_not_of("abcdefghijklmnop"), std::string::npos);
    EXPECT_EQ(pseudonym(text, "lte", 1), first);
    EXPECT_EQ(pseudonym(xml, "utran", 1), first);
    EXPECT_NE(pseudonym(binary, "gsm", 2), first);
}

// ---- what is decoded of masked packets

/// Decodes packet by packet.
class Decoding {
public:
    explicit Decoding(std::string_view technology) {
        _driver.setGenerator(LogGenerator::generatorFromTechnology(
            Text(technologyOfCommandName(technology)->identifier), technologies(),
            {_clock, _resources, _bundle, _notices}));
    }

    /// The display after the packet, or why it could not be read.
    PropertyList after(Bytes packet) {
        try {
            _driver.update(packet);
        } catch (const std::exception& error) {
            return error.what();
        }
        return _driver.generate();
    }

private:
    doubles::ManualClock _clock;
    DirectoryResources _resources{PALLAX_SOURCE_DIR "/resources"};
    doubles::FakeBundle _bundle;
    doubles::FakeStandardOutput _notices;
    DisplayDriver _driver;
};

/// The paths of leaves that differ, or whose containers have another shape.
void compare(const PropertyList& a, const PropertyList& b, ScalarPath& path,
             const std::function<void(const ScalarPath&, const PropertyList&)>& differs) {
    if (a == b) {
        return;
    }
    const DictionaryRef entries = a.dictionary();
    const DictionaryRef others = b.dictionary();
    const ArrayRef elements = a.array();
    const ArrayRef otherElements = b.array();
    if (entries != nullptr && others != nullptr && entries->size() == others->size()) {
        auto other = others->begin();
        for (const Dictionary::Entry& entry : *entries) {
            path.push_back(entry.key.string());
            entry.key == other->key ? compare(entry.value, other->value, path, differs)
                                    : differs(path, entry.value);
            path.pop_back();
            ++other;
        }
    } else if (elements != nullptr && otherElements != nullptr &&
               elements->size() == otherElements->size()) {
        path.emplace_back(kAnyElement);
        for (std::size_t index = 0; index < elements->size(); ++index) {
            compare((*elements)[index], (*otherElements)[index], path, differs);
        }
        path.pop_back();
    } else {
        differs(path, a);
    }
}

/// A property list of any kind of values that a telephony service might send.
PropertyList anyValue(int depth) {
    switch (any::between(0, depth > 0 ? 6 : 4)) {
    case 0:
        return any::textOf("0123456789+ .x");
    case 1:
        return PropertyList::data(any::bytes());
    case 2:
        return PropertyList::integer(any::integer());
    case 3:
        return PropertyList::boolean(any::boolean());
    case 4: {
        Array elements;
        for (unsigned count = any::below(4); count > 0; --count) {
            elements.push_back(anyValue(depth - 1));
        }
        return elements;
    }
    default: {
        Dictionary entries;
        for (unsigned count = any::below(4); count > 0; --count) {
            entries.set(any::textOf("abcIMS"), anyValue(depth - 1));
        }
        return entries;
    }
    }
}

ByteBuffer anyListRecord() {
    constexpr auto kFiles = std::to_array<const char*>(
        {"kSimFile_ICCID", "kSimFile_MSISDN", "kSimFile_LOCI", "kSimFile_AD", "kSimFile_PNN",
         "kSimFile_IMSI", "kSimFile_ACC", "other"});
    Dictionary files;
    for (unsigned count = any::below(6); count > 0; --count) {
        files.set(any::elementOf(kFiles), anyValue(2));
    }
    const bool isSim = any::boolean();
    const PropertyList list =
        isSim ? PropertyList(files) : PropertyList(Array{anyValue(2), anyValue(2)});
    const LogCode code = isSim ? kSimFiles : kContexts;
    if (any::boolean()) {
        return doubles::propertyListRecord(code, list).bytes();
    }
    const auto xml = serializeXml(list);
    return xml ? doubles::textRecord(code, *xml).bytes() : Record(code).bytes();
}

/// A message that an object stream might send, in any form.
ByteBuffer anyMessage() {
    constexpr auto kKeys = std::to_array<const char*>({"IMSI", "P-TMSI", "RR", "Note", "Cell"});
    Dictionary entries;
    for (unsigned count = any::below(6); count > 0; --count) {
        const PropertyList text = any::textOf("0123456789+x");
        entries.set(any::elementOf(kKeys),
                    any::boolean() ? text : PropertyList(Dictionary{{"Value", text}, {"x", text}}));
    }
    if (any::boolean()) {
        return bytesOfText(doubles::textForm(entries));
    }
    const auto bytes = serializeBinary(entries);
    return *bytes;
}

/// A packet of a drive, as it is or cut, or with other bytes in it; or a record of any list.
ByteBuffer anyPacket(const std::vector<ByteBuffer>& drive, bool areObjects) {
    const int kind = any::between(0, 8);
    if (kind == 0) {
        return any::bytes();
    }
    if (kind <= 2) {
        return areObjects ? anyMessage() : anyListRecord();
    }
    ByteBuffer packet = any::elementOf(drive);
    if (kind == 3) {
        packet.resize(any::index(packet.size() + 1));
    }
    if (kind == 4) {
        for (unsigned count = any::below(8); count > 0 && !packet.empty(); --count) {
            packet[any::index(packet.size())] = any::byte();
        }
    }
    return packet;
}

class PacketMaskProperty : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(Technologies, PacketMaskProperty,
                         testing::Values("ifx", "gsm", "cdma", "lte", "utran"));

TEST_P(PacketMaskProperty, OnlyMaskedFieldsDecodeOtherwise) {
    const std::string technology = GetParam();
    const bool areObjects = technology == "ifx";
    std::vector<ByteBuffer> drive;
    Simulation simulation({.technology = technologyOfCommandName(technology),
                           .seed = 3,
                           .duration = std::chrono::seconds(30)});
    while (const auto packet = simulation.next()) {
        drive.emplace_back(packet->data.begin(), packet->data.end());
    }
    const MaskPlan plan = planFor(technology);
    const auto mayDiffer = [&](const ScalarPath& path, const PropertyList& value) {
        return plan.ofDisplay(path) == MaskAction::Mask ||
               (areObjects && ofLooseValue(path, value) == MaskAction::Mask);
    };
    std::uint64_t values = 0;
    EXPECT_TRUE(doubles::holds([&] {
        const Replacements replacements{any::boolean() ? keyed(1) : Replacement(), keyed(2)};
        Decoding original(technology);
        Decoding other(technology);
        for (unsigned count = 20; count > 0; --count) {
            const ByteBuffer packet = anyPacket(drive, areObjects);
            ByteBuffer result = packet;
            MaskReport report;
            PacketMask(plan, replacements).mask(result, report);
            values += report.values;
            ScalarPath path;
            compare(original.after(packet), other.after(result), path,
                    [&](const ScalarPath& different, const PropertyList& value) {
                        if (!mayDiffer(different, value)) {
                            std::string text;
                            for (const std::string& key : different) {
                                text += "/" + key;
                            }
                            RC_FAIL(text + " differs");
                        }
                    });
        }
    }));
    EXPECT_GT(values, 0U);
}

} // namespace
} // namespace pallax
