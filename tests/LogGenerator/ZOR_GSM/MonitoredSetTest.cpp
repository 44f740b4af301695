#include "LogGenerator/ZOR_GSM/MonitoredSet.h"

#include "tests/LogGenerator/ZOR_GSM/SearcherRecords.h"

namespace pallax {
namespace {

TEST(MonitoredSet, SubscribesToTheCellListIgnoresShortAndUnknownPacketsAndIsEmptiedByNoCells) {
    doubles::expectSearcherSet<MonitoredSet>("Monitored Set", "MonitoredSet");
}

TEST(MonitoredSet, IsEmptiedByAnyCells) {
    doubles::expectAlwaysEmptied<MonitoredSet>();
}

} // namespace
} // namespace pallax
