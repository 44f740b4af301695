#include "cli/Completion.h"

#include <algorithm>
#include <array>
#include <utility>

namespace pallax {

namespace {

using Script = std::string (*)(const CommandDescription& program);

constexpr auto kScripts = std::to_array<std::pair<std::string_view, Script>>({
    {"bash", bashCompletion},
    {"zsh", zshCompletion},
    {"fish", fishCompletion},
});

} // namespace

std::vector<std::string> completionShells() {
    std::vector<std::string> shells;
    shells.reserve(kScripts.size());
    for (const auto& [shell, script] : kScripts) {
        shells.emplace_back(shell);
    }
    return shells;
}

std::string completionFunction(const CommandDescription& program) {
    std::string name = "_" + program.name;
    std::replace(name.begin(), name.end(), '-', '_');
    return name;
}

std::string completionScript(const CommandDescription& program, std::string_view shell) {
    const auto* found = std::find_if(kScripts.begin(), kScripts.end(),
                                     [shell](const auto& each) { return each.first == shell; });
    return found == kScripts.end() ? "" : found->second(program);
}

} // namespace pallax
