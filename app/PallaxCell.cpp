#include "app/PallaxCell.h"

#include "platform/ui/TextMetrics.h"

#include <utility>

namespace pallax {

namespace {

constexpr double kTextSize = 15;
constexpr ui::Font kKeyFont{ui::FontFace::BoldSystem, kTextSize};
constexpr ui::Font kValueFont{ui::FontFace::System, kTextSize};
/// The font for measuring both texts; the slight excess width of the value is intended.
constexpr ui::Font kMeasuringFont = kKeyFont;

constexpr double kMargin = 10;     ///< left of the key
constexpr double kGap = 50;        ///< minimum space between key and value
constexpr double kViewHeight = 50; ///< of the scroll container, for any row height
constexpr double kHalf = 0.5;

std::shared_ptr<ui::Label> leftAlignedLabel(const ui::Font& font) {
    auto label = std::make_shared<ui::Label>();
    label->alignment = ui::TextAlignment::Left;
    label->font = font;
    return label;
}

double centred(double extent, double available) {
    return (available - extent) * kHalf;
}

} // namespace

PallaxCell::PallaxCell(Kind kind, std::string reuseIdentifier, const ui::TextMetrics& metrics)
    : TableCell(ui::CellStyle::TitleAndDetail, std::move(reuseIdentifier)), _metrics(metrics),
      _key(leftAlignedLabel(kKeyFont)) {
    if (kind == Kind::Leaf) {
        _value = leftAlignedLabel(kValueFont);
        _view = std::make_shared<ui::ScrollContainer>();
    }
}

ui::CellContents PallaxCell::contents() const {
    ui::CellContents contents{{}, _view.get()};
    for (const ui::Label* label : {_key.get(), _value.get()}) {
        if (label != nullptr) {
            contents.labels.push_back(label);
        }
    }
    return contents;
}

ui::Size PallaxCell::measured(const std::shared_ptr<ui::Label>& label) const {
    return label ? _metrics.measure(label->text, kMeasuringFont) : ui::Size{};
}

void PallaxCell::placeKey(const ui::Size& extent) {
    if (!_key) {
        return;
    }
    const ui::Rect& bounds = contentBounds();
    // The bounds' y is ignored, here and for the value.
    _key->frame = {{bounds.origin.x + kMargin, centred(extent.height, bounds.size.height)}, extent};
}

void PallaxCell::setLayoutKey() {
    layoutSubviews();
    placeKey(measured(_key));
}

void PallaxCell::setLayout() {
    layoutSubviews();
    const ui::Rect& bounds = contentBounds();
    const double width = bounds.size.width;
    const ui::Size key = measured(_key);
    const ui::Size value = measured(_value);
    placeKey(key);

    const double need = key.width + kMargin + kGap + value.width;
    if (_value) {
        // The flush-right position ignores the bounds' x.
        const double x =
            need < width ? width - value.width : bounds.origin.x + kMargin + key.width + kGap;
        _value->frame = {{x, centred(value.height, bounds.size.height)}, value};
    }
    if (_view) {
        // If the row is needed to the last point, the value follows the key but there is nothing to
        // scroll: "less than" above, "greater than" here.
        const double extra = need > width ? key.width + value.width : 0;
        _view->contentSize = {width + extra, kViewHeight};
        _view->frame = {bounds.origin, {width, kViewHeight}};
    }
}

} // namespace pallax
