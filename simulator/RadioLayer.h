#pragma once

#include "simulator/Random.h"
#include "simulator/Route.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace pallax {

/// What the cells of one radio technology have in common, and how their numbers are given out.
struct LayerPlan {
    unsigned firstChannel = 0;
    unsigned channelStep = 1;
    unsigned channelCount = 1; ///< so many channels take turns
    unsigned firstCode = 0;
    unsigned codeCount = 504; ///< no multiple of 101
    std::uint32_t firstIdentity = 1;
    std::uint32_t identityStep = 1;
    unsigned firstArea = 1;
    unsigned sitesPerSide = 6; ///< of a square around the middle
    double spacing_m = 700;
    double power_dbm = 30;   ///< radiated, in the bandwidth that the level is told of
    double least_dbm = -130; ///< what is weaker is not heard
    double hillLoss_db = 0;  ///< in the deepest shadow
    int updateEvery = 1;     ///< steps: what the phone does not serve on it measures less often
};

/// A cell's unchanging properties.
struct Cell {
    unsigned channel = 0;
    unsigned code = 0; ///< physical cell ID, scrambling code, colour code or pilot
    std::uint32_t identity = 0;
    unsigned area = 0;
    PlanePoint position;
};

/// The cells of one technology and how the phone hears them: path loss over the distance,
/// shadowing that changes slowly along the way, and the phone's own smoothing. The phone camps on
/// one of them and leaves it for another that has been better by a hysteresis for a while.
class RadioLayer {
public:
    static constexpr std::size_t kMostHeard = 9;

    RadioLayer(const LayerPlan& plan, Random& random, PlanePoint phone);

    /// The phone has moved `moved_m` to `phone`, where a hill shadows it so much (0 to 1).
    void update(PlanePoint phone, double moved_m, double shadow, Random& random);

    const std::vector<Cell>& cells() const { return _cells; }
    double level_dbm(std::size_t cell) const { return _levels_dbm[cell]; }
    /// Of all cells together.
    double total_dbm() const { return _total_dbm; }
    /// Where the phone camps. It stays there when nothing is heard.
    std::size_t camped() const { return _camped; }
    const Cell& campedCell() const { return _cells[_camped]; }
    double campedLevel_dbm() const { return _levels_dbm[_camped]; }
    bool isHeard(std::size_t cell) const { return _levels_dbm[cell] > _plan.least_dbm; }
    /// True when the latest update brought another camped cell.
    bool hasChanged() const { return _hasChanged; }
    /// The other cells that are heard, the strongest first.
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
