// The tests' main, which is also the child service's, as the command's own is.

#include "telephony/ChildService.h"
#include "tests/doubles/TestRun.h"

int main(int argc, char** argv) {
    if (argc > 1 && argv[1] == pallax::kChildServiceCommand) {
        return pallax::runChildService(argc, argv);
    }
    return pallax::doubles::runTests(argc, argv);
}
