// The tests' main, which is also the child service's, as the command's own is.

#include "telephony/ChildService.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

int main(int argc, char** argv) {
    if (argc > 1 && argv[1] == pallax::kChildServiceCommand) {
        return pallax::runChildService(argc, argv);
    }
    testing::InitGoogleMock(&argc, argv);
    return RUN_ALL_TESTS();
}
