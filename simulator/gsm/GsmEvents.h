#pragma once

#include "simulator/Modem.h"

/// The records of what happens to a GSM/UMTS phone: registration, sessions, cell changes.
namespace pallax::gsm {

void queuePowerOn(RecordQueue& queue);
/// The latest step has brought another phase.
void queuePhase(const Scenario& scenario, RecordQueue& queue);
/// The latest step has brought another serving cell, and maybe the other technology.
void queueServingCell(const Scenario& scenario, RecordQueue& queue);
/// The identity of the serving network.
void encodeServingPlmn(const Scenario& scenario, ByteBuffer& out);

} // namespace pallax::gsm
