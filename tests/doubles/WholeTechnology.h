#pragma once

#include "LogGenerator/Records/LogCode.h"

#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

namespace pallax::doubles {

/// All records of a technology, by their sections; written by hand.
struct WholeTechnology {
    using Names = std::vector<std::string>;

    /// Who gets the packets of a log code, in call order.
    std::map<LogCode, Names> subscribers;
    /// In the order of registration, each with the number of its log codes.
    std::vector<std::pair<std::string, int>> registration;
    /// Those that show nothing, whatever the modem sends.
    std::set<std::string> alwaysEmpty;
    /// Those whose log codes are in no simulated drive and no sample.
    std::set<std::string> notSimulated = {};

    /// Those that no simulated drive fills.
    std::set<std::string> emptyInDrives() const {
        std::set<std::string> sections = alwaysEmpty;
        sections.insert(notSimulated.begin(), notSimulated.end());
        return sections;
    }
};

} // namespace pallax::doubles
