#include "report/Page.h"

#include "host/Sha256.h"
#include "text/Base64.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

std::string between(const std::string& text, const std::string& open, const std::string& close) {
    const std::size_t begin = text.find(open);
    EXPECT_NE(begin, std::string::npos) << open;
    const std::size_t from = begin + open.size();
    return text.substr(from, text.find(close, from) - from);
}

std::string hashOf(const std::string& text) {
    return "'sha256-" + base64Text(Sha256().add(text).finishBytes()) + "'";
}

TEST(Page, AllowsItsOwnScriptAndStyleAlone) {
    const std::string page = pageHtml("", PageUse::Report);
    const std::string script = between(page, "<script type=\"module\">", "</script>");
    const std::string style = between(page, "<style>", "</style>");
    ASSERT_GT(script.size(), 1000U) << "web/page/dist is built";
    EXPECT_EQ(between(page, "Content-Security-Policy\" content=\"", "\""),
              "default-src 'none'; script-src " + hashOf(script) + "; style-src " +
                  hashOf(style) + "; img-src data:; base-uri 'none'; form-action 'none'");
}

TEST(Page, MayAskItsServerWhenItIsLive) {
    EXPECT_EQ(pagePolicy(PageUse::Live), pagePolicy(PageUse::Report) + "; connect-src 'self'");
    const std::string page = pageHtml("", PageUse::Live);
    EXPECT_EQ(page.find("http-equiv"), std::string::npos) << "the server sends the policy";
}

TEST(Page, HoldsItsDataBeforeItsScript) {
    const std::string page = pageHtml("<!-- the data -->", PageUse::Report);
    EXPECT_LT(page.find("<!-- the data -->"), page.find("<script type=\"module\">"));
    EXPECT_EQ(page.find("<!-- data -->"), std::string::npos);
    EXPECT_EQ(page.find("<!-- policy -->"), std::string::npos);
}

TEST(Page, FetchesNothingAndIsSmall) {
    const std::string page = pageHtml("", PageUse::Report);
    EXPECT_LE(page.size(), 150'000U);
    for (const char* reference : {" src=\"", "url(", "@import", "href=\"http"}) {
        EXPECT_EQ(page.find(reference), std::string::npos) << reference;
    }
}

} // namespace
} // namespace pallax
