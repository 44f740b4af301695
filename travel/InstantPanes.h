#pragma once

#include "app/HeldPanes.h"
#include "timeline/FrameWalk.h"
#include "travel/Travel.h"

#include <cstdint>
#include <memory>
#include <optional>

namespace pallax {

/// The panes of the instant that a screen shows, while it is not the present.
class InstantPanes {
public:
    /// Both must outlive the object.
    InstantPanes(Travel& travel, ui::Toolkit& toolkit) : _travel(travel), _toolkit(toolkit) {}

    /// Those of the shown instant, which begin with those of `live`; null at the present.
    ui::NavigationStack* shown(const ui::NavigationStack& live);
    /// The timeline is another one.
    void forget();

private:
    Travel& _travel;
    ui::Toolkit& _toolkit;
    std::unique_ptr<HeldPanes> _panes;
    std::uint64_t _instant = 0;     ///< that the panes show
    std::optional<FrameWalk> _walk; ///< while another instant than the present is shown
    const Timeline* _walked = nullptr;
};

} // namespace pallax
