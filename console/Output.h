#pragma once

#include <cstddef>
#include <functional>
#include <stdexcept>
#include <string>
#include <string_view>

namespace pallax {

/// The reader of the output has gone, or does not read while a signal asks the program to end: exit
/// quietly, without failure.
class OutputClosed : public std::runtime_error {
public:
    OutputClosed() : std::runtime_error("the output was closed") {}
};

/// The output cannot be written (a full disk); the text is one sentence.
class OutputFailure : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// Collects text and passes it on in large blocks.
class Output {
public:
    static constexpr std::size_t kBlockSize = std::size_t{64} << 10U;

    /// Writes a whole block, or throws.
    using Write = std::function<void(std::string_view block)>;

    explicit Output(Write write) : _write(std::move(write)) {}
    ~Output() = default;
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;

    /// The text to append to.
    std::string& text() { return _text; }
    /// Call this after each line or row: passes the text on once it fills a block.
    void lineDone();
    /// Passes the remaining text on. The destructor does not, because this may throw.
    void flush();

private:
    Write _write;
    std::string _text;
    std::string _taken; // the block being written; both keep their memory
};

/// Writes whole blocks of text to a file descriptor. Throws OutputClosed for a pipe without a
/// reader (SIGPIPE must be ignored) and when an Interruption is due, otherwise OutputFailure that
/// names `name`. Escapes the text for a terminal (text/Printable); files and pipes get it
/// unchanged.
Output::Write writeToDescriptor(int descriptor, std::string name);

} // namespace pallax
