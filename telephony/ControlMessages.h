#pragma once

#include "platform/TelephonyService.h"
#include "plist/PropertyList.h"
#include "text/Bytes.h"

#include <optional>
#include <string>
#include <string_view>

/// The messages between clients and the telephony service, XML property lists:
///
///   to the control port    {"CreateLogChannel": local port name}
///   its answer             {"ErrorDomain": number, "ErrorCode": number, "RemotePort": port name}
///   to a channel's port    {"GetTechnology": "GetTechnology"}
///   its answer             {"GetTechnology": technology identifier}
///   to a channel's port    the technology's start command; no answer
namespace pallax {

inline constexpr std::string_view kTelephonyControlPort = "com.norvane.telephony";

/// The error domain of the service; its codes are errno values.
inline constexpr std::int32_t kServiceErrorDomain = 1;
/// The error domain of the connection to the service; its codes are those of SendError.
inline constexpr std::int32_t kPortErrorDomain = 2;

/// The bytes of a message; nothing if XML cannot represent one of its texts.
std::optional<ByteBuffer> encodeMessage(const Dictionary& message);
/// The dictionary in a message; nothing for any other content.
std::optional<Dictionary> decodeMessage(Bytes bytes);
/// The string under `key`.
std::optional<std::string> stringIn(const Dictionary& message, std::string_view key);

Dictionary createLogChannelRequest(std::string_view localPortName);
Dictionary createLogChannelReply(const LogChannel& channel);
/// Nothing if the reply lacks its numbers.
std::optional<LogChannel> parseCreateLogChannelReply(const Dictionary& reply);

} // namespace pallax
