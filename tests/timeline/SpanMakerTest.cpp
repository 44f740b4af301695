#include "timeline/SpanMaker.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax {
namespace {

using std::chrono::seconds;

constexpr FieldIndex kField = 3;
constexpr ListId kList = 7;

FieldValue valueOf(std::int64_t number) {
    FieldValue value;
    value.shown = PropertyList::integer(number);
    value.number = static_cast<double>(number);
    return value;
}

/// "3/0=5 from packet 1, 0 to 2 s".
std::vector<std::string> ended(SpanMaker& spans) {
    std::vector<std::string> texts;
    for (const Span& span : spans.ended()) {
        const auto second = [](Time time) {
            return std::to_string(
                std::chrono::duration_cast<seconds>(time.time_since_epoch()).count());
        };
        texts.push_back(std::to_string(span.field) + "/" + std::to_string(span.entry) + "=" +
                        span.value.text() + " from packet " + std::to_string(span.packet) + ", " +
                        second(span.start) + " to " + second(span.end) + " s");
    }
    spans.ended().clear();
    return texts;
}

TEST(SpanMaker, AValueHoldsUntilAnotherIsRead) {
    SpanMaker spans;
    spans.beginPacket(1, Time(seconds(0)));
    spans.valueRead(kField, kNoEntry, valueOf(5));
    spans.beginPacket(2, Time(seconds(1)));
    spans.valueRead(kField, kNoEntry, valueOf(5));
    EXPECT_EQ(ended(spans), std::vector<std::string>{});
    spans.beginPacket(3, Time(seconds(2)));
    spans.valueRead(kField, kNoEntry, valueOf(6));
    EXPECT_EQ(ended(spans), std::vector<std::string>{"3/0=5 from packet 1, 0 to 2 s"});
    spans.beginPacket(4, Time(seconds(3)));
    spans.valueRemoved(kField);
    EXPECT_EQ(ended(spans), std::vector<std::string>{"3/0=6 from packet 3, 2 to 3 s"});
    spans.endAll();
    EXPECT_EQ(ended(spans), std::vector<std::string>{});
}

TEST(SpanMaker, AnEntryThatItsListNoLongerHasEnds) {
    SpanMaker spans;
    spans.beginPacket(1, Time(seconds(0)));
    spans.listReplaced(kList);
    spans.valueRead(kField, 1, valueOf(5));
    spans.valueRead(kField, 2, valueOf(6));
    spans.beginPacket(2, Time(seconds(1)));
    spans.listReplaced(kList);
    spans.valueRead(kField, 2, valueOf(6));
    spans.beginPacket(3, Time(seconds(2)));
    EXPECT_EQ(ended(spans), std::vector<std::string>{"3/1=5 from packet 1, 0 to 1 s"});
}

TEST(SpanMaker, WhatAPacketDoesNotReadCanEndWithIt) {
    SpanMaker spans;
    spans.beginPacket(1, Time(seconds(0)));
    spans.valueRead(kField, kNoEntry, valueOf(5));
    spans.valueRead(kField + 1, kNoEntry, valueOf(6));
    spans.beginPacket(2, Time(seconds(4)));
    spans.valueRead(kField, kNoEntry, valueOf(5));
    spans.endUnread();
    EXPECT_EQ(ended(spans), std::vector<std::string>{"4/0=6 from packet 1, 0 to 4 s"});
}

TEST(SpanMaker, NoSpanEndsBeforeItsStart) {
    SpanMaker spans;
    spans.beginPacket(1, Time(seconds(10)));
    spans.valueRead(kField, kNoEntry, valueOf(5));
    spans.beginPacket(2, Time(seconds(9)));
    spans.endAll();
    EXPECT_EQ(ended(spans), std::vector<std::string>{"3/0=5 from packet 1, 10 to 10 s"});
}

} // namespace
} // namespace pallax
