#pragma once

#include "console/ExitStatus.h"

namespace pallax {

struct EventsOptions;

/// `pallax events --live`: writes the events of the live modem as they happen. TemplateFailure,
/// OutputClosed and OutputFailure leave.
ExitStatus runLiveEvents(EventsOptions options);

} // namespace pallax
