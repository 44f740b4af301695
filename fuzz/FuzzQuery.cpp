// Any text as a query over a small recording: it gives rows, or is refused with a sentence; it
// never changes the tables.

#include "fuzz/QueryTimeline.h"

#include <cstdint>
#include <cstdlib>
#include <string>

namespace {

std::vector<pallax::QueryValue> countsOf(pallax::Database& database) {
    return *database.prepare("select count(*), (select count(*) from tables) from packet")
                .value()
                .next()
                .value();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace pallax;
    static QueryTimeline timeline;
    const std::string text(data, data + size);
    int questions = 0;
    timeline.database.setMayContinue([&questions] {
        constexpr int kMostQuestions = 50; // of which each stands for some thousand steps
        return ++questions < kMostQuestions;
    });
    auto prepared = timeline.database.prepare(text);
    if (!prepared) {
        const QueryError& error = prepared.error();
        if (error.sentence.empty() || error.place.value_or(0) > text.size()) {
            std::abort();
        }
    } else {
        Query query = std::move(prepared).value();
        constexpr int kMostRows = 1000;
        for (int rows = 0; rows < kMostRows; ++rows) {
            auto row = query.next();
            if (!row) {
                if (row.error().sentence.empty()) {
                    std::abort();
                }
                break;
            }
            if (!*row) {
                break;
            }
            if ((*row)->size() != query.columns().size() || query.columns().empty()) {
                std::abort();
            }
        }
    }
    timeline.database.setMayContinue({});
    static const std::vector<QueryValue> kCounts = countsOf(timeline.database);
    if (countsOf(timeline.database) != kCounts) {
        std::abort();
    }
    return 0;
}
