#include "tests/doubles/Property.h"

#include <rapidcheck.h>

namespace pallax::doubles {

bool holds(const std::function<void()>& property) {
    return rc::check([&property] { property(); });
}

namespace any {

bool boolean() {
    return *rc::gen::arbitrary<bool>();
}

std::uint8_t byte() {
    return *rc::gen::arbitrary<std::uint8_t>();
}

std::int64_t integer() {
    return *rc::gen::arbitrary<std::int64_t>();
}

double real() {
    return *rc::gen::arbitrary<double>();
}

int between(int low, int high) {
    return *rc::gen::inRange(low, high);
}

ByteBuffer bytesBelow(unsigned bound, std::size_t length) {
    const auto byte = rc::gen::map(rc::gen::arbitrary<std::uint8_t>(), [bound](std::uint8_t any) {
        return static_cast<std::uint8_t>(any % bound);
    });
    return *rc::gen::container<ByteBuffer>(length, rc::gen::resize(rc::kNominalSize, byte));
}

} // namespace any

} // namespace pallax::doubles
