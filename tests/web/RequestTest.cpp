#include "web/Request.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(WebRequest, NamesOfHeadersHaveNoCase) {
    const WebRequest request{
        .method = "GET", .path = "/", .headers = {{"hOST", "a"}, {"Host", "b"}, {"Hosts", "c"}}};
    EXPECT_EQ(request.countOfHeader("Host"), 2U);
    ASSERT_NE(request.header("Host"), nullptr);
    EXPECT_EQ(*request.header("Host"), "a");
    EXPECT_EQ(request.header("Origin"), nullptr);
}

TEST(WebRequest, FindsACookieAmongOthers) {
    WebRequest request{.method = "GET", .path = "/"};
    const auto cookie = [&request](const std::string& sent) {
        request.headers = {{"Cookie", sent}};
        return request.cookie("b");
    };
    EXPECT_EQ(cookie("b=2"), "2");
    EXPECT_EQ(cookie("a=1; b=2; c=3"), "2");
    EXPECT_EQ(cookie("a=b=1;b=2=3"), "2=3");
    EXPECT_EQ(cookie("bb=1; B=2; b"), std::nullopt);
    EXPECT_EQ(cookie(";; ;"), std::nullopt);
    EXPECT_EQ(cookie(""), std::nullopt);
    EXPECT_EQ((WebRequest{.method = "GET", .path = "/"}.cookie("b")), std::nullopt);
}

TEST(WebResponse, IsNeitherKeptNorGuessedNorShownElsewhere) {
    const WebRequest::Fields common{
        {"Cache-Control", "no-store"},
        {"Content-Security-Policy", "default-src 'none'; frame-ancestors 'none'"},
        {"Cross-Origin-Opener-Policy", "same-origin"},
        {"Cross-Origin-Resource-Policy", "same-origin"},
        {"Referrer-Policy", "no-referrer"},
        {"X-Content-Type-Options", "nosniff"},
    };
    EXPECT_EQ(headersOf(textResponse(200, "All is well.")), common);
}

TEST(WebResponse, MayHaveAPolicyOfItsOwn) {
    WebResponse response = textResponse(200, "All is well.");
    response.headers = {{"Content-Security-Policy", "default-src 'self'"}};
    std::size_t policies = 0;
    for (const auto& [name, value] : headersOf(response)) {
        policies += name == "Content-Security-Policy" ? 1U : 0U;
    }
    EXPECT_EQ(policies, 1U);
    EXPECT_EQ(headersOf(response).front().second, "default-src 'self'");
}

} // namespace
} // namespace pallax
