#pragma once

#include "text/Bytes.h"

#include <array>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

// The state of the library that computes digests.
struct evp_md_ctx_st;

namespace pallax {

/// A SHA-256 that is being computed.
class Sha256 {
public:
    using Digest = std::array<std::uint8_t, 32>;

    Sha256();
    Sha256& add(Bytes bytes);
    Sha256& add(std::string_view text);
    /// The digest of what was added; a new one begins.
    Digest finishBytes();
    /// The same as 64 hexadecimal digits.
    std::string finish();
    /// The digest of what was added so far; more can be added.
    std::string soFar() const;

private:
    struct Free {
        void operator()(evp_md_ctx_st* context) const;
    };

    void begin();

    std::unique_ptr<evp_md_ctx_st, Free> _state;
};

} // namespace pallax
