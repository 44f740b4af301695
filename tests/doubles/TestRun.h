#pragma once

namespace pallax::doubles {

/// The exit status of a test executable: 0 if all tests passed, 1 if one failed, and kTestsSkipped
/// if none failed but some were skipped, so that ctest can tell.
int runTests(int argc, char** argv);

constexpr int kTestsSkipped = 77;

} // namespace pallax::doubles
