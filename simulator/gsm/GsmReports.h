#pragma once

#include "simulator/Modem.h"

/// The GSM/UMTS modem's measurements of a scenario, and reports of its links.
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

/// A level relative to the carrier's, in dB.
double ecno_db(const Scenario& scenario, double level_dbm);

} // namespace pallax::gsm
