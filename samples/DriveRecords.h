#pragma once

#include "plist/PropertyList.h"
#include "text/Bytes.h"

#include <cstdint>
#include <vector>

/// The log records of the drive sample, each with the transport prefix, from values in engineering
/// units. Levels are in dBm, energies in dB.
namespace pallax {

/// A UMTS cell as the searcher sees it.
struct UmtsCell {
    unsigned scramblingCode;
    unsigned uarfcn;
    int rscp_dbm;
    int ecno_db;
};

/// A GSM cell as the serving cell measures it.
struct GsmCell {
    unsigned arfcn;
    unsigned bsic;
    int rxLevel_dbm;
};

/// A log record of up to a few payload bytes, padded to its minimum length.
ByteBuffer plainRecord(unsigned logCode, const std::vector<unsigned>& payload, std::size_t length);

/// 0x7135: service, identity and areas of the serving network.
ByteBuffer servingPlmnRecord(unsigned lac, unsigned rac);
/// 0x7150: one equivalent network, 262-20.
ByteBuffer equivalentPlmnRecord();

/// 0x417A: the active cell, which is the first, and its neighbours in the monitored set.
ByteBuffer searcherRecord(const std::vector<UmtsCell>& cells);
/// 0x4005: the ranking of the UMTS cells, or of the GSM cells if there are no UMTS cells.
ByteBuffer rankingRecord(const std::vector<UmtsCell>& umts, const std::vector<GsmCell>& gsm);
/// 0x4127: identity and frequencies of the serving cell.
ByteBuffer umtsIdentityRecord(unsigned uarfcn, unsigned cellId, unsigned ura);
/// 0x4031: transmit power, as two samples of a slot.
ByteBuffer transmitPowerRecord(int power_dbm);
/// 0x4116: blocks received and in error on two transport channels.
ByteBuffer blerRecord(unsigned window, unsigned received, unsigned errors);
/// 0x4221: two primary HARQ processes, and on two carriers also a secondary one.
enum class Carriers { One, Two };
ByteBuffer hsdpaRecord(unsigned subFrames, unsigned receivedBits, unsigned errors,
                       Carriers carriers);

/// 0x5134: identity of the serving GSM cell.
ByteBuffer gsmIdentityRecord(const GsmCell& cell, unsigned cellId);
/// 0x5137: levels of the serving GSM cell and its neighbours.
ByteBuffer gsmMeasurementRecord(const GsmCell& serving, const std::vector<GsmCell>& neighbours);
/// 0x51FF: the BSICs of the neighbours.
ByteBuffer bsicRecord(const std::vector<GsmCell>& neighbours);

/// 0xFF0001, 0xFF0000 and 0xFF0002: a property list after the header, in one of two forms.
enum class ListForm { Xml, Binary };
ByteBuffer propertyListRecordOf(unsigned logCode, const PropertyList& object, ListForm form);
/// The cell monitor's dictionaries.
PropertyList umtsCellEntry(const UmtsCell& cell, bool serving, unsigned cellId, unsigned lac);
PropertyList gsmCellEntry(const GsmCell& cell, bool serving, unsigned cellId, unsigned lac);

} // namespace pallax
