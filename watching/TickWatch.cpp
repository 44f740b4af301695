#include "watching/TickWatch.h"

#include "decoding/EventLine.h"
#include "text/Format.h"

#include <algorithm>
#include <cctype>

namespace pallax {

namespace {

/// "PALLAX_MEASURED_RSRP" for the column "measured_rsrp".
std::string variableName(std::string_view column) {
    std::string name = "PALLAX_";
    for (const char character : column) {
        const auto byte = static_cast<unsigned char>(character);
        name += std::isalnum(byte) != 0 ? static_cast<char>(std::toupper(byte)) : '_';
    }
    return name;
}

} // namespace

void TickWatch::show(const DisplayMoment& moment, const PropertyList& /*display*/) {
    const StateMoment state{moment.time, moment.packet, moment.number};
    const HeldCondition::Change change = _held.at(moment.time, _setup.condition.holds(state));
    if (change == HeldCondition::Change::Ended) {
        const auto seconds = std::chrono::round<std::chrono::seconds>(_held.held());
        write(moment.time, "ended",
              formatText("%@ (held for %lld s)", {_setup.words, seconds.count()}));
    } else if (change == HeldCondition::Change::BecameTrue) {
        _hasHeld = true;
        write(moment.time, "holds", _setup.words);
        const std::string time = isoTimeText(moment.time);
        _setup.output.flush(); // the action may write to the same place
        _setup.action.run(time, variables(state, time));
    }
}

void TickWatch::write(Time time, std::string_view kind, const std::string& words) {
    appendEventLine(_setup.output.text(), {_setup.named, time, kind, words}, _setup.zone);
    _setup.output.lineDone();
}

WatchAction::Variables TickWatch::variables(const StateMoment& moment,
                                            const std::string& time) const {
    WatchAction::Variables all{{"PALLAX_CONDITION", _setup.words},
                               {"PALLAX_TIME", time},
                               {"PALLAX_PACKET", std::to_string(moment.packet)},
                               {"PALLAX_SOURCE", _setup.source}};
    for (auto& [column, text] : _setup.condition.named(moment)) {
        const std::string name = variableName(column);
        const bool isTaken = std::any_of(all.begin(), all.end(),
                                         [&name](const auto& each) { return each.first == name; });
        if (!isTaken) {
            all.emplace_back(name, text);
        }
    }
    return all;
}

} // namespace pallax
