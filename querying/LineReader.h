#pragma once

#include <cstdio>
#include <string>

namespace pallax {

/// Where the lines of a shell come from.
class LineReader {
public:
    enum class Outcome {
        Line,
        Cleared, ///< the user has taken back the lines since the last statement
        End,
    };

    virtual ~LineReader() = default;
    /// Reads the next line, without its end. `before` are the lines of the statement so far.
    virtual Outcome read(const std::string& before, std::string& line) = 0;
    /// Keeps a whole statement or command for later.
    virtual void remember(const std::string& /*statement*/) {}
};

/// The longest statement, in bytes.
inline constexpr std::size_t kLongestStatement = std::size_t{1} << 20U;

inline constexpr const char* kPrompt = "pallax> ";
inline constexpr const char* kPromptOfMore = "   ...> "; ///< for further lines of a statement

/// Lines as they are; one that is too long for a statement comes in parts. With a prompt on
/// standard error, for a user, and Ctrl-C takes a line back.
class PlainLines final : public LineReader {
public:
    PlainLines(std::FILE& file, bool hasPrompt) : _file(file), _hasPrompt(hasPrompt) {}
    Outcome read(const std::string& before, std::string& line) override;

private:
    std::FILE& _file;
    bool _hasPrompt;
};

} // namespace pallax
