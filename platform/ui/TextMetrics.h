#pragma once

#include "platform/ui/Geometry.h"

#include <string_view>

namespace pallax::ui {

enum class FontFace { System, BoldSystem, Helvetica };

struct Font {
    FontFace face = FontFace::System;
    double size = 0; ///< points
    bool operator==(const Font&) const = default;
};

/// Measures texts.
class TextMetrics {
public:
    virtual ~TextMetrics() = default;
    /// The extent of `text` (UTF-8) on one line, in points.
    virtual Size measure(std::string_view text, const Font& font) const = 0;
};

} // namespace pallax::ui
