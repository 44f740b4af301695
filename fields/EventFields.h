#pragma once

#include <optional>
#include <span>
#include <string_view>

namespace pallax {

enum class EventKind {
    CellChange,
    PingPong, ///< a cell change back to the cell before, soon
    StateChange,
    TechnologyChange,
    ServiceLost,
    ServiceRegained,
    ContextUp,
    ContextDown,
    Gap,
    TimeStep,
    FatalRecord,
    Alarm, ///< a viewer's: recordings have none
};

/// "cell-change": one word, for tables and programs.
std::string_view wordOf(EventKind kind);

std::optional<EventKind> eventKindNamed(std::string_view word);

/// Which fields of a technology make an event. Texts and tables live as long as the program.
struct EventFields {
    enum class Watch {
        Cell,       ///< the fields identify the serving cell; each may be missing but the first
        State,      ///< the field is the state of a state machine
        Technology, ///< the modem leaves for another technology when the field gets a `good` value
        Service,    ///< the field tells whether there is service, or a registration
        Contexts,   ///< the field's list has an entry for each context
    };

    std::string_view technology; ///< its name on the command line
    Watch watch;
    std::string_view subject; ///< "serving cell", "RRC", "service"
    /// Of a Cell: the first is the one that the words give when it alone tells the cells apart.
    std::span<const std::string_view> fields;
    /// Of a State: values between which an idle phone changes all the time, without an event.
    /// Of Service: the values of a phone that has it; if there are none, any value.
    std::span<const std::string_view> good = {};
    /// Of a Cell: values of the first field that name none. Of a State: values that tell nothing,
    /// so that the state before them counts. Of Service: the values of a phone that
    /// has lost it, as it has when the field is removed. Values in neither change nothing.
    std::span<const std::string_view> bad = {};
};

/// All rows, by technology. Where several rows have the same technology and subject, other records
/// tell of the same cell; the first row counts whose fields have values.
std::span<const EventFields> eventFields();

} // namespace pallax
