#include "cli/Programs.h"

#include <cstdio>
#include <string>

namespace pallax {

void complain(std::string_view sentence) {
    const std::string line = "pallax: " + std::string(sentence) + "\n";
    (void)std::fwrite(line.data(), 1, line.size(), stderr);
}

void complainOfWaiting(const std::string& text) {
    if (!text.empty()) {
        complain(text + ".");
    }
}

} // namespace pallax
