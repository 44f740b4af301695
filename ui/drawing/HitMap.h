#pragma once

#include <algorithm>
#include <functional>
#include <optional>
#include <utility>
#include <vector>

namespace pallax::terminal {

/// A row of columns that stand for the places from 0 to 1. A click, or dragging that began on it,
/// goes to a place.
struct Slider {
    int first;   ///< its first column
    int columns; ///< at least 2
    std::function<void(double)> go;

    /// Columns beyond its ends stand for its ends.
    void moveTo(int x) const {
        go(static_cast<double>(std::clamp(x - first, 0, columns - 1)) / (columns - 1));
    }
};

/// The actions of clicks, by position; filled again with every drawing.
class HitMap {
public:
    using Action = std::function<void()>;

    void clear() { _areas.clear(); }
    /// Later areas are above earlier ones.
    void add(int x, int y, int columns, int rows, Action action) {
        _areas.push_back({x, y, columns, rows, std::move(action), {}});
    }
    void add(int y, const Slider& slider) {
        _areas.push_back({slider.first, y, slider.columns, 1, {}, slider});
    }
    /// The action at a position; empty if there is none.
    Action at(int x, int y) const {
        const Area* const area = areaAt(x, y);
        if (area == nullptr) {
            return {};
        }
        return area->slider ? [slider = *area->slider, x] { slider.moveTo(x); } : area->action;
    }
    std::optional<Slider> sliderAt(int x, int y) const {
        const Area* const area = areaAt(x, y);
        return area != nullptr ? area->slider : std::nullopt;
    }

private:
    struct Area {
        int x;
        int y;
        int columns;
        int rows;
        Action action;
        std::optional<Slider> slider;
    };

    const Area* areaAt(int x, int y) const {
        const auto found = std::find_if(_areas.rbegin(), _areas.rend(), [x, y](const Area& area) {
            return x >= area.x && x < area.x + area.columns && y >= area.y &&
                   y < area.y + area.rows;
        });
        return found != _areas.rend() ? &*found : nullptr;
    }

    std::vector<Area> _areas;
};

} // namespace pallax::terminal
