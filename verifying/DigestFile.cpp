#include "verifying/DigestFile.h"

#include "text/Format.h"

#include <charconv>
#include <optional>

namespace pallax {

namespace {

constexpr std::string_view kHead = "pallax-verify 1";
constexpr std::string_view kEnd = "end";

/// Takes a word and the blank after it.
std::string_view takeWord(std::string_view& line) {
    const std::size_t end = line.find(' ');
    const std::string_view word = line.substr(0, end);
    line.remove_prefix(end == std::string_view::npos ? line.size() : end + 1);
    return word;
}

template <class Number>
std::optional<Number> numberIn(std::string_view word) {
    Number number = 0;
    const char* const last = word.data() + word.size();
    const auto [end, error] = std::from_chars(word.data(), last, number);
    return error == std::errc() && end == last ? std::optional(number) : std::nullopt;
}

bool isDigest(std::string_view word) {
    constexpr std::size_t kDigits = 64;
    return word.size() == kDigits &&
           word.find_first_not_of("0123456789abcdef") == std::string_view::npos;
}

bool takeDecoded(RecordingDigest& digest, std::string_view line) {
    const auto minute = numberIn<std::int64_t>(takeWord(line));
    const std::string field(takeWord(line));
    if (!minute || field.empty() || !isDigest(line)) {
        return false;
    }
    return digest.decoded.emplace(RecordingDigest::Decoded{*minute, field}, line).second;
}

bool takeLine(RecordingDigest& digest, std::string_view line) {
    const std::string_view what = takeWord(line);
    if (what == "decoder") {
        digest.decoder = line;
        return true;
    }
    if (what == "technology") {
        digest.technology = line;
        return true;
    }
    if (what == "packets") {
        const auto number = numberIn<std::uint64_t>(line);
        digest.packets = number.value_or(0);
        return number.has_value();
    }
    if (what == "first") {
        const auto number = numberIn<std::int64_t>(line);
        digest.first = Time(std::chrono::nanoseconds(number.value_or(0)));
        return number && digest.first >= kEarliestTime && digest.first <= kLatestTime;
    }
    if (what == "block") {
        digest.blocks.emplace_back(line);
        return isDigest(line);
    }
    return what == "decoded" && takeDecoded(digest, line);
}

} // namespace

std::string textOfDigest(const RecordingDigest& digest) {
    std::string text = formatText("%@\ndecoder %@\ntechnology %@\npackets %llu\nfirst %lld\n",
                                  {kHead, digest.decoder, digest.technology, digest.packets,
                                   digest.first.time_since_epoch().count()});
    for (const std::string& block : digest.blocks) {
        text += formatText("block %@\n", {block});
    }
    for (const auto& [decoded, value] : digest.decoded) {
        text += formatText("decoded %lld %@ %@\n", {decoded.minute, decoded.field, value});
    }
    return text.append(kEnd).append("\n");
}

Result<RecordingDigest, DigestFileError> digestInText(std::string_view text) {
    RecordingDigest digest;
    std::size_t number = 0;
    bool hasEnded = false;
    while (!text.empty()) {
        const std::size_t end = text.find('\n');
        const std::string_view line = text.substr(0, end);
        text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
        ++number;
        const bool isHead = number == 1 && line == kHead;
        if (hasEnded || (!isHead && (number == 1 || (line != kEnd && !takeLine(digest, line))))) {
            return DigestFileError{formatText("line %zu is no line of digests", {number})};
        }
        hasEnded = line == kEnd;
    }
    const std::uint64_t blocks =
        (digest.packets + RecordingDigest::kPacketsOfBlock - 1) / RecordingDigest::kPacketsOfBlock;
    if (!hasEnded || digest.blocks.size() != blocks) {
        return DigestFileError{"it is cut"};
    }
    return digest;
}

std::string digestFileOf(const std::string& recording) {
    return recording + ".pallax-verify";
}

} // namespace pallax
