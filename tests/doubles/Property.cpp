#include "tests/doubles/Property.h"

#include <rapidcheck.h>

namespace pallax::doubles {

bool holds(const std::function<void()>& property) {
    return rc::check([&property] { property(); });
}

void require(bool condition) {
    RC_PRE(condition);
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

std::int64_t longBetween(std::int64_t low, std::int64_t high) {
    return *rc::gen::resize(rc::kNominalSize, rc::gen::inRange(low, high));
}

std::uint64_t bits() {
    return *rc::gen::resize(rc::kNominalSize, rc::gen::arbitrary<std::uint64_t>());
}

ByteBuffer bytes() {
    return *rc::gen::arbitrary<ByteBuffer>();
}

ByteBuffer bytesBelow(unsigned bound, std::size_t length) {
    const auto byte = rc::gen::map(rc::gen::arbitrary<std::uint8_t>(), [bound](std::uint8_t any) {
        return static_cast<std::uint8_t>(any % bound);
    });
    return *rc::gen::container<ByteBuffer>(length, rc::gen::resize(rc::kNominalSize, byte));
}

std::vector<ByteBuffer> buffers() {
    return *rc::gen::arbitrary<std::vector<ByteBuffer>>();
}

std::string text() {
    return *rc::gen::arbitrary<std::string>();
}

std::string textOf(std::string_view characters) {
    return *rc::gen::container<std::string>(rc::gen::elementOf(std::string(characters)));
}

std::vector<std::string> texts() {
    return *rc::gen::arbitrary<std::vector<std::string>>();
}

std::vector<int> integers(int low, int high) {
    return *rc::gen::container<std::vector<int>>(rc::gen::inRange(low, high));
}

} // namespace any

} // namespace pallax::doubles
