#pragma once

#include "knowledge/Quality.h"
#include "sources/Source.h"
#include "telephony/PacketPlayer.h"

#include <cstdint>
#include <optional>
#include <string>

namespace pallax {

/// `pallax web`: a live page for browsers.
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
};

} // namespace pallax
