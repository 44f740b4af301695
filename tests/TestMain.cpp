#include "tests/doubles/TestRun.h"

int main(int argc, char** argv) {
    return pallax::doubles::runTests(argc, argv);
}
