#pragma once

#include "simulator/Activity.h"
#include "simulator/RadioLayer.h"
#include "simulator/Random.h"
#include "simulator/Route.h"

#include <chrono>
#include <optional>
#include <vector>

namespace pallax {

/// When the phone leaves its first layer for the second, and when it returns.
struct Fallback {
    double leave_dbm;
    double return_dbm;
};

struct ScenarioPlan {
    std::vector<LayerPlan> layers;    ///< the phone starts on the first
    std::optional<Fallback> fallback; ///< if missing, the phone stays there
};

/// A phone in a car among cells: its position, what it hears, and what it does. One model for all
/// technologies, which differ only in their layers. The same seed gives the same drive.
class Scenario {
public:
    static constexpr std::chrono::milliseconds kStep{200};

    Scenario(const ScenarioPlan& plan, std::uint64_t seed);

    /// Advances by `kStep`.
    void step();

    std::chrono::milliseconds now() const { return _now; }
    const Activity& activity() const { return _activity; }
    const RadioLayer& layer(std::size_t index) const { return _layers[index]; }
    /// The index of the serving layer.
    std::size_t servingLayer() const { return _servingLayer; }
    const RadioLayer& serving() const { return _layers[_servingLayer]; }
    /// The latest step changed the serving cell. Also true at the start.
    bool hasNewServingCell() const { return _hasNewServingCell; }
    /// The latest step changed the serving layer. Also true at the start.
    bool hasNewLayer() const { return _hasNewLayer; }

private:
    void move();
    void chooseLayer();

    Random _random;
    Route _route;
    std::optional<Fallback> _fallback;
    std::vector<RadioLayer> _layers;
    Activity _activity;
    std::chrono::milliseconds _now{0};
    double _distance_m = 0;
    double _speed_mps = 13;
    std::size_t _servingLayer = 0;
    int _layerPatience = 0;
    unsigned _area = 0;
    bool _hasNewServingCell = true;
    bool _hasNewLayer = true;
};

} // namespace pallax
