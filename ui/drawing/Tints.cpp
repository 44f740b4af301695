#include "ui/drawing/Tints.h"

#include <array>

namespace pallax::terminal {

namespace {

struct Color {
    int basic;   ///< among the eight that nearly every terminal has
    int indexed; ///< among the 256 of an xterm
};

/// The hues of Okabe and Ito, which people with colour-blindness tell apart, as dark as a text must
/// be on a light background and as light as on a dark one. The basic colours are the nearest ones
/// that differ.
constexpr std::array<Color, 6> kColors{{
    {2, 29},  // green
    {6, 32},  // blue
    {3, 172}, // orange
    {1, 160}, // red
    {5, 139}, // purple
    {4, 63},  // violet
}};

constexpr int kBasicColors = 8;
constexpr int kIndexedColors = 256;
constexpr int kDirectColors = 1 << 24; // a colour's number is its red, green and blue

/// Red, green and blue of a colour in the cube of 6 x 6 x 6 colours among the 256.
constexpr int directColor(int indexed) {
    constexpr int kFirst = 16;
    constexpr int kSide = 6;
    constexpr int kByteBits = 8;
    const auto level = [](int step) { return step == 0 ? 0 : 55 + 40 * step; };
    const int place = indexed - kFirst;
    return level(place / (kSide * kSide)) << (2 * kByteBits) |
           level(place / kSide % kSide) << kByteBits | level(place % kSide);
}

} // namespace

Tint tintOf(Grade grade) {
    switch (grade) {
    case Grade::Excellent:
        return Tint::Green;
    case Grade::Good:
        return Tint::Blue;
    case Grade::Fair:
        return Tint::Orange;
    case Grade::Poor:
    case Grade::None:
        break;
    }
    return Tint::Red;
}

Tint tintOfCurve(std::size_t index) {
    constexpr std::array kOrder{Tint::Blue,   Tint::Orange, Tint::Green,
                                Tint::Purple, Tint::Red,    Tint::Violet};
    return kOrder.at(index % kOrder.size());
}

std::optional<int> colorOf(Tint tint, int colors) {
    if (tint == Tint::None || colors < kBasicColors) {
        return std::nullopt;
    }
    const Color& color = kColors.at(static_cast<std::size_t>(tint) - 1);
    if (colors < kIndexedColors) {
        return color.basic;
    }
    return colors < kDirectColors ? color.indexed : directColor(color.indexed);
}

} // namespace pallax::terminal
