#pragma once

#include "overview/Status.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// What a session says about itself, beside the radio.
struct SessionCounts {
    bool isConnected = false;
    std::uint64_t packets = 0;       ///< that have come
    std::uint64_t forgotten = 0;     ///< of these, which the bounded journal had to drop
    std::size_t viewers = 0;         ///< event streams
    std::optional<Time> latest = {}; ///< the time of the latest packet
};

/// The two text forms that scrapers know.
enum class MetricsForm { OpenMetrics, Prometheus };

/// The form that a scraper's Accept header asks for.
MetricsForm metricsFormFor(std::string_view accept);
/// The Content-Type of a form.
std::string metricsType(MetricsForm form);

/// Levels with their grades, states, the identity of the serving cells and the counts. A level that
/// is old is left out, because a scraper would take it for a new one. Nothing in it identifies a
/// person.
std::string metricsText(const std::optional<Status>& status, const SessionCounts& counts,
                        MetricsForm form);

} // namespace pallax
