#include "decoding/StampSentence.h"

#include "text/Format.h"

#include <chrono>

namespace pallax {

namespace {

double secondsOf(const StampRemark& remark) {
    return std::chrono::duration<double>(remark.size).count();
}

} // namespace

std::string stampSentence(std::string_view source, std::uint64_t packet,
                          const StampRemark& remark) {
    switch (remark.kind) {
    case StampRemark::Kind::StepBack:
        return formatText("%@: packet %llu is %.1f s earlier than the latest packet before it; "
                          "ticks are counted from there.",
                          {source, packet, secondsOf(remark)});
    case StampRemark::Kind::Gap:
        return formatText("%@: no packets for %.1f s before packet %llu.",
                          {source, secondsOf(remark), packet});
    case StampRemark::Kind::OutOfRange:
        break;
    }
    return formatText("%@: the stamp of packet %llu is not between 1970 and 2255; the nearest time "
                      "replaces it and others like it.",
                      {source, packet});
}

std::string stampNote(std::uint64_t packet, const StampRemark& remark) {
    switch (remark.kind) {
    case StampRemark::Kind::StepBack:
        return formatText("Time steps back %.1f s at packet %llu", {secondsOf(remark), packet});
    case StampRemark::Kind::Gap:
        return formatText("No packets for %.1f s before packet %llu", {secondsOf(remark), packet});
    case StampRemark::Kind::OutOfRange:
        break;
    }
    return formatText("The stamp of packet %llu is impossible", {packet});
}

} // namespace pallax
