#include "cli/Program.h"
#include "decoding/FatalRecord.h"
#include "window/Activation.h"
#include "window/Arguments.h"
#include "window/Window.h"

#include <string>
#include <utility>
#include <variant>
#include <vector>

namespace {

using namespace pallax;

ExitStatus run(std::vector<std::string> arguments) {
    if (arguments == std::vector<std::string>{kActivationArgument}) {
        return runActivated();
    }
    const auto parsed = windowOptions(std::move(arguments));
    if (const auto* end = std::get_if<ParseEnd>(&parsed)) {
        return tell(*end);
    }
    try {
        return runWindow(std::get<BrowseOptions>(parsed));
    } catch (const FatalRecord&) {
        return kExitFatalRecord; // reported when it happened
    }
}

} // namespace

int main(int argc, char** argv) {
    return runProgram(argc, argv, run);
}
