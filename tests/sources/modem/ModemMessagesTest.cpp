#include "sources/modem/ModemMessages.h"

#include "plist/PropertyListCodec.h"
#include "tests/doubles/ManualClock.h"
#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using namespace std::chrono_literals;

class ModemMessagesTest : public testing::Test {
protected:
    void change(const std::string& level) {
        _level = level;
        _messages.changed();
    }
    /// The levels of the messages that were made in that time.
    std::vector<std::string> after(std::chrono::nanoseconds time) {
        _made.clear();
        _queue.advance(time);
        return _made;
    }
    using Levels = std::vector<std::string>;

private:
    void note() {
        const auto message = parsePropertyList(*_messages.latest());
        _made.push_back(message->dictionary()->find("Level")->string().value());
    }

    doubles::SteppedQueue _queue;
    doubles::ManualClock _clock;
    std::string _level = "none";
    std::vector<std::string> _made;
    ModemMessages _messages{{_queue, _clock,
                             [this] {
                                 return Dictionary{{"Level", PropertyList(_level)}, {"B", "b"}};
                             },
                             [this] { note(); }}};
};

TEST_F(ModemMessagesTest, ChangesOfOneMomentMakeOneMessage) {
    change("a");
    change("b");
    EXPECT_EQ(after(100ms), (Levels{"b"}));
}

TEST_F(ModemMessagesTest, ThereIsAtMostOneMessageASecond) {
    change("a");
    EXPECT_EQ(after(100ms), (Levels{"a"}));
    change("b");
    change("c");
    EXPECT_EQ(after(999ms), (Levels{}));
    EXPECT_EQ(after(1ms), (Levels{"c"}));
}

TEST_F(ModemMessagesTest, ThereIsAtLeastOneMessageInFiveSeconds) {
    change("a");
    EXPECT_EQ(after(100ms), (Levels{"a"}));
    EXPECT_EQ(after(4999ms), (Levels{}));
    EXPECT_EQ(after(1ms), (Levels{"a"}));
    EXPECT_EQ(after(10s), (Levels{"a", "a"}));
}

TEST_F(ModemMessagesTest, WhatChangesNothingInThePictureMakesNoMessage) {
    change("a");
    EXPECT_EQ(after(100ms), (Levels{"a"}));
    change("a");
    EXPECT_EQ(after(4s), (Levels{}));
    change("b");
    EXPECT_EQ(after(100ms), (Levels{"b"}));
}

} // namespace
} // namespace pallax
