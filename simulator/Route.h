#pragma once

#include "simulator/Random.h"

#include <vector>

namespace pallax {

/// A point on the scenario's plane, in metres east and north of its centre.
struct PlanePoint {
    double x_m = 0;
    double y_m = 0;
};

/// A closed route around the centre, along straight streets. It has hills that shadow some of the
/// radio technologies, the first a short way from the start.
class Route {
public:
    explicit Route(Random& random);

    double length_m() const { return _starts.back(); }
    /// The point `distance_m` from the start, over any number of rounds.
    PlanePoint at(double distance_m) const;
    /// The depth of a hill's shadow: 0 (none) to 1.
    double shadowAt(double distance_m) const;

private:
    double withinRound(double distance_m) const;

    std::vector<PlanePoint> _corners;
    std::vector<double> _starts; // start of each street, and end of the last one
};

} // namespace pallax
