#pragma once

#include "web/Request.h"

#include <memory>
#include <string>

namespace pallax {

/// The page of a report, with its data in it, as a server gives it. It has nothing else.
class StoredPage {
public:
    /// `data` is that of `pageData`.
    explicit StoredPage(const std::string& data);

    WebResponse answer(const WebRequest& request) const;

private:
    std::shared_ptr<const std::string> _page;
};

} // namespace pallax
