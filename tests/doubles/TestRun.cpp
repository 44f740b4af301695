#include "tests/doubles/TestRun.h"

#include <gtest/gtest.h>

namespace pallax::doubles {

int runTests(int argc, char** argv) {
    testing::InitGoogleTest(&argc, argv);
    const int status = RUN_ALL_TESTS();
    if (status == 0 && testing::UnitTest::GetInstance()->skipped_test_count() > 0) {
        return kTestsSkipped;
    }
    return status;
}

} // namespace pallax::doubles
