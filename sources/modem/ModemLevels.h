#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// What ModemManager measures, with the unit and the values that can be true.
enum class LevelKind { Rssi, Rscp, Rsrp, Rsrq, Sinr, EcIo, PathLoss };

/// "-96.0 dBm"; nothing for a value that cannot be true.
std::optional<std::string> levelText(LevelKind kind, double value);

} // namespace pallax
