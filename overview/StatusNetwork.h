#pragma once

#include "overview/Status.h"

namespace pallax {

/// The network that serves or, where that is not told, the network of the SIM.
std::optional<StatusOperator> statusNetworkOf(const CurrentValues& values,
                                              const NetworkNames& names);

} // namespace pallax
