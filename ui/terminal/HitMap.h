#pragma once

#include <functional>
#include <utility>
#include <vector>

namespace pallax::terminal {

/// The actions of clicks, by position; filled again with every drawing.
class HitMap {
public:
    using Action = std::function<void()>;

    void clear() { _areas.clear(); }
    /// Later areas are above earlier ones.
    void add(int x, int y, int columns, int rows, Action action) {
        _areas.push_back({x, y, columns, rows, std::move(action)});
    }
    /// The action at a position; empty if there is none.
    Action at(int x, int y) const {
        for (auto area = _areas.rbegin(); area != _areas.rend(); ++area) {
            if (x >= area->x && x < area->x + area->columns && y >= area->y &&
                y < area->y + area->rows) {
                return area->action;
            }
        }
        return {};
    }

private:
    struct Area {
        int x;
        int y;
        int columns;
        int rows;
        Action action;
    };
    std::vector<Area> _areas;
};

} // namespace pallax::terminal
