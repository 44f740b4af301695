#pragma once

#include <string>
#include <vector>

namespace pallax::doubles {

/// What the protocol analyser shows of a packet: an item and those below it.
struct AnalyserItem {
    std::string label;
    std::vector<AnalyserItem> items;

    /// "-94.50 dBm" of "Measured RSRP: -94.50 dBm"; empty where there is no value.
    std::string value() const;
    /// "Measured RSRP" of it.
    std::string key() const;
    bool hasValue() const { return label.find(": ") != std::string::npos || label.ends_with(":"); }

    const AnalyserItem* find(const std::string& itsKey) const;
};

/// The items of each packet's protocol `title`, out of the analyser's text with all details.
std::vector<AnalyserItem> packetsIn(const std::string& text, const std::string& title);

} // namespace pallax::doubles
