#pragma once

#include "simulator/Random.h"
#include "simulator/Route.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace pallax {

/// The common properties of a radio technology's cells, and how their numbers are assigned.
struct LayerPlan {
    unsigned firstChannel = 0;
    unsigned channelStep = 1;
    unsigned channelCount = 1; ///< number of channels, used in turn
    unsigned firstCode = 0;
    unsigned codeCount = 504; ///< not a multiple of 101
    std::uint32_t firstIdentity = 1;
    std::uint32_t identityStep = 1;
    unsigned firstArea = 1;
    unsigned sitesPerSide = 6; ///< of a square around the centre
    double spacing_m = 700;
    double power_dbm = 30;   ///< radiated power in the bandwidth of the level
    double least_dbm = -130; ///< weaker cells are not heard
    double hillLoss_db = 0;  ///< in the deepest shadow
    int updateEvery = 1;     ///< steps between measurements while the layer does not serve
};

/// A cell's unchanging properties.
struct Cell {
    unsigned channel = 0;
    unsigned code = 0; ///< physical cell ID, scrambling code, colour code or pilot
    std::uint32_t identity = 0;
    unsigned area = 0;
    PlanePoint position;
};

/// The cells of one technology as the phone hears them: path loss, shadowing that changes slowly
/// along the route, and smoothing. The phone camps on one cell and leaves it for another that has
/// been better by a hysteresis for some time.
class RadioLayer {
public:
    static constexpr std::size_t kMostHeard = 9;

    RadioLayer(const LayerPlan& plan, Random& random, PlanePoint phone);

    /// The phone has moved by `moved_m` to `phone`, where a hill shadows it by `shadow` (0 to 1).
    void update(PlanePoint phone, double moved_m, double shadow, Random& random);

    const std::vector<Cell>& cells() const { return _cells; }
    double level_dbm(std::size_t cell) const { return _levels_dbm[cell]; }
    /// The total level of all cells.
    double total_dbm() const { return _total_dbm; }
    /// The cell on which the phone camps. It does not change while no cell is heard.
    std::size_t camped() const { return _camped; }
    const Cell& campedCell() const { return _cells[_camped]; }
    double campedLevel_dbm() const { return _levels_dbm[_camped]; }
    bool isHeard(std::size_t cell) const { return _levels_dbm[cell] > _plan.least_dbm; }
    /// True if the latest update changed the camped cell.
    bool hasChanged() const { return _hasChanged; }
    /// The other audible cells, strongest first.
    std::span<const std::size_t> neighbours() const {
        return {_neighbours.data(), _neighbourCount};
    }

private:
    void hear(std::size_t cell, double rawLevel_dbm);
    void rankNeighbours();
    void reselect();

    LayerPlan _plan;
    std::vector<Cell> _cells;
    std::vector<double> _shadows_db;
    std::vector<double> _levels_dbm;
    std::array<std::size_t, kMostHeard> _neighbours{};
    std::size_t _neighbourCount = 0;
    std::size_t _camped = 0;
    double _total_dbm = 0;
    int _betterSince = 0; // updates
    int _stepsSince = 0;  // the latest update
    double _movedSince_m = 0;
    bool _hasChanged = true;
};

} // namespace pallax
