#pragma once

#include "LogGenerator/Records/Layout.h"
#include "LogGenerator/Records/SampleValue.h"
#include "text/Date.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>

namespace pallax {

/// The number of a row in a technology's registry of fields: the rows of its layouts, in the order
/// of their registration. An object stream numbers its paths in the order of their arrival.
using FieldId = std::uint32_t;

/// One field read from one packet. Valid while the sink looks at it.
struct Sample {
    FieldId id;
    const Field& field;
    /// The number behind the value; nothing for a value of a property list that is no number, for
    /// one that is computed, and for a text of an object stream.
    std::optional<std::int64_t> raw;
    const SampleValue& value;
};

/// The packet that samples come from.
struct SamplePacket {
    std::uint64_t number = 0; ///< in its source, from 1; 0: not known
    Time time = {};
};

/// A list that a packet replaces. `layout` is null for one that a property list tells of.
struct SampleList {
    std::string_view key; ///< empty: the section is the list
    const ListLayout* layout = nullptr;
    std::size_t count = 0; ///< of the entries to come, at most
};

/// Takes samples. What comes between the begin and the end of a packet belongs together, as does
/// what comes between the begin and the end of a list or of an entry. A list that is emptied begins
/// and ends without entries.
class SampleSink {
public:
    /// Whether it gets what is kept from the display, too.
    static constexpr bool kTakesHidden = true;

    virtual ~SampleSink() = default;
    virtual void beginPacket(const SamplePacket& /*packet*/) {}
    virtual void endPacket() {}
    /// What follows belongs to that section. Technologies without sections do not call it.
    virtual void beginSection(std::string_view /*section*/) {}

    virtual void sample(const Sample& sample) = 0;
    virtual void keyRemoved(std::string_view key) = 0;
    virtual void beginList(const SampleList& list) = 0;
    virtual void endList() = 0;
    /// `name`: of a list by pilot the PN offset, else 0.
    virtual void beginEntry(std::size_t index, std::int64_t name) = 0;
    virtual void endEntry() = 0;
};

} // namespace pallax
