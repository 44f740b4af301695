#pragma once

#include "simulator/Modem.h"

/// What the GSM/UMTS modem measures of a scenario, and what it tells of its links.
namespace pallax::gsm {

/// The strongest UMTS cells; none behind a hill.
void reportSearcher(const Scenario& scenario, Random& random, ByteBuffer& out);
void reportUmtsRanking(const Scenario& scenario, Random& random, ByteBuffer& out);
void reportGsmRanking(const Scenario& scenario, Random& random, ByteBuffer& out);
void reportTransmitPower(const Scenario& scenario, Random& random, ByteBuffer& out);
void reportBlockErrors(const Scenario& scenario, Random& random, ByteBuffer& out);
void reportHsdpa(const Scenario& scenario, Random& random, ByteBuffer& out);

/// The serving GSM cell and its neighbours.
void reportMeasurement(const Scenario& scenario, Random& random, ByteBuffer& out);
void reportBsics(const Scenario& scenario, ByteBuffer& out);

/// A level's part of the carrier, in dB.
double ecno_db(const Scenario& scenario, double level_dbm);

} // namespace pallax::gsm
