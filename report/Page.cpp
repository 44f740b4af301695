#include "report/Page.h"

#include "host/Sha256.h"
#include "report/PageFiles.h"
#include "text/Base64.h"

#include <stdexcept>

namespace pallax {

namespace {

std::string hashOf(std::string_view text) {
    const Sha256::Digest digest = Sha256().add(text).finishBytes();
    return "'sha256-" + base64Text(digest) + "'";
}

void replaceMark(std::string& page, std::string_view mark, std::string_view text) {
    const std::size_t place = page.find(mark);
    if (place == std::string::npos) {
        throw std::logic_error("the page has no mark " + std::string(mark));
    }
    page.replace(place, mark.size(), text);
}

} // namespace

std::string pagePolicy(PageUse use) {
    return "default-src 'none'; script-src " + hashOf(page_files::kScript) + "; style-src " +
           hashOf(page_files::kStyle) + "; img-src data:; base-uri 'none'; form-action 'none'" +
           (use == PageUse::Live ? "; connect-src 'self'" : "");
}

std::string pageHtml(std::string_view data, PageUse use) {
    const bool isReport = use == PageUse::Report;
    std::string page(page_files::kSkeleton);
    // The last mark first: the data stand before it and can be large.
    replaceMark(page, "<!-- script -->",
                "<script type=\"module\">" + std::string(page_files::kScript) + "</script>");
    replaceMark(page, "<!-- style -->", "<style>" + std::string(page_files::kStyle) + "</style>");
    replaceMark(page, "<!-- policy -->",
                isReport ? "<meta http-equiv=\"Content-Security-Policy\" content=\"" +
                               pagePolicy(use) + "\">"
                         : "");
    replaceMark(page, "<!-- data -->", data);
    return page;
}

} // namespace pallax
