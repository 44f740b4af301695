#include "browsing/SnapshotOverview.h"

#include "host/Snapshot.h"
#include "overview/DisplayValues.h"

namespace pallax {

void SnapshotOverview::take(Bytes message, Time time) {
    const PropertyList display = displayIn(message);
    _latest = std::make_unique<Display>(technologyOfDisplay(display, _resources), _resources, time);
    giveDisplay(display, time, _latest->fields, _latest->values);
}

Overview SnapshotOverview::overview(const NetworkNames& names,
                                    const QualityProfile& profile) const {
    if (!_latest) {
        return {};
    }
    Overview overview{statusOf(_latest->values, _latest->time, names, profile), {}};
    overview.knowsAges = false; // a snapshot holds none
    return overview;
}

} // namespace pallax
