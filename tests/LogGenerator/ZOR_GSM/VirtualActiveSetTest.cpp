#include "LogGenerator/ZOR_GSM/VirtualActiveSet.h"

#include "tests/LogGenerator/ZOR_GSM/SearcherRecords.h"

namespace pallax {
namespace {

TEST(VirtualActiveSet, SubscribesToTheCellListIgnoresShortAndUnknownPacketsAndIsEmptiedByNoCells) {
    doubles::expectSearcherSet<VirtualActiveSet>("Virtual Active Set", "VirtualActiveSet");
}

TEST(VirtualActiveSet, IsEmptiedByAnyCells) {
    doubles::expectAlwaysEmptied<VirtualActiveSet>();
}

} // namespace
} // namespace pallax
