#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// The two lives of the page.
enum class PageUse {
    Report, ///< one file with its data, opened without a server
    Live,   ///< fed by the server that it came from
};

/// The page's Content-Security-Policy: only its own script and style, known by their hashes, may
/// run. A live page may ask its server for data.
std::string pagePolicy(PageUse use);

/// The page as one HTML file. `data` are elements of `pageData`; none in a live page, whose policy
/// the server sends.
std::string pageHtml(std::string_view data, PageUse use);

} // namespace pallax
