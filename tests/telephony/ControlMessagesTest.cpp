#include "telephony/ControlMessages.h"

#include "tests/telephony/ServiceFolder.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(ControlMessages, ARequestNamesTheLocalPort) {
    EXPECT_EQ(PropertyList(createLogChannelRequest("a.port")),
              PropertyList(Dictionary{{"CreateLogChannel", "a.port"}}));
}

TEST(ControlMessages, AReplyIsReadAsItWasMade) {
    const auto parsed = parseCreateLogChannelReply(createLogChannelReply({0, 0, "channel"}));
    ASSERT_TRUE(parsed);
    EXPECT_EQ(parsed->errorCode, 0);
    EXPECT_EQ(parsed->remotePortName, "channel");
    const auto failed = parseCreateLogChannelReply(createLogChannelReply({1, 5, {}}));
    ASSERT_TRUE(failed);
    EXPECT_EQ(failed->errorDomain, 1);
    EXPECT_EQ(failed->errorCode, 5);
    EXPECT_EQ(failed->remotePortName, std::nullopt);
}

TEST(ControlMessages, AReplyWithoutItsNumbersIsNone) {
    EXPECT_FALSE(parseCreateLogChannelReply({}));
    EXPECT_FALSE(parseCreateLogChannelReply({{"ErrorDomain", PropertyList::integer(0)}}));
    EXPECT_FALSE(parseCreateLogChannelReply({{"ErrorDomain", "0"}, {"ErrorCode", "0"}}));
}

TEST(ControlMessages, OnlyADictionaryIsAMessage) {
    const Dictionary message{{"GetTechnology", "IFX"}};
    const auto bytes = encodeMessage(message);
    ASSERT_TRUE(bytes);
    EXPECT_EQ(comparable(decodeMessage(*bytes)), PropertyList(message));
    EXPECT_FALSE(decodeMessage({}));
    EXPECT_FALSE(decodeMessage(ByteBuffer{'<', '0', '1', '>'}));
    EXPECT_FALSE(encodeMessage({{"key", PropertyList()}}));
}

} // namespace
} // namespace pallax
