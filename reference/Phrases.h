#pragma once

#include "fields/Description.h"

#include <string>

/// Descriptions in words, without the markup of a document.
namespace pallax {

/// The format as printf takes it, without length modifiers: "%4.2f dBm".
std::string printfText(const NumberFormat& format);

/// "0xB17F"
std::string hexadecimal(LogCode logCode);

/// The shortest form of a number: "0.25", "-140".
std::string decimal(double number);

/// "byte 36", "the 16 bits at byte 19", "the 5 bits from bit 6 of byte 19".
std::string inWords(const Position& position);

/// The bytes of a field: "21", "15, 16"; for a property list, the key.
std::string placeOf(const FieldDescription& field);
/// The bits of a field: "16", "9 from bit 1", "16 signed"; empty without a raw number.
std::string bitsOf(const FieldDescription& field);
/// How the raw number is shown: a formula, labels, exceptions.
std::string shownOf(const FieldDescription& field);
std::string unitOf(const FieldDescription& field);

/// The layout and the number of a list's entries: one or more sentences.
std::string layoutOf(const ListDescription& list);
/// The required length of a log record and other conditions: one or more sentences.
std::string demandsOf(const CodeDescription& code);

} // namespace pallax
