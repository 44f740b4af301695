#include "telephony/ControlMessages.h"

#include "plist/PropertyListCodec.h"

namespace pallax {

namespace {

std::optional<std::int32_t> numberIn(const Dictionary& message, std::string_view key) {
    const PropertyList* value = message.find(key);
    return value != nullptr ? value->int32() : std::nullopt;
}

} // namespace

std::optional<ByteBuffer> encodeMessage(const Dictionary& message) {
    const auto text = serializeXml(PropertyList(message));
    return text ? std::optional(ByteBuffer(text->begin(), text->end())) : std::nullopt;
}

std::optional<Dictionary> decodeMessage(Bytes bytes) {
    const auto parsed = parsePropertyList(bytes);
    const DictionaryRef message = parsed ? parsed->dictionary() : nullptr;
    return message ? std::optional(*message) : std::nullopt;
}

std::optional<std::string> stringIn(const Dictionary& message, std::string_view key) {
    const PropertyList* value = message.find(key);
    return value != nullptr ? value->string() : std::nullopt;
}

Dictionary createLogChannelRequest(std::string_view localPortName) {
    return {{"CreateLogChannel", std::string(localPortName)}};
}

Dictionary createLogChannelReply(const LogChannel& channel) {
    Dictionary reply{{"ErrorDomain", PropertyList::integer(channel.errorDomain)},
                     {"ErrorCode", PropertyList::integer(channel.errorCode)}};
    if (channel.remotePortName) {
        reply.set("RemotePort", *channel.remotePortName);
    }
    return reply;
}

std::optional<LogChannel> parseCreateLogChannelReply(const Dictionary& reply) {
    const auto domain = numberIn(reply, "ErrorDomain");
    const auto code = numberIn(reply, "ErrorCode");
    if (!domain || !code) {
        return std::nullopt;
    }
    return LogChannel{*domain, *code, stringIn(reply, "RemotePort")};
}

} // namespace pallax
