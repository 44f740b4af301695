#pragma once

#include "text/Bytes.h"

#include <cstddef>
#include <string_view>
#include <vector>

namespace pallax {

/// Something that looks like a person's identity.
struct FoundIdentity {
    enum class Kind {
        Imsi,  ///< 15 digits that begin with an assigned mobile country code
        Imei,  ///< 15 digits with a valid check digit
        Iccid, ///< 19 or 20 digits that begin with 89, with a valid check digit
        Phone, ///< a number in international form, of 7 to 15 digits
    };
    enum class Coding {
        Text,  ///< a byte for each digit
        Utf16, ///< of either byte order
        Bcd,   ///< two digits in a byte, as on a SIM or the other way round
    };

    std::size_t offset; ///< of the first byte
    std::size_t length; ///< in bytes
    Kind kind;
    Coding coding;
};

/// "IMSI"
std::string_view nameOf(FoundIdentity::Kind kind);
/// "text"
std::string_view nameOf(FoundIdentity::Coding coding);

/// Everything that looks like an identity, in the order of the bytes.
///
/// Packed digits need more than the digits to be recognised, since any bytes contain some: an IMSI
/// or IMEI its length and type (3GPP TS 24.008, 10.5.1.4), a phone number its length and
/// international type, an ICCID its leading 89.
std::vector<FoundIdentity> findIdentities(Bytes bytes);
/// The same of a text.
bool hasIdentity(std::string_view text);

} // namespace pallax
