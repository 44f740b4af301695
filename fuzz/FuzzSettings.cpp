// The settings file: any text is accepted, or refused with one sentence that names file and line;
// accepted values contain no line end.

#include "link/Settings.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <string_view>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace pallax;
    const std::string text(data, data + size);
    const auto settings = parseSettings(text, "pallax.conf");
    if (!settings) {
        const std::string& sentence = settings.error().sentence;
        if (!sentence.starts_with("pallax.conf, line ") || sentence.back() != '.') {
            std::abort();
        }
        return 0;
    }
    for (const auto& path : {settings->snapshotDirectory, settings->saveButtonMarker}) {
        if (path && (path->empty() || path->find('\n') != std::string::npos)) {
            std::abort();
        }
    }
    return 0;
}
