#pragma once

#include "knowledge/Channels.h"
#include "overview/Status.h"

#include <chrono>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// The parts of a status in words, for every front end. Texts of the modem stay as they are, so
/// they may hold characters that command a terminal.
namespace pallax {

/// "Telekom 262-01 (Germany)".
std::string operatorWords(const StatusOperator& network);
/// The parts of a cell's identity: "eNodeB 104470 sector 1"; empty where the system has none.
std::string siteWords(RadioSystem system, double identity);
/// The number of a channel or an identity; nothing if it is none.
std::optional<std::uint32_t> wholeNumber(double number);
/// "eNodeB 104470 sector 1", "PCI 150", "TAC 6699".
std::vector<std::string> identityWords(const StatusCell& cell);
/// "EARFCN 1850", "band 3", "1870.0 MHz"; empty without a channel.
std::vector<std::string> channelWords(const StatusCell& cell);
/// "RRC Idle", or "MM_IDLE" where the value names itself.
std::string stateWords(const StatusValue& state);
/// "ims Active".
std::string contextWords(const StatusContext& context);
/// "excellent"; empty if the profile does not judge the value.
std::string_view qualityWord(const StatusValue& value);
/// "12 s ago".
std::string ageWords(std::chrono::nanoseconds age);
/// The age of the oldest of the values that are old; empty if none is.
std::string oldAgeWords(Time now, const std::vector<const StatusValue*>& values);

/// How far a level is from the worst to the best value of its measure, from 0 to 1; nothing for a
/// value that no profile can judge.
std::optional<double> shareOf(const StatusValue& level);

} // namespace pallax
