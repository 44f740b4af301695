#include "plist/PropertyListCodec.h"
#include "simulator/ifx/BinaryObjectWriter.h"
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

/// Random values, and what the display makes of them: what stands alone in a dictionary stands
/// without it, and the first element of a list is left out.
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
    using ifx::BinaryObjectWriter;
    /// How many texts are read back of `lists` arrays that hold `count` of them each.
    const auto writeTexts = [](std::size_t lists, std::size_t count, const auto&... parts) {
        BinaryObjectWriter writer;
        writer.beginArray();
        for (std::size_t list = 0; list < lists; ++list) {
            writer.beginArray();
            for (std::size_t index = 0; index < count; ++index) {
                writer.shortText(parts...);
            }
            writer.endArray();
        }
        writer.endArray();
        ByteBuffer out;
        writer.finish(out);
        const auto object = parsePropertyList(out);
        std::size_t texts = 0;
        for (const PropertyList& list : *object->array()) {
            texts += list.array()->size();
        }
        return texts;
    };
    constexpr std::size_t kMost = BinaryObjectWriter::kMostInContainer;
    using Letters = std::string_view;
    EXPECT_EQ(writeTexts(3, kMost, 12345U, Letters("nine more")), 3 * kMost);
    EXPECT_EQ(writeTexts(1, 0, 1), 0U);
    EXPECT_THROW(writeTexts(1, 1, Letters("eleven more")), std::length_error);
    EXPECT_THROW(writeTexts(1, 1, 123456U, Letters("nine more")), std::length_error);
    EXPECT_THROW(writeTexts(1, kMost + 1, 1), std::length_error);
    BinaryObjectWriter large;
    const auto writeLarge = [&large](auto&& self, std::size_t levels) -> void {
        large.beginArray();
        for (std::size_t index = 0; index < kMost; ++index) {
            levels == 0 ? large.shortText(1) : self(self, levels - 1);
        }
        large.endArray();
    };
    EXPECT_THROW(writeLarge(writeLarge, 2), std::length_error) << "of 512 texts";
    BinaryObjectWriter deep;
    for (std::size_t depth = 0; depth < BinaryObjectWriter::kDeepest; ++depth) {
        deep.beginArray();
    }
    EXPECT_THROW(deep.beginArray(), std::length_error);
}

} // namespace
} // namespace pallax
