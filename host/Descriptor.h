#pragma once

#include <unistd.h>
#include <utility>

namespace pallax {

/// Owns a file descriptor.
class Descriptor {
public:
    Descriptor() = default;
    explicit Descriptor(int number) : _number(number) {}
    ~Descriptor() { reset(); }
    Descriptor(Descriptor&& other) noexcept : _number(std::exchange(other._number, kNone)) {}
    Descriptor& operator=(Descriptor&& other) noexcept {
        if (this != &other) {
            reset();
            _number = std::exchange(other._number, kNone);
        }
        return *this;
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    explicit operator bool() const { return _number != kNone; }
    int number() const { return _number; }
    void reset() {
        if (_number != kNone) {
            (void)::close(std::exchange(_number, kNone));
        }
    }

private:
    static constexpr int kNone = -1;
    int _number = kNone;
};

} // namespace pallax
