#include "ui/drawing/Dots.h"

#include "text/Utf8.h"

#include <algorithm>
#include <array>
#include <cstdlib>

namespace pallax::terminal {

namespace {

/// The block of dots U+2800 ... U+28FF has a bit for each dot, in the order in which the dots were
/// added to the alphabet.
constexpr std::array<std::array<unsigned, 2>, 4> kBrailleBits{
    {{0x01, 0x08}, {0x02, 0x10}, {0x04, 0x20}, {0x40, 0x80}}};

constexpr char32_t kFirstBraille = 0x2800;

} // namespace

Dots::Dots(int columns, int rows, Curves curves)
    : _columns(std::max(columns, 0)), _rows(std::max(rows, 0)), _curves(curves),
      _perCell(dotsPerCell(curves)),
      _cells(static_cast<std::size_t>(_columns) * static_cast<std::size_t>(_rows)) {}

void Dots::set(int x, int y) {
    if (x < 0 || x >= across() || y < 0 || y >= down()) {
        return;
    }
    const auto bitX = static_cast<std::size_t>(x % _perCell.across);
    const auto bitY = static_cast<std::size_t>(y % _perCell.down);
    const int cell = y / _perCell.down * _columns + x / _perCell.across;
    const unsigned bit = _curves == Curves::Braille ? kBrailleBits.at(bitY).at(bitX) : 1U << bitY;
    std::uint8_t& bits = _cells[static_cast<std::size_t>(cell)];
    bits = static_cast<std::uint8_t>(bits | bit);
}

void Dots::line(int fromX, int fromY, int toX, int toY) {
    const int steps = std::max(std::abs(toX - fromX), std::abs(toY - fromY));
    for (int step = 0; step <= steps; ++step) {
        const double share = steps == 0 ? 0.0 : static_cast<double>(step) / steps;
        const auto between = [share](int from, int to) {
            constexpr double kHalf = 0.5;
            return from + static_cast<int>((to - from) * share + (to < from ? -kHalf : kHalf));
        };
        set(between(fromX, toX), between(fromY, toY));
    }
}

std::string Dots::textAt(int column, int row) const {
    constexpr std::array<const char*, 4> kBlocks{"", "▀", "▄", "█"}; // upper half, lower half
    const unsigned bits =
        _cells[static_cast<std::size_t>(row) * static_cast<std::size_t>(_columns) +
               static_cast<std::size_t>(column)];
    std::string text;
    switch (_curves) {
    case Curves::Braille:
        if (bits != 0) {
            appendUtf8(text, kFirstBraille + bits);
        }
        return text;
    case Curves::Blocks:
        return kBlocks.at(bits);
    case Curves::Ascii:
        break;
    }
    return bits == 0 ? "" : "*";
}

} // namespace pallax::terminal
