#pragma once

#include "query/QueryTable.h"

#include <memory>

namespace pallax {

class Timeline;

/// `packet`: a row for each packet.
std::unique_ptr<QueryTable> packetTable(Timeline& timeline);

} // namespace pallax
