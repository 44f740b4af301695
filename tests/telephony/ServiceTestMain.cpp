// The main function of the tests and of their child service, like the command's own.

#include "telephony/ChildService.h"
#include "tests/doubles/TestRun.h"

int main(int argc, char** argv) {
    if (argc > 1 && argv[1] == pallax::kChildServiceCommand) {
        return pallax::runChildService(argc, argv);
    }
    return pallax::doubles::runTests(argc, argv);
}
