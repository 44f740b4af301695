#include "web/StoredPage.h"

#include "report/Page.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

WebResponse answerTo(const std::string& path) {
    WebRequest request;
    request.method = "GET";
    request.path = path;
    return StoredPage("<script type=\"text/plain\" id=\"figures-0\">x</script>").answer(request);
}

TEST(StoredPage, IsThePageOfAReport) {
    const WebResponse page = answerTo("/");
    EXPECT_EQ(page.status, 200U);
    EXPECT_EQ(page.type, "text/html; charset=utf-8");
    EXPECT_NE(page.content->find("id=\"figures-0\">x<"), std::string::npos);
    EXPECT_EQ(page.headers,
              (WebRequest::Fields{{"Content-Security-Policy",
                                   pagePolicy(PageUse::Report) + "; frame-ancestors 'none'"}}));
}

TEST(StoredPage, HasNothingElse) {
    for (const char* path : {"/api/figures", "/api/events", "/metrics", "/..", ""}) {
        const WebResponse response = answerTo(path);
        EXPECT_EQ(response.status, 404U) << path;
        EXPECT_EQ(*response.content, "There is no such page.\n");
    }
}

} // namespace
} // namespace pallax
