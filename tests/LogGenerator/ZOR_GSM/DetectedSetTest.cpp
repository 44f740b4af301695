#include "LogGenerator/ZOR_GSM/DetectedSet.h"

#include "tests/LogGenerator/ZOR_GSM/SearcherRecords.h"

namespace pallax {
namespace {

TEST(DetectedSet, SubscribesToTheCellListIgnoresShortAndUnknownPacketsAndIsEmptiedByNoCells) {
    doubles::expectSearcherSet<DetectedSet>("Detected Set", "DetectedSet");
}

TEST(DetectedSet, IsEmptiedByAnyCells) {
    doubles::expectAlwaysEmptied<DetectedSet>();
}

} // namespace
} // namespace pallax
