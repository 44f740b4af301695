#pragma once

#include <string>
#include <vector>

namespace pallax::doubles {

/// An item of the protocol analyser's output for a packet, with the items below it.
struct AnalyserItem {
    std::string label;
    std::vector<AnalyserItem> items;

    /// "-94.50 dBm" for "Measured RSRP: -94.50 dBm"; empty if there is no value.
    std::string value() const;
    /// "Measured RSRP" for the same label.
    std::string key() const;
    bool hasValue() const { return label.find(": ") != std::string::npos || label.ends_with(":"); }

    const AnalyserItem* find(const std::string& itsKey) const;
};

/// The items of the protocol `title` for each packet in the analyser's text with all details.
std::vector<AnalyserItem> packetsIn(const std::string& text, const std::string& title);

} // namespace pallax::doubles
