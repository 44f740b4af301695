#pragma once

#include "masking/MaskPlan.h"
#include "masking/MaskReport.h"
#include "masking/PathActions.h"
#include "masking/Replacement.h"
#include "text/Bytes.h"

#include <cstddef>
#include <functional>
#include <vector>

namespace pallax {

/// What stands in place of what is masked.
struct Replacements {
    Replacement identities; ///< zeros, unless the user has a key
    Replacement places;     ///< keyed
};

/// Masks the packets of one technology. Not for several threads.
class PacketMask {
public:
    /// Both must outlive it.
    PacketMask(const MaskPlan& plan, const Replacements& replacements)
        : _plan(plan), _replacements(replacements), _byPath(plan) {}

    /// Masks a packet in its bytes and counts what it does. The length stays, except where
    /// `maskList` writes a property list anew.
    void mask(ByteBuffer& packet, MaskReport& report) const;

    /// Visits what `mask` would replace by an identity's replacement and is none yet: the name of
    /// the field or, in a property list, the keys that lead to the value; and its first byte.
    using IdentityVisitor = std::function<void(const ScalarPath& path, std::size_t offset)>;
    void find(const ByteBuffer& packet, const IdentityVisitor& visit) const;

private:
    struct Reading {
        std::size_t payload; ///< where the content begins
        bool isUnderstood;
        std::vector<const CodeDescription*> readers; ///< empty for an object stream
        bool isList;                                 ///< the payload is a property list
    };

    Reading read(const ByteBuffer& packet) const;
    MaskAction actionIn(const Reading& reading, const ScalarPath& path,
                        const PropertyList& value) const;
    void maskObject(ByteBuffer& packet, const Reading& reading, MaskReport& report) const;
    void maskUnknown(ByteBuffer& packet, std::size_t from, MaskReport& report) const;

    const MaskPlan& _plan;
    const Replacements& _replacements;
    PathActions _byPath;
};

} // namespace pallax
