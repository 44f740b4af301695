#include "LogGenerator/Technologies/Technologies.h"
#include "decoding/DisplayJson.h"
#include "decoding/DroppedNotices.h"
#include "host/BuildBundle.h"
#include "host/DirectoryResources.h"
#include "host/Recording.h"
#include "plist/PropertyList.h"
#include "tests/doubles/ManualClock.h"

#include <gtest/gtest.h>

#include <map>
#include <string>
#include <vector>

namespace pallax {
namespace {

/// Generators of several technologies with one state, as after restarts of the link.
class KeptDisplay : public testing::Test {
protected:
    using Packets = std::vector<ByteBuffer>;

    std::unique_ptr<LogGenerator> generatorOf(std::string_view technology) {
        return LogGenerator::generatorFromTechnology(Text(technology), technologies(),
                                                     {clock, resources, bundle, notices});
    }
    /// The packets of a sample, or of its second half.
    static Packets packetsOf(const std::string& sample, bool isSecondHalf) {
        const auto recording =
            Recording::open(std::string(PALLAX_SOURCE_DIR) + "/samples/" + sample + ".pcap");
        EXPECT_TRUE(recording) << sample;
        Packets packets;
        while (const auto packet = (*recording)->next()) {
            packets.emplace_back(packet->data.begin(), packet->data.end());
        }
        const auto middle = packets.begin() + static_cast<std::ptrdiff_t>(packets.size() / 2);
        return isSecondHalf ? Packets(middle, packets.end()) : packets;
    }
    static void feed(LogGenerator& generator, Dictionary& state, const Packets& packets) {
        for (const ByteBuffer& packet : packets) {
            generator.updateState(state, packet);
        }
    }
    static std::string shownBy(LogGenerator& generator, const Dictionary& state) {
        std::string text;
        appendJson(text, generator.display(state));
        return text;
    }

    /// Sample recordings, by technology.
    const std::map<std::string, std::string> samples{{"IFX", "ifx-stream"},
                                                     {"Zorell_GSM", "umts-drive"},
                                                     {"Zorell_CDMA", "cdma-drive"},
                                                     {"Zorell_LTE", "lte-drive"},
                                                     {"Zorell_UTRAN2", "utran-drive"}};
    doubles::ManualClock clock;
    DirectoryResources resources{std::string(PALLAX_SOURCE_DIR) + "/resources"};
    BuildBundle bundle;
    DroppedNotices notices;
};

TEST_F(KeptDisplay, AGeneratorTellsForEachPairOfTechnologiesWhetherTheDisplayWillFollowIt) {
    for (const auto& [first, firstSample] : samples) {
        for (const auto& [second, secondSample] : samples) {
            Dictionary state;
            const auto before = generatorOf(first);
            EXPECT_FALSE(before->keepsDisplay(state)) << first << ", as the first generator";
            feed(*before, state, packetsOf(firstSample, false));
            const std::string shown = shownBy(*before, state);
            ASSERT_GT(shown.size(), 100U) << first;

            const auto after = generatorOf(second);
            const bool isKept = after->keepsDisplay(state);
            feed(*after, state, packetsOf(secondSample, true));
            feed(*after, state, Packets(1, packetsOf(secondSample, false).front()));
            EXPECT_EQ(shownBy(*after, state) == shown, isKept) << first << ", then " << second;
        }
    }
}

} // namespace
} // namespace pallax
