#include "telephony/ServiceStatus.h"

#include "telephony/ControlMessages.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

ServiceStatus busy() {
    return {"Zorell_LTE",
            3600,
            5'000'000'000,
            7,
            {{"viewer", true, 4'999'999'000, 0}, {"recorder", false, 0, 7}}};
}

TEST(ServiceStatus, IsReadAsItIsSaid) {
    for (const ServiceStatus& status : {busy(), ServiceStatus{"IFX", 0, 0, 0, {}}}) {
        const auto bytes = encodeMessage(statusReply(status));
        ASSERT_TRUE(bytes);
        const auto message = decodeMessage(*bytes);
        ASSERT_TRUE(message);
        EXPECT_EQ(parseStatusReply(*message), status);
    }
}

TEST(ServiceStatus, AReplyThatLacksAnythingIsNone) {
    const Dictionary whole = statusReply(busy());
    for (const char* key : {"Technology", "Uptime", "Sent", "Dropped", "Clients"}) {
        Dictionary without = whole;
        without.set(key, "?");
        EXPECT_EQ(parseStatusReply(without).has_value(), std::string_view(key) == "Technology");
    }
    EXPECT_EQ(parseStatusReply({}), std::nullopt);
    Dictionary strange = whole;
    strange.set("Clients", Array{"?"});
    EXPECT_EQ(parseStatusReply(strange), std::nullopt);
    strange.set("Clients", Array{Dictionary{{"LocalPort", "a"}}});
    EXPECT_EQ(parseStatusReply(strange), std::nullopt);
}

TEST(ServiceStatus, OnlyItsRequestAsksForIt) {
    EXPECT_TRUE(isStatusRequest(statusRequest()));
    EXPECT_FALSE(isStatusRequest({{"GetStatus", "?"}}));
    EXPECT_FALSE(isStatusRequest({}));
}

TEST(ServiceStatus, IsToldInLines) {
    EXPECT_EQ(statusText(busy()), "Technology: Zorell_LTE\n"
                                  "Uptime: 3600 s\n"
                                  "Packets sent: 5000000000\n"
                                  "Packets dropped: 7\n"
                                  "Clients: 2\n"
                                  "  viewer: streaming, 4999999000 packets sent, 0 dropped\n"
                                  "  recorder: not started, 0 packets sent, 7 dropped\n");
}

TEST(ServiceStatus, AClientThatHasBeenToldTheEndIsAtTheEnd) {
    ServiceStatus status;
    status.clients = {{"viewer", false, 12, 0}};
    EXPECT_NE(statusText(status).find("  viewer: at the end, 12 packets sent, 0 dropped\n"),
              std::string::npos);
}

TEST(ServiceStatus, NoNameIsACommandToTheTerminal) {
    ServiceStatus status;
    status.technology = "LTE\u009B2J";
    status.clients = {{"\x1B[31mred", false, 0, 0}};
    EXPECT_EQ(statusText(status), "Technology: LTE\\u009B2J\n"
                                  "Uptime: 0 s\n"
                                  "Packets sent: 0\n"
                                  "Packets dropped: 0\n"
                                  "Clients: 1\n"
                                  "  \\x1B[31mred: not started, 0 packets sent, 0 dropped\n");
}

} // namespace
} // namespace pallax
