#pragma once

#include "plist/PropertyList.h"
#include "report/ReportBuilder.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The data of one recording in a page: two elements, `figures-N` with JSON and `numbers-N` with
/// 32-bit little-endian words, each deflated (RFC 1951) and in base64. `place` is N, from 0.
///
/// The JSON is {"figures": …, "series": [id …], "paths": [[key …] …], "texts": [text …]}.
/// The words are the ticks: their number and the milliseconds of each since the one before, the
/// first of them since the first tick, as signed numbers; then, for each series, the number of its
/// changes, the distance in ticks of each to the one before, and the values (IEEE 754); then the
/// same for each path, with places in `texts` as values, of which 0 is nothing.
std::string pageData(const Dictionary& figures, const ReportBuilder& report, std::size_t place);

/// An element of that kind, with any content.
std::string pageElement(const std::string& id, std::string_view content);

} // namespace pallax
