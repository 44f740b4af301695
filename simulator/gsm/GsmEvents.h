#pragma once

#include "simulator/Modem.h"

/// The log records for a GSM/UMTS phone's events: registration, sessions, cell changes.
namespace pallax::gsm {

void queuePowerOn(RecordQueue& queue);
/// The latest step has changed the phase.
void queuePhase(const Scenario& scenario, RecordQueue& queue);
/// The latest step has changed the serving cell, and maybe the technology.
void queueServingCell(const Scenario& scenario, RecordQueue& queue);
/// The identity of the serving network.
void encodeServingPlmn(const Scenario& scenario, ByteBuffer& out);

} // namespace pallax::gsm
