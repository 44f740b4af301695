// A time on a command line: any text is a time in the range of recordings, or is refused with a
// sentence and a place in the text.

#include "text/TimeText.h"

#include <cstdint>
#include <cstdlib>
#include <string_view>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace pallax;
    const std::string text(data, data + size);
    const auto parsed = TimeText::parse(text);
    if (!parsed) {
        const TimeTextError& error = parsed.error();
        if (error.place > text.size() || error.sentence.back() != '.') {
            std::abort();
        }
        return 0;
    }
    const auto zone = [](Time time) -> std::chrono::seconds {
        return std::chrono::hours(time < Time(std::chrono::hours(500'000)) ? 2 : -2);
    };
    const Time begin(std::chrono::hours(499'990));
    for (const auto& end : {std::optional(begin + std::chrono::hours(20)), std::optional<Time>()}) {
        const auto time = parsed->timeIn({begin, end}, zone);
        if (time ? *time < kEarliestTime || *time > kLatestTime
                 : time.error().sentence.back() != '.') {
            std::abort();
        }
    }
    return 0;
}
