#pragma once

#include "console/ExitStatus.h"

namespace pallax {

/// `pallax modem --list`: the modems of this machine.
struct ModemListOptions {};

/// `pallax modem --policy`: what an administrator may add to the system bus.
struct ModemPolicyOptions {};

ExitStatus runModemList(const ModemListOptions& options);
ExitStatus runModemPolicy(const ModemPolicyOptions& options);

} // namespace pallax
