#include "simulator/Route.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace pallax {

namespace {

constexpr int kCorners = 14;
constexpr double kNearestM = 1100;
constexpr double kFarthestM = 1700;
// One fourteenth of a turn, as constants, because sines differ between machines in the last bit.
constexpr double kTurnCosine = 0.9009688679024191;
constexpr double kTurnSine = 0.4338837391175581;

struct Hill {
    double start_m;
    double length_m;
};
constexpr std::array<Hill, 3> kHills = {{{330, 260}, {2900, 420}, {5600, 300}}};
/// The distance over which a shadow begins or ends.
constexpr double kSlopeM = 90;

double distance(const PlanePoint& a, const PlanePoint& b) {
    return std::sqrt((a.x_m - b.x_m) * (a.x_m - b.x_m) + (a.y_m - b.y_m) * (a.y_m - b.y_m));
}

} // namespace

Route::Route(Random& random) {
    PlanePoint direction{1, 0};
    for (int corner = 0; corner < kCorners; ++corner) {
        const double radius_m = random.between(kNearestM, kFarthestM);
        _corners.push_back({direction.x_m * radius_m, direction.y_m * radius_m});
        direction = {direction.x_m * kTurnCosine - direction.y_m * kTurnSine,
                     direction.x_m * kTurnSine + direction.y_m * kTurnCosine};
    }
    double start_m = 0;
    for (std::size_t street = 0; street < _corners.size(); ++street) {
        _starts.push_back(start_m);
        start_m += distance(_corners[street], _corners[(street + 1) % _corners.size()]);
    }
    _starts.push_back(start_m);
}

double Route::withinRound(double distance_m) const {
    return std::fmod(distance_m, length_m());
}

PlanePoint Route::at(double distance_m) const {
    const double place_m = withinRound(distance_m);
    const auto next = std::upper_bound(_starts.begin() + 1, _starts.end() - 1, place_m);
    const auto street = static_cast<std::size_t>(next - _starts.begin()) - 1;
    const PlanePoint& from = _corners[street];
    const PlanePoint& to = _corners[(street + 1) % _corners.size()];
    const double part = (place_m - _starts[street]) / (_starts[street + 1] - _starts[street]);
    return {from.x_m + (to.x_m - from.x_m) * part, from.y_m + (to.y_m - from.y_m) * part};
}

double Route::shadowAt(double distance_m) const {
    const double place_m = withinRound(distance_m);
    double shadow = 0;
    for (const Hill& hill : kHills) {
        const double inside_m =
            std::min(place_m - hill.start_m, hill.start_m + hill.length_m - place_m);
        shadow = std::max(shadow, std::clamp(inside_m / kSlopeM, 0.0, 1.0));
    }
    return shadow;
}

} // namespace pallax
