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

/// Thrown by an element accessor of a record layout when the index is not below the element
/// count that the record itself carries. Nothing in the core catches it.
class ArrayOutOfBoundsException : public std::exception {
public:
    const char* what() const noexcept override {
        return "an element index at or past the record's own element count";
    }
};

} // namespace pallax
