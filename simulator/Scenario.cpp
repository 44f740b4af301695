#include "simulator/Scenario.h"

#include <algorithm>

namespace pallax {

namespace {

constexpr double kSlowestMps = 7;
constexpr double kFastestMps = 17;

} // namespace

Scenario::Scenario(const ScenarioPlan& plan, std::uint64_t seed)
    : _random(seed), _route(_random), _fallback(plan.fallback), _activity(_random) {
    const PlanePoint start = _route.at(0);
    _layers.reserve(plan.layers.size());
    for (const LayerPlan& layer : plan.layers) {
        _layers.emplace_back(layer, _random, start);
    }
    _area = serving().campedCell().area;
}

void Scenario::step() {
    _now += kStep;
    move();
    chooseLayer();
    _hasNewServingCell = _hasNewLayer || serving().hasChanged();
    const unsigned area = serving().campedCell().area;
    const bool newArea = area != _area || _hasNewLayer;
    _area = area;
    _activity.update(kStep, newArea, _random);
}

void Scenario::move() {
    constexpr double kSpeedChangeMps = 0.25; // per step
    constexpr double kStep_s = std::chrono::duration<double>(kStep).count();
    _speed_mps =
        std::clamp(_speed_mps + _random.normal() * kSpeedChangeMps, kSlowestMps, kFastestMps);
    const double moved_m = _speed_mps * kStep_s;
    _distance_m += moved_m;
    const PlanePoint phone = _route.at(_distance_m);
    const double shadow = _route.shadowAt(_distance_m);
    for (RadioLayer& layer : _layers) {
        layer.update(phone, moved_m, shadow, _random);
    }
}

void Scenario::chooseLayer() {
    constexpr int kLayerPatience = 6; // steps for which a threshold must be exceeded
    _hasNewLayer = false;
    if (!_fallback || !_activity.isRegistered()) {
        return;
    }
    const double level_dbm = _layers.front().campedLevel_dbm();
    const bool wantsChange =
        _servingLayer == 0 ? level_dbm < _fallback->leave_dbm : level_dbm > _fallback->return_dbm;
    _layerPatience = wantsChange ? _layerPatience + 1 : 0;
    if (_layerPatience >= kLayerPatience) {
        _servingLayer = _servingLayer == 0 ? 1 : 0;
        _layerPatience = 0;
        _hasNewLayer = true;
    }
}

} // namespace pallax
