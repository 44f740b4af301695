#pragma once

#include "LogGenerator/Records/Description.h"

#include <string>

/// Descriptions in words, without marks of any document.
namespace pallax {

/// The format as printf takes it, without length modifiers: "%4.2f dBm".
std::string printfText(const NumberFormat& format);

/// "0xB17F"
std::string hexadecimal(LogCode logCode);

/// A number as short as it can be: "0.25", "-140".
std::string decimal(double number);

/// "byte 36", "the 16 bits at byte 19", "the 5 bits from bit 6 of byte 19".
std::string inWords(const Position& position);

/// Which bytes a field is read from: "21", "15, 16"; of a property list the key.
std::string placeOf(const FieldDescription& field);
/// How many bits of them: "16", "9 from bit 1", "16 signed"; empty where there is no raw number.
std::string bitsOf(const FieldDescription& field);
/// What is shown of the raw number: a formula, labels, exceptions.
std::string shownOf(const FieldDescription& field);
std::string unitOf(const FieldDescription& field);

/// How the entries of a list lie, and how many there are: a sentence or more.
std::string layoutOf(const ListDescription& list);
/// How long a record must be, and what else must hold: a sentence or more.
std::string demandsOf(const CodeDescription& code);

} // namespace pallax
