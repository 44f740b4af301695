#pragma once

#include "platform/ui/TextMetrics.h"

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace pallax::doubles {

/// Text metrics with round numbers: the width of a byte depends on the face but not on the size of
/// the font. A text with an extent set by a test has that extent in every font.
class FakeTextMetrics final : public ui::TextMetrics {
public:
    static constexpr double kBoldWidth = 9;
    static constexpr double kPlainWidth = 8;
    static constexpr double kHeight = 18;

    std::map<std::string, ui::Size, std::less<>> extents;
    mutable std::vector<std::pair<std::string, ui::Font>> measured; ///< every call

    ui::Size measure(std::string_view text, const ui::Font& font) const override {
        measured.emplace_back(text, font);
        if (const auto set = extents.find(text); set != extents.end()) {
            return set->second;
        }
        const double width = font.face == ui::FontFace::BoldSystem ? kBoldWidth : kPlainWidth;
        return {width * static_cast<double>(text.size()), kHeight};
    }
};

} // namespace pallax::doubles
