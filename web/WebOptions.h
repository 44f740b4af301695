#pragma once

#include "knowledge/Quality.h"
#include "sources/Source.h"
#include "telephony/PacketPlayer.h"
#include "text/TimeText.h"

#include <cstdint>
#include <optional>
#include <string>

namespace pallax {

struct RecordedTechnology;

/// `pallax web`: a live page, or a page of stored measurements, for browsers.
struct WebOptions {
    Source source = {};
    PlayOptions play = {};
    std::string address = "127.0.0.1"; ///< to listen on
    std::uint16_t port = 0;            ///< 0: one that is free
    std::string certificate = {};      ///< a PEM file; empty: no TLS
    std::string key = {};              ///< likewise
    bool metrics = false;
    bool open = false; ///< in the user's browser
    bool withIdentities = false;
    std::optional<std::string> profile = {}; ///< nothing: that of the settings
    std::string store = {}; ///< the file of a store, which is shown instead; empty: the source
    std::optional<std::string> device = {};         ///< of the store; nothing: the only one
    const RecordedTechnology* technology = nullptr; ///< null: the only one of the device
    std::optional<TimeText> from = {};              ///< of what the store has of the device
    std::optional<TimeText> to = {};
};

} // namespace pallax
