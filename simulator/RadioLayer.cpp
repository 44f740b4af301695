#include "simulator/RadioLayer.h"

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

// Path loss in a city at 2 GHz: 128.1 dB at one kilometre, plus 37.6 dB for each factor of ten.
constexpr double kLossAtKilometreDb = 128.1;
constexpr double kLossPerDecadeDb = 37.6;
constexpr double kMastHeightM = 70; // the minimum distance to a cell

constexpr double kShadowingDb = 5;
constexpr double kShadowingDistanceM = 110; // the distance over which shadowing decorrelates
constexpr double kSmoothing = 0.5;          // weight of the newest value

constexpr double kHysteresisDb = 3;
constexpr int kPatience = 4; // updates for which another cell must be better

/// The cells lie on a square grid with small random offsets.
PlanePoint siteOf(const LayerPlan& plan, unsigned site, Random& random) {
    constexpr double kOff = 0.18; // relative to the spacing
    const double half = (plan.sitesPerSide - 1) / 2.0;
    const unsigned rowNumber = site / plan.sitesPerSide;
    const double column = site % plan.sitesPerSide + random.between(-kOff, kOff) - half;
    const double row = rowNumber + random.between(-kOff, kOff) - half;
    return {column * plan.spacing_m, row * plan.spacing_m};
}

double rawLevel_dbm(const LayerPlan& plan, const Cell& cell, PlanePoint phone) {
    const double dx = cell.position.x_m - phone.x_m;
    const double dy = cell.position.y_m - phone.y_m;
    constexpr double kSquareMetres = 1e6;
    const double square_km = (dx * dx + dy * dy + kMastHeightM * kMastHeightM) / kSquareMetres;
    return plan.power_dbm - kLossAtKilometreDb - kLossPerDecadeDb / 2 * std::log10(square_km);
}

} // namespace

RadioLayer::RadioLayer(const LayerPlan& plan, Random& random, PlanePoint phone) : _plan(plan) {
    constexpr unsigned kCodeStep = 101; // prime, so that no two cells share a code
    constexpr unsigned kChannelStep = 7;
    const unsigned count = plan.sitesPerSide * plan.sitesPerSide;
    const unsigned codeOffset = random.below(plan.codeCount);
    for (unsigned site = 0; site < count; ++site) {
        Cell cell;
        cell.position = siteOf(plan, site, random);
        cell.channel =
            plan.firstChannel + plan.channelStep * (site * kChannelStep % plan.channelCount);
        cell.code = plan.firstCode + (codeOffset + site * kCodeStep) % plan.codeCount;
        cell.identity = plan.firstIdentity + site * plan.identityStep;
        cell.area =
            plan.firstArea + (cell.position.x_m < 0 ? 1 : 0) + (cell.position.y_m < 0 ? 2 : 0);
        _shadows_db.push_back(random.normal() * kShadowingDb);
        _levels_dbm.push_back(
            std::max(rawLevel_dbm(plan, cell, phone) + _shadows_db.back(), plan.least_dbm));
        _cells.push_back(cell);
    }
    const auto best = std::max_element(_levels_dbm.begin(), _levels_dbm.end());
    _camped = static_cast<std::size_t>(best - _levels_dbm.begin());
    rankNeighbours();
}

void RadioLayer::update(PlanePoint phone, double moved_m, double shadow, Random& random) {
    _hasChanged = false;
    _movedSince_m += moved_m;
    if (++_stepsSince < _plan.updateEvery) {
        return;
    }
    const double kept = std::exp(-_movedSince_m / kShadowingDistanceM);
    _stepsSince = 0;
    _movedSince_m = 0;
    const double renewed_db = kShadowingDb * std::sqrt(1 - kept * kept);
    for (std::size_t cell = 0; cell < _cells.size(); ++cell) {
        _shadows_db[cell] = _shadows_db[cell] * kept + random.normal() * renewed_db;
        hear(cell, rawLevel_dbm(_plan, _cells[cell], phone) + _shadows_db[cell] -
                       shadow * _plan.hillLoss_db);
    }
    reselect();
    rankNeighbours();
}

void RadioLayer::hear(std::size_t cell, double rawLevel_dbm) {
    const double wanted_dbm = std::max(rawLevel_dbm, _plan.least_dbm);
    _levels_dbm[cell] += (wanted_dbm - _levels_dbm[cell]) * kSmoothing;
    constexpr double kBarelyHeardDb = 0.25; // because the smoothing never quite reaches the lowest
                                            // level
    if (wanted_dbm == _plan.least_dbm && _levels_dbm[cell] < wanted_dbm + kBarelyHeardDb) {
        _levels_dbm[cell] = wanted_dbm;
    }
}

void RadioLayer::reselect() {
    const auto best = std::max_element(_levels_dbm.begin(), _levels_dbm.end());
    if (*best < campedLevel_dbm() + kHysteresisDb) {
        _betterSince = 0;
    } else if (++_betterSince >= kPatience) {
        _camped = static_cast<std::size_t>(best - _levels_dbm.begin());
        _betterSince = 0;
        _hasChanged = true;
    }
}

/// The strongest others, by insertion sort, because they are few.
void RadioLayer::rankNeighbours() {
    constexpr double kDecadeDb = 10;
    _neighbourCount = 0;
    for (std::size_t cell = 0; cell < _cells.size(); ++cell) {
        const double level_dbm = _levels_dbm[cell];
        if (cell == _camped || level_dbm <= _plan.least_dbm) {
            continue;
        }
        std::size_t place = std::min(_neighbourCount, kMostHeard - 1);
        if (_neighbourCount == kMostHeard && _levels_dbm[_neighbours[place]] >= level_dbm) {
            continue;
        }
        for (; place > 0 && _levels_dbm[_neighbours[place - 1]] < level_dbm; --place) {
            _neighbours[place] = _neighbours[place - 1];
        }
        _neighbours[place] = cell;
        _neighbourCount = std::min(_neighbourCount + 1, kMostHeard);
    }
    // The three strongest make up nearly all of the sum.
    constexpr std::size_t kCounted = 3;
    double ratio = 1;
    for (const std::size_t cell : neighbours().first(std::min(kCounted, _neighbourCount))) {
        ratio += std::pow(10.0, (_levels_dbm[cell] - campedLevel_dbm()) / kDecadeDb);
    }
    _total_dbm = campedLevel_dbm() + kDecadeDb * std::log10(ratio);
}

} // namespace pallax
