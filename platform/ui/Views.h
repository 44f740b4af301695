#pragma once

#include "platform/ui/Geometry.h"
#include "platform/ui/TextMetrics.h"

#include <functional>
#include <string>
#include <variant>
#include <vector>

/// The passive views: values that a controller fills and a front end draws.
namespace pallax::ui {

enum class TextAlignment { Left, Center, Right };
enum class TextColor { Default, Dark };

struct Label {
    std::string text;
    Font font;
    TextAlignment alignment = TextAlignment::Left;
    TextColor color = TextColor::Default;
    bool clearBackground = false;
    Rect frame;
};

/// Shows a part of wider content.
struct ScrollContainer {
    Rect frame;
    Size contentSize;
};

enum class IndicatorStyle { Gray, White };

/// Turns during an operation.
struct ActivityIndicator {
    IndicatorStyle style = IndicatorStyle::Gray;
    bool isSpinning = false;
    bool hidesWhenStopped = false;
};

struct FlexibleSpace {};

/// A button that the toolkit draws as its standard save button.
struct SaveButton {
    std::function<void()> action;
};

using BarItem = std::variant<ActivityIndicator, Label, FlexibleSpace, SaveButton>;
using BarItems = std::vector<BarItem>; ///< from left to right

struct Alert {
    std::string title;
    std::string message;
    std::string button; ///< the only button; it closes the alert
};

} // namespace pallax::ui
