#pragma once

#include "simulator/Random.h"

#include <vector>

namespace pallax {

/// On the plane of the scenario, in metres east and north of its middle.
struct PlanePoint {
    double x_m = 0;
    double y_m = 0;
};

/// A closed way around the middle, along straight streets. It has hills that shadow some of the
/// radio technologies: the first one a little way from the start.
class Route {
public:
    explicit Route(Random& random);

    double length_m() const { return _starts.back(); }
    /// `distance_m` from the start, any number of rounds on.
    PlanePoint at(double distance_m) const;
    /// How deep in a hill's shadow: 0 (not at all) to 1.
    double shadowAt(double distance_m) const;

private:
    double withinRound(double distance_m) const;

    std::vector<PlanePoint> _corners;
    std::vector<double> _starts; // of each street, and where the last one ends
};

} // namespace pallax
