#include "web/StoredPage.h"

#include "report/Page.h"

namespace pallax {

StoredPage::StoredPage(const std::string& data)
    : _page(std::make_shared<const std::string>(pageHtml(data, PageUse::Report))) {}

WebResponse StoredPage::answer(const WebRequest& request) const {
    if (request.path != "/") {
        return textResponse(404, "There is no such page.");
    }
    return {.type = "text/html; charset=utf-8",
            .content = _page,
            .headers = {{"Content-Security-Policy",
                         pagePolicy(PageUse::Report) + "; frame-ancestors 'none'"}}};
}

} // namespace pallax
