#pragma once

#include <cstddef>
#include <functional>
#include <stdexcept>
#include <string>
#include <string_view>

namespace pallax {

/// Whoever reads our output has gone, or does not take it while a signal asks us to end: a reason
/// to end quietly, not a failure.
class OutputClosed : public std::runtime_error {
public:
    OutputClosed() : std::runtime_error("the output was closed") {}
};

/// The output cannot be written on (a full disk); the text is one clear sentence.
class OutputFailure : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// Text that is gathered and handed on in big blocks.
class Output {
public:
    static constexpr std::size_t kBlockSize = std::size_t{64} << 10U;

    /// Takes a whole block, or throws.
    using Write = std::function<void(std::string_view block)>;

    explicit Output(Write write) : _write(std::move(write)) {}
    ~Output() = default;
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;

    /// Where the next text is appended.
    std::string& text() { return _text; }
    /// To be called after each line or row: hands the text on once it makes a block.
    void lineDone();
    /// Hands on what is there. Nothing is handed on at destruction, for that may throw.
    void flush();

private:
    Write _write;
    std::string _text;
    std::string _taken; // the block being written; both keep their memory
};

/// Writes whole blocks of text to a file descriptor; throws OutputClosed when it is a pipe that
/// nobody reads (SIGPIPE must be ignored) and when an Interruption is due, OutputFailure that names
/// `name` otherwise. A terminal gets what commands it as escapes (platform/Printable); files and
/// pipes get the text as it is.
Output::Write writeToDescriptor(int descriptor, std::string name);

} // namespace pallax
