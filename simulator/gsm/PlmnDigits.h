#pragma once

namespace pallax::gsm {

/// The decimal digit of `number` with this weight: 100, 10 or 1.
constexpr unsigned digit(unsigned number, unsigned weight) {
    constexpr unsigned kBase = 10;
    return number / weight % kBase;
}

} // namespace pallax::gsm
