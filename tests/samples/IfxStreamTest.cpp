#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "samples/Sample.h"
#include "tests/doubles/GeneratorFixture.h"

#include <gtest/gtest.h>

#include <map>
#include <set>
#include <string>

namespace pallax {
namespace {

/// The generator's display of the stream, message by message.
class IfxStream : public testing::Test {
protected:
    void feed(const TimedPacket& packet) {
        _generator->updateState(_state, packet.data);
        _display = _generator->display(_state).dictionary();
    }
    const PropertyList& shown(std::string_view key) const { return *_display->find(key); }

    doubles::GeneratorFixture _fixture;
    std::unique_ptr<LogGenerator> _generator = GSMLogGenerator::generator(_fixture.environment());
    Dictionary _state;
    DictionaryRef _display;
};

TEST_F(IfxStream, EachOfThirtyPicturesReplacesTheDisplayWhole) {
    const std::vector<TimedPacket> packets = ifxStreamPackets();
    EXPECT_EQ(packets.size(), 30U);
    for (const TimedPacket& packet : packets) {
        feed(packet);
        std::string keys;
        for (const Dictionary::Entry& entry : *_display) {
            keys += entry.key.string() + '\n';
        }
        EXPECT_EQ(keys, "Network\nRR\nServing Cell\nNeighbour Cells\nDedicated Channel\n"
                        "Barred Cells\n");
    }
}

TEST_F(IfxStream, TheThreeFormsTakeTurns) {
    std::map<std::string, int> beginnings;
    for (const TimedPacket& packet : ifxStreamPackets()) {
        const std::string text(packet.data.begin(), packet.data.end());
        ++beginnings[text.substr(0, text.starts_with('{') ? 1 : 5)];
    }
    EXPECT_EQ(beginnings, (std::map<std::string, int>{{"<?xml", 10}, {"bplis", 10}, {"{", 10}}));
}

TEST_F(IfxStream, ItsLastPictureIsShownNestedAndFolded) {
    feed(ifxStreamPackets().back());
    EXPECT_EQ(PropertyList(_display).description(),
              "{ Network = { Name = Sample Net; MCC = 262; MNC = 42; }; RR = Idle; "
              "Serving Cell = { ARFCN = 85; BSIC = 4,1; Rx Level = -65 dBm; C1 = 40; "
              "Area = { LAC = 6701; Cell ID = 31004; }; }; "
              "Neighbour Cells = ( { ARFCN = 62; BSIC = 2,3; Rx Level = -89 dBm; }, "
              "{ ARFCN = 71; BSIC = 2,5; Rx Level = -79 dBm; }, "
              "{ ARFCN = 17; BSIC = 4,2; Rx Level = -92 dBm; }, 103 ); "
              "Dedicated Channel = {}; Barred Cells = (); }");
}

TEST_F(IfxStream, ACallComesAndGoesAndThreeCellsServe) {
    std::set<std::string> states;
    std::set<std::string> cells;
    std::size_t hopping = 0;
    for (const TimedPacket& packet : ifxStreamPackets()) {
        feed(packet);
        states.insert(shown("RR").string().value_or("(no text)"));
        cells.insert(shown("Serving Cell").dictionary()->find("ARFCN")->string().value());
        const PropertyList* channels = shown("Dedicated Channel").dictionary()->find("Hopping");
        hopping += channels != nullptr && channels->array()->size() == 4 ? 1 : 0;
    }
    EXPECT_EQ(states, (std::set<std::string>{"Connection Establishment", "Dedicated", "Idle"}));
    EXPECT_EQ(cells, (std::set<std::string>{"62", "71", "85"}));
    EXPECT_EQ(hopping, 11U) << "the seconds of the call";
}

} // namespace
} // namespace pallax
