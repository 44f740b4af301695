#include "sources/StreamOpening.h"

#include <gtest/gtest.h>

#include <future>
#include <vector>

namespace pallax {
namespace {

using namespace std::chrono_literals;

/// The recording that opening a stream's header returns.
class NoPackets final : public Recording {
public:
    const std::string& name() const override { return _name; }
    int linkType() const override { return 0; }
    const RecordedTechnology* technology() const override { return nullptr; }
    RecordingError foreignLinkType() const override { return {}; }
    std::optional<RecordedPacket> next() override { return std::nullopt; }
    const std::optional<RecordingError>& error() const override { return _error; }

private:
    std::string _name;
    std::optional<RecordingError> _error;
};

using Sentences = std::vector<std::string>;

TEST(StreamOpening, AStreamThatBeginsAtOnceIsNotReported) {
    Sentences told;
    const auto opened =
        openStream({[] { return StreamOpening::Opened(std::make_unique<NoPackets>()); },
                    [&](const std::string& sentence) { told.push_back(sentence); }});
    EXPECT_TRUE(opened);
    EXPECT_EQ(told, Sentences());
}

TEST(StreamOpening, AStallBeforeTheHeaderIsReportedAndItsEnd) {
    Sentences told;
    std::promise<void> stalled;
    const auto opened = openStream({[&] {
                                        stalled.get_future().wait();
                                        return StreamOpening::Opened(std::make_unique<NoPackets>());
                                    },
                                    [&](const std::string& sentence) {
                                        told.push_back(sentence);
                                        if (told.size() == 1) {
                                            stalled.set_value();
                                        }
                                    },
                                    2ms});
    EXPECT_TRUE(opened);
    EXPECT_EQ(told, (Sentences{"The stream has stalled: no header for 0 s.",
                               "The stream continues after 0 s."}));
}

TEST(StreamOpening, AStreamThatEndsWithoutAHeaderAfterAStallIsAFailureAndDoesNotGoOn) {
    Sentences told;
    std::promise<void> stalled;
    const auto opened =
        openStream({[&] {
                        stalled.get_future().wait();
                        return StreamOpening::Opened(HostError{"standard input is empty."});
                    },
                    [&](const std::string& sentence) {
                        told.push_back(sentence);
                        stalled.set_value();
                    },
                    2ms});
    ASSERT_FALSE(opened);
    EXPECT_EQ(opened.error().sentence, "standard input is empty.");
    EXPECT_EQ(told, (Sentences{"The stream has stalled: no header for 0 s."}));
}

} // namespace
} // namespace pallax
