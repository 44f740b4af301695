#include "ui/pages/PageTitle.h"

#include "ui/drawing/TextWidth.h"

namespace pallax::terminal {

void drawPageTitle(Grid& grid, const Marks& marks, Bars& bars, std::string_view title) {
    constexpr Style kBoldPageTitle{.bold = true};
    const int end = grid.columns() - kMargin;
    const int columns = columnsOf(title);
    const int room = bars.drawOrigin(end, end - kMargin - columns - kGap);
    const int beyond = kMargin + columns - room;
    if (beyond <= 0) {
        (void)grid.put(kMargin, kTitleRow, title, kBoldPageTitle);
        return;
    }
    const int start = grid.put(kMargin, kTitleRow, marks.more, kBoldPageTitle);
    (void)grid.put(kMargin - beyond, kTitleRow, title, kBoldPageTitle, {start, room});
}

} // namespace pallax::terminal
