#include "host/Recording.h"
#include "simulator/SimulatedRecording.h"
#include "tests/reference/DissectedLists.h"

#include <gtest/gtest.h>

#include <limits>

// Compares the protocol analyser with the dissector to the output of `pallax decode` after each
// packet, for packets that are property lists.

namespace pallax {
namespace {

using doubles::Compared;
using doubles::compareRecording;

class DissectorLists : public DissectedLists {};

/// Values that are not cells, cells that do not match, and cells with missing keys.
Array strangeCells() {
    Array all = cells("text");
    for (const PropertyList& element : cells(PropertyList::integer(5))) {
        all.push_back(element);
    }
    (void)all.front().dictionary()->remove(kHXCellMonitorCellType);
    all[1].dictionary()->setFixed(kHXCellMonitorCellType, PropertyList::integer(1));
    all[2].dictionary()->setFixed(kHXCellMonitorCellRadioAccessTechnology, Array());
    (void)all.back().dictionary()->remove(kHXCellMonitorLAC);
    all.insert(all.begin() + 3,
               {"no cell", Array{"nor this"}, Dictionary(), PropertyList::boolean(true)});
    return all;
}

/// Numbers that fit into 32 bits, and some that do not.
std::vector<PropertyList> numbers() {
    std::vector<PropertyList> all;
    for (const std::int64_t number :
         {std::int64_t{0}, std::int64_t{-1}, std::int64_t{32767}, std::int64_t{-32768},
          std::int64_t{32768}, std::int64_t{65535}, std::int64_t{98303}, std::int64_t{255},
          std::int64_t{256}, std::int64_t{2147483647}, std::int64_t{2147483648},
          std::int64_t{-2147483648}, std::int64_t{-2147483649},
          std::numeric_limits<std::int64_t>::max(), std::numeric_limits<std::int64_t>::min()}) {
        all.push_back(PropertyList::integer(number));
    }
    all.push_back(PropertyList::unsignedInteger(9223372036854775808U));
    all.push_back(PropertyList::unsignedInteger(18446744073709551615U));
    for (const double number :
         {12.0, -7.0, 12.5, 2147483647.0, 2147483648.0, 1e300, -0.0,
          std::numeric_limits<double>::quiet_NaN(), std::numeric_limits<double>::infinity()}) {
        all.push_back(PropertyList::real(number));
    }
    all.push_back(PropertyList::boolean(true));
    all.push_back(PropertyList::data({1, 2}));
    return all;
}

/// These values in all SIM files, in as many dictionaries as necessary.
std::vector<Dictionary> simFilesOf(const std::vector<PropertyList>& values) {
    std::vector<Dictionary> all;
    for (std::size_t index = 0; index < values.size(); ++index) {
        const std::size_t file = index % kSimFiles.size();
        if (file == 0) {
            all.emplace_back();
        }
        all.back().set(kSimFiles.at(file), values[index]);
    }
    return all;
}

std::vector<PropertyList> valuesOfEveryType() {
    std::vector<PropertyList> all = numbers();
    for (const double number : {0.1, 100000.0, 123456.0, 1e21, 123456789012345680000.0, 5e-324,
                                1.7976931348623157e308, 0.0001, 0.00001, 1.5e-7, 3.0}) {
        all.push_back(PropertyList::real(number));
    }
    for (const char* text : {"", "a & b < c > \"d\" 'e'", "Z\xC3\xBCrich", "\xE2\x82\xAC",
                             "\xF0\x9F\x98\x80", "two\nlines\ttab", "true", "  blanks  "}) {
        all.emplace_back(text);
    }
    for (std::size_t length = 0; length < 7; ++length) {
        all.push_back(PropertyList::data(ByteBuffer(length, 0xFB)));
    }
    for (const std::int64_t seconds :
         {std::int64_t{0}, std::int64_t{1700000000}, std::int64_t{951782399},
          std::int64_t{951868800}, std::int64_t{-62167219200}, std::int64_t{253402300799}}) {
        all.emplace_back(Date(std::chrono::seconds(seconds)));
    }
    all.emplace_back(Array{"one", Array{"two", Array()}, Dictionary{{"key", "three"}}});
    all.emplace_back(Dictionary{{"outer", Dictionary{{"inner", Array{"x"}}}}, {"other", "y"}});
    return all;
}

TEST_F(DissectorLists, ShowsSimulatedDrivesAsTheyAreDecoded) {
    for (const char* name : {"gsm", "lte", "utran", "ifx"}) {
        SCOPED_TRACE(name);
        SimulationOptions options;
        options.technology = technologyOfCommandName(name);
        options.seed = 3;
        options.packetsPerSecond = 6;
        options.duration = std::chrono::minutes(3);
        const std::string path = _folder.path(std::string(name) + "-drive.pcap");
        ASSERT_EQ(writeSimulatedRecording(options, path), std::nullopt);
        const Compared compared = compareRecording(path, name);
        EXPECT_GT(compared.values, 2000U);
        EXPECT_EQ(compared.unread, 0U);
    }
}

TEST_F(DissectorLists, ShowsAnObjectStreamInEveryForm) {
    const Compared compared = compareRecording(PALLAX_SOURCE_DIR "/samples/ifx-stream.pcap", "ifx");
    EXPECT_GT(compared.values, 500U);
    EXPECT_EQ(compared.unread, 0U);
}

TEST_F(DissectorLists, ShowsTheNumbersOfCellsAsTheyAreDecoded) {
    Packets packets;
    for (const PropertyList& number : numbers()) {
        add(packets, kCellMonitorCode, cells(PropertyList::integer(77)));
        add(packets, kCellMonitorCode, cells(number));
    }
    add(packets, kCellMonitorCode, strangeCells());
    add(packets, kCellMonitorCode, Array());
    add(packets, kCellMonitorCode, Dictionary{{"no", "array"}});
    add(packets, kCellMonitorCode, "text");
    for (const char* name : {"gsm", "lte", "utran"}) {
        SCOPED_TRACE(name);
        const Compared compared = compare(name, packets);
        EXPECT_GT(compared.values, 200U);
        EXPECT_EQ(compared.unread, 0U);
    }
}

TEST_F(DissectorLists, OfSeveralServingCellsShowsTheOneThatStays) {
    Array several = cells(PropertyList::integer(1));
    for (const std::int64_t number : {2, 3}) {
        for (PropertyList& each : cells(PropertyList::integer(number))) {
            (void)each.dictionary()->remove(number == 3 ? kHXCellMonitorLAC : kHXCellMonitorSCN);
            several.push_back(each);
        }
    }
    Packets packets;
    add(packets, kCellMonitorCode, several);
    for (const char* name : {"gsm", "lte", "utran"}) {
        SCOPED_TRACE(name);
        EXPECT_GE(compare(name, packets).values, 10U);
    }
}

TEST_F(DissectorLists, ShowsSimFilesAndContextsOfEveryType) {
    const std::vector<PropertyList> values = valuesOfEveryType();
    Packets packets;
    for (const Dictionary& files : simFilesOf(values)) {
        add(packets, kSimFilesCode, files);
    }
    for (const PropertyList& value : values) {
        add(packets, kPdpContextsCode, Array{value, Dictionary{{"APN", value}, {"State", "-"}}});
    }
    add(packets, kPdpContextsCode, Dictionary{{"no", "array"}});
    add(packets, kSimFilesCode, Array{"no", "dictionary"});
    const Compared compared = compare("gsm", packets);
    EXPECT_GT(compared.values, 4 * values.size());
    EXPECT_EQ(compared.unread, 0U);
}

TEST_F(DissectorLists, WritesEveryValueAsDecodeDoes) {
    Packets packets;
    for (const Dictionary& files : simFilesOf(valuesOfEveryType())) {
        add(packets, kSimFilesCode, files);
    }
    const std::string recording = doubles::recordingOf(_folder, "lte", packets);
    const std::string decoded =
        doubles::runCommand(PALLAX_BINARY_DIR "/pallax decode --every packet " + recording).out;
    std::size_t found = 0;
    for (const doubles::AnalyserItem& packet : doubles::dissectedPackets(recording, "lte")) {
        const doubles::AnalyserItem* section = packet.find("SIM Info");
        ASSERT_NE(section, nullptr);
        for (const doubles::AnalyserItem& item : section->items) {
            const std::string key = "\"" + item.key() + "\":";
            const bool isText = item.value().find_first_of("\"\n\xEF") != std::string::npos;
            if (item.items.empty() && item.hasValue() && !isText) {
                ++found;
                EXPECT_TRUE(decoded.find(key + item.value()) != std::string::npos ||
                            decoded.find(key + "\"" + item.value() + "\"") != std::string::npos)
                    << item.label;
            }
        }
    }
    EXPECT_GT(found, 80U);
}

TEST_F(DissectorLists, ShowsObjectsAsTheyAreDecoded) {
    const PropertyList nested = Dictionary{{"a", Dictionary{{"b", Dictionary{{"c", "folds"}}}}},
                                           {"d", Array{"header", Dictionary{{"e", "f"}}, Array()}},
                                           {"g", Dictionary{}},
                                           {"h", Dictionary{{"i", Array{"only header"}}}},
                                           {"j", Dictionary{{"k", "l"}, {"m", "n"}}},
                                           {"Serving Cell", "a text"}};
    Packets packets;
    for (const PropertyList& object :
         {nested, PropertyList("text"), PropertyList(Array{"header", "x", nested}),
          PropertyList(Dictionary{{"single", nested}}), PropertyList(Dictionary{}),
          PropertyList(Array{})}) {
        packets.push_back(bytesOf(*serializeXml(object)));
        packets.push_back(*serializeBinary(object));
        packets.push_back(bytesOf(doubles::textForm(object)));
    }
    const std::size_t shown = packets.size();
    for (const PropertyList& other : valuesOfEveryType()) {
        const PropertyList object = Dictionary{{"a", "b"}, {"list", Array{other, "x"}}};
        packets.push_back(bytesOf(*serializeXml(object)));
        packets.push_back(*serializeBinary(object));
    }
    const Compared compared = compare("ifx", packets);
    EXPECT_GT(compared.values, shown);
    EXPECT_EQ(compared.unread, 0U);
}

TEST_F(DissectorLists, ReadsScalarsOfXmlAsTheyMayBeWritten) {
    Packets packets;
    for (const std::string value : {"<data>QQ==</data>",
                                    "<data> Q U\nI= </data>",
                                    "<data>QR==</data>",
                                    "<data>QQ=</data>",
                                    "<data>Q</data>",
                                    "<data>====</data>",
                                    "<data>Q!==</data>",
                                    "<data/>",
                                    "<integer> +07 </integer>",
                                    "<integer>-0</integer>",
                                    "<integer>0x1f</integer>",
                                    "<integer>-0X10</integer>",
                                    "<integer>9223372036854775807</integer>",
                                    "<integer>9223372036854775808</integer>",
                                    "<integer>18446744073709551615</integer>",
                                    "<integer>18446744073709551616</integer>",
                                    "<integer>-9223372036854775808</integer>",
                                    "<integer>1.0</integer>",
                                    "<integer></integer>",
                                    "<integer>- 1</integer>",
                                    "<real> 1e3 </real>",
                                    "<real>+.5</real>",
                                    "<real>-5.</real>",
                                    "<real>NaN</real>",
                                    "<real>-Infinity</real>",
                                    "<real>.</real>",
                                    "<real>1e400</real>",
                                    "<real>1e-400</real>",
                                    "<real>0e5</real>",
                                    "<real>1.2.3</real>",
                                    "<real>0x10</real>",
                                    "<real>--1</real>",
                                    "<date> 2024-02-29T23:59:59Z </date>",
                                    "<date>2023-02-29T00:00:00Z</date>",
                                    "<date>2023-13-01T00:00:00Z</date>",
                                    "<date>2023-01-01T24:00:00Z</date>",
                                    "<date>2023-00-10T00:00:00Z</date>",
                                    "<date>2023-01-01</date>",
                                    "<true></true>",
                                    "<false> </false>",
                                    "<true>x</true>",
                                    "<string>&#x110000;</string>",
                                    "<string>&#xD800;</string>",
                                    "<string>&#1;</string>",
                                    "<string>&unknown;</string>",
                                    "<string>a & b</string>",
                                    "<string>a<b/></string>",
                                    "<null/>",
                                    "<string>a</strin>"}) {
        packets.push_back(recordOf(kSimFilesCode, bytesOf("<plist><dict><key>kSimFile_PNN</key>" +
                                                          value + "</dict></plist>")));
        packets.push_back(recordOf(kSimFilesCode, bytesOf("{ kSimFile_PNN = other; }")));
    }
    const Compared compared = compare("gsm", packets);
    constexpr std::size_t kReadable = 20; // the others are refused
    EXPECT_EQ(compared.values, kReadable + packets.size() / 2);
    EXPECT_EQ(compared.unread, 0U);
}

TEST_F(DissectorLists, ReadsXmlAndTextAsTheyMayBeWritten) {
    Packets packets;
    for (const char* message :
         {"<?xml version='1.0' encoding='utf-8'?>\r\n<!DOCTYPE plist PUBLIC \"-//A//B 1.0//EN\" "
          "\"http://localhost/p.dtd\">\n<plist version=\"1.0\"><dict><!-- a - b "
          "--><key>k&amp;</key>"
          "\t<string>&lt;&#65;&#x42;&#x20AC;&gt;\r\nx</string>\n<key>e</key><string/>"
          "<key>d</key><dict/></dict ></plist>\n<!-- end -->",
          "\xEF\xBB\xBF<plist><array><string>h</string><string>]]&gt; ></string></array></plist>",
          "// comment\n{ a = b; /* c */ 'q;' = \"x\\n\\\"\\101\\U20ac\\ud83d\\uDE00\"; l = (1, "
          "two/x,); }",
          "( header, { only = value }, 'it' )", "bare", "\"\"", "{}", "( )",
          "{ a = 1; a = 2; b = 3 }", "{ a = <0f bd 77>; }"}) {
        packets.push_back(bytesOf(message));
    }
    const Compared compared = compare("ifx", packets);
    EXPECT_GE(compared.values, 12U);
    EXPECT_EQ(compared.unread, 0U);
}

} // namespace
} // namespace pallax
