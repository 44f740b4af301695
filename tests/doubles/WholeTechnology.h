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

    /// The subscribers of each log code, in call order.
    std::map<LogCode, Names> subscribers;
    /// The sections in the order of registration, with their numbers of log codes.
    std::vector<std::pair<std::string, int>> registration;
    /// The sections that never show anything.
    std::set<std::string> alwaysEmpty;
    /// The sections whose log codes are in no simulated drive and no sample.
    std::set<std::string> notSimulated = {};

    /// The sections that no simulated drive fills.
    std::set<std::string> emptyInDrives() const {
        std::set<std::string> sections = alwaysEmpty;
        sections.insert(notSimulated.begin(), notSimulated.end());
        return sections;
    }
};

} // namespace pallax::doubles
