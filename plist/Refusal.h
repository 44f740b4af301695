#pragma once

#include "plist/PropertyListCodec.h"

#include <cstddef>
#include <string>
#include <utility>

namespace pallax {

/// Thrown by a reader or writer of property lists to give up from within its recursion. Internal to
/// the codecs: `refusedOr` turns it into the error of a result.
struct Refusal {
    CodecError error;
};

[[noreturn]] inline void refuse(std::size_t offset, std::string reason) {
    throw Refusal{{offset, std::move(reason)}};
}

/// The result of `work`, or the reason for its refusal.
template <class Output, class Work>
Result<Output, CodecError> refusedOr(const Work& work) {
    try {
        return work();
    } catch (Refusal& refusal) {
        return std::move(refusal.error);
    }
}

/// Refuses an input that is empty or too large, before reading it.
inline void requireReadableSize(Bytes bytes) {
    if (bytes.empty()) {
        refuse(0, "an empty input");
    }
    if (bytes.size() > kLargestPropertyList) {
        refuse(kLargestPropertyList, "an input larger than 64 MiB");
    }
}

/// `depth` counts the containers around a container, including itself.
inline void requireDepth(std::size_t offset, std::size_t depth) {
    if (depth > kDeepestPropertyList) {
        refuse(offset, "containers nested deeper than 512");
    }
}

} // namespace pallax
