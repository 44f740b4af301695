#include "fleet/AnswerRows.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>

// Answers of servers: any bytes are rows or none, and the same in pieces of any size.

namespace {

/// The cells of all rows; -1 for what is no answer.
long cellsOf(std::string_view answer, std::size_t piece) {
    long cells = 0;
    pallax::AnswerRows rows([&](const auto& names) { cells += static_cast<long>(names.size()); },
                            [&](const auto& row) { cells += static_cast<long>(row.size()); });
    try {
        for (std::size_t at = 0; at < answer.size(); at += piece) {
            rows.add(answer.substr(at, piece));
        }
        rows.finish();
    } catch (const pallax::NoAnswer&) {
        return -1;
    }
    return cells;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view answer(static_cast<const char*>(static_cast<const void*>(data)), size);
    if (cellsOf(answer, std::max<std::size_t>(size, 1)) != cellsOf(answer, 3)) {
        std::abort();
    }
    return 0;
}
