#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "fields/Reference.h"
#include "host/Recording.h"
#include "packets/StampSequence.h"
#include "plist/PropertyListCodec.h"

#include <array>
#include <chrono>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pallax {

/// What a recording holds, counted packet by packet without decoding. Its memory does not grow with
/// the recording.
class RecordingSummary {
public:
    /// The log codes that a technology's sections read. Must outlive the summaries that use it.
    class Codes {
    public:
        struct Reader {
            std::size_t section; ///< index of `sections`
            std::size_t minimumLength;
            bool exactLength;
        };
        struct Code {
            std::string name; ///< may be empty
            std::vector<Reader> readers;
        };

        explicit Codes(const TechnologyReference& technology);

        /// Null for a code that no section reads.
        const Code* find(LogCode code) const;
        const std::vector<std::string>& sections() const { return _sections; }
        /// Whether messages are property lists, without log codes.
        bool areObjects() const { return _areObjects; }

    private:
        std::unordered_map<LogCode, Code> _codes;
        std::vector<std::string> _sections; ///< in the order of the display
        bool _areObjects;
    };

    struct Count {
        std::uint64_t packets = 0;
        std::uint64_t damaged = 0; ///< of them, those of a length that no section accepts
        std::size_t longest = 0;   ///< record, in bytes
    };
    /// The irregular stamps of one kind.
    struct Stamps {
        static constexpr std::size_t kMostListed = 8;
        struct Listed {
            std::uint64_t packet;
            std::chrono::nanoseconds size;
        };

        std::uint64_t count = 0;
        std::vector<Listed> first; ///< the first few
    };

    /// Without codes, only times are counted.
    explicit RecordingSummary(const Codes* codes) : _codes(codes) {}

    void add(const RecordedPacket& packet);

    std::uint64_t packets() const { return _packets; }
    std::uint64_t bytes() const { return _bytes; } ///< of the packets
    std::optional<Time> first() const { return _first; }
    Time last() const { return _last; }
    /// The time that the stamps cover; where they step back, the sum of the stretches.
    std::chrono::nanoseconds duration() const { return withStretch(); }
    const Stamps& irregular(StampRemark::Kind kind) const { return _irregular.at(index(kind)); }

    const std::map<LogCode, Count>& codes() const { return _counts; }
    /// Messages that are not log records: shorter than a header, or of another log type.
    std::uint64_t notRecords() const { return _notRecords; }
    std::uint64_t damaged() const;
    std::uint64_t unknown() const; ///< packets of codes that no section reads
    /// Messages of an object stream by form; empty ones are in `notRecords`.
    std::uint64_t messages(PropertyListForm form) const {
        return _messages.at(static_cast<std::size_t>(form));
    }
    /// Which of the sections at least one packet can fill.
    std::vector<bool> filled() const;

private:
    static std::size_t index(StampRemark::Kind kind) { return static_cast<std::size_t>(kind) - 1; }
    /// The finished stretches and the current one; limited to the range of a duration.
    std::chrono::nanoseconds withStretch() const;
    void note(StampRemark::Kind kind, std::chrono::nanoseconds size);
    void addTime(const RecordedPacket& packet);
    void addContent(Bytes message);

    const Codes* _codes;
    StampSequence _stamps;
    std::chrono::nanoseconds _covered{0}; ///< by the finished stretches
    std::optional<Time> _first;
    Time _last;
    std::array<Stamps, 3> _irregular;
    std::uint64_t _packets = 0;
    std::uint64_t _bytes = 0;
    std::map<LogCode, Count> _counts;
    std::uint64_t _notRecords = 0;
    std::array<std::uint64_t, 3> _messages{};
};

} // namespace pallax
