#pragma once

#include <string_view>

/// The built page, web/page/dist, as the build has put it into the program.
namespace pallax::page_files {

extern const std::string_view kSkeleton; ///< HTML with marks for what is put in
extern const std::string_view kScript;
extern const std::string_view kStyle;

} // namespace pallax::page_files
