#include "plist/PropertyListCodec.h"
#include "simulator/ifx/BinaryMessage.h"
#include "simulator/ifx/Picture.h"
#include "tests/simulator/Values.h"

#include <stdexcept>

namespace pallax {
namespace {

using ifx::RrState;

std::string dbm(int level_dbm) {
    return std::to_string(level_dbm) + " dBm";
}

std::string colours(ifx::ColourCode code) {
    return text(code.network) + "," + text(code.station);
}

/// Random values with their display: a dictionary of one entry is shown as its value, and the first
/// element of a list is left out.
struct RandomPicture {
    RandomPicture() {
        const auto state = oneOf<RrState>({{RrState::Off, "Off"},
                                           {RrState::Selection, "Cell Selection"},
                                           {RrState::Establishment, "Connection Establishment"},
                                           {RrState::Idle, "Idle"},
                                           {RrState::Dedicated, "Dedicated"},
                                           {RrState::Release, "Connection Release"}});
        picture.isRegistered = below(2) == 1;
        picture.state = state.number;
        const PropertyList network =
            picture.isRegistered
                ? PropertyList(Dictionary{{"Name", "Sample Net"}, {"MCC", "262"}, {"MNC", "42"}})
                : PropertyList("No");
        expected = {{"Network", network}, {"RR", state.label}};
        expected.set(std::string("Serving Cell"), serving());
        expected.set(std::string("Neighbour Cells"), neighbours());
        expected.set(std::string("Dedicated Channel"), dedicated());
    }

    PropertyList serving() {
        picture.serving = {below(1024),      {below(8), below(8)}, between(-113, -30),
                           between(-20, 80), below(65536),         below(65536)};
        const ifx::ServingCell& cell = picture.serving;
        return Dictionary{
            {"ARFCN", text(cell.arfcn)},
            {"BSIC", colours(cell.bsic)},
            {"Rx Level", dbm(cell.level_dbm)},
            {"C1", std::to_string(cell.c1)},
            {"Area", Dictionary{{"LAC", text(cell.locationArea)}, {"Cell ID", text(cell.cellId)}}}};
    }

    PropertyList neighbours() {
        cells.resize(below(ifx::Picture::kMostNeighbours + 1));
        Array list;
        for (ifx::NeighbourCell& cell : cells) {
            cell = {below(1024), below(2) == 1, {below(8), below(8)}, between(-113, -30)};
            if (cell.isRead) {
                list.emplace_back(Dictionary{{"ARFCN", text(cell.arfcn)},
                                             {"BSIC", colours(cell.bsic)},
                                             {"Rx Level", dbm(cell.level_dbm)}});
            } else {
                list.emplace_back(text(cell.arfcn));
            }
        }
        picture.neighbours = cells;
        return list;
    }

    PropertyList dedicated() {
        if (below(2) == 0) {
            return Dictionary{};
        }
        const auto type = oneOf<ifx::ChannelType>(
            {{ifx::ChannelType::Traffic, "TCH/F"}, {ifx::ChannelType::Signalling, "SDCCH/8"}});
        frequencies.resize(below(ifx::Picture::kMostHopping + 1));
        Array hopping;
        for (unsigned& arfcn : frequencies) {
            arfcn = below(1024);
            hopping.emplace_back(text(arfcn));
        }
        const ifx::DedicatedChannel channel{type.number, below(8),       below(64),
                                            below(8),    between(5, 34), frequencies};
        picture.dedicated = channel;
        Dictionary shown{{"Channel", type.label},
                         {"Time Slot", text(channel.timeSlot)},
                         {"Timing Advance", text(channel.timingAdvance)},
                         {"Rx Quality", text(channel.quality)},
                         {"Tx Power", dbm(channel.power_dbm)}};
        if (!hopping.empty()) {
            shown.set(std::string("Hopping"), hopping);
        }
        return shown;
    }

    ifx::Picture picture{};
    std::vector<ifx::NeighbourCell> cells;
    std::vector<unsigned> frequencies;
    Dictionary expected;
};

TEST(IfxPicture, IsShownAsEncodedInBothForms) {
    EXPECT_TRUE(doubles::holds([] {
        const RandomPicture random;
        for (const ListForm form : {ListForm::Binary, ListForm::Xml}) {
            ByteBuffer bytes;
            ifx::encode(random.picture, form, bytes);
            DecodedDisplay decoded("ifx");
            decoded.feed(bytes);
            RC_ASSERT(PropertyList(*decoded.display()) == PropertyList(random.expected));
        }
    }));
}

TEST(IfxPicture, ItsFormsHoldTheSameAndItsXmlIsThatOfTheSerialiser) {
    EXPECT_TRUE(doubles::holds([] {
        const RandomPicture random;
        ByteBuffer binary;
        ByteBuffer xml;
        ifx::encode(random.picture, ListForm::Binary, binary);
        ifx::encode(random.picture, ListForm::Xml, xml);
        const auto object = parsePropertyList(binary);
        RC_ASSERT(object);
        const auto serialised = serializeXml(*object);
        RC_ASSERT(serialised);
        RC_ASSERT(std::string(xml.begin(), xml.end()) == *serialised);
    }));
}

TEST(IfxPicture, AMessageThatHoldsTooMuchIsRefused) {
    const auto textsReadBack = [](std::size_t count) {
        ifx::BinaryMessage message;
        message.beginArray();
        for (std::size_t index = 0; index < count; ++index) {
            message.text(std::to_string(index));
        }
        message.endArray();
        const std::string_view list = message.finish();
        const auto object = parsePropertyList(ByteBuffer(list.begin(), list.end()));
        return object->array()->size();
    };
    constexpr std::size_t kMostObjects = 256;
    constexpr std::size_t kMostTexts = kMostObjects - ifx::kWords.size() - 1; // and the array
    EXPECT_EQ(textsReadBack(0), 0U);
    EXPECT_EQ(textsReadBack(kMostTexts), kMostTexts);
    EXPECT_THROW(textsReadBack(kMostTexts + 1), std::length_error);
}

} // namespace
} // namespace pallax
