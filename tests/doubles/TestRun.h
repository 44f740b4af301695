#pragma once

namespace pallax::doubles {

/// What the main of a test executable returns: 0 when every test passed, 1 when one failed,
/// and kTestsSkipped when none failed but some were skipped, so that ctest can tell.
int runTests(int argc, char** argv);

constexpr int kTestsSkipped = 77;

} // namespace pallax::doubles
