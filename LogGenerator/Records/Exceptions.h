#pragma once

#include <exception>
#include <stdexcept>
#include <string>

namespace pallax {

/// Thrown by an abstract operation that a subclass has not overridden: a programming error.
class UnrecognisedOperation : public std::logic_error {
public:
    explicit UnrecognisedOperation(const std::string& operation)
        : std::logic_error("unrecognised operation: " + operation) {}
};

/// Thrown by an element accessor when the index is not below the element count that the record
/// carries. The core does not catch it.
class ArrayOutOfBoundsException : public std::exception {
public:
    const char* what() const noexcept override {
        return "an element index at or past the record's own element count";
    }
};

} // namespace pallax
