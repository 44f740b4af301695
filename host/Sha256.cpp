#include "host/Sha256.h"

#include <openssl/evp.h>
#include <stdexcept>

namespace pallax {

namespace {

void require(bool isDone) {
    if (!isDone) {
        throw std::runtime_error("A digest cannot be computed.");
    }
}

} // namespace

void Sha256::Free::operator()(evp_md_ctx_st* context) const {
    EVP_MD_CTX_free(context);
}

Sha256::Sha256() : _state(EVP_MD_CTX_new()) {
    require(_state != nullptr);
    begin();
}

void Sha256::begin() {
    require(EVP_DigestInit_ex(_state.get(), EVP_sha256(), nullptr) == 1);
}

Sha256& Sha256::add(Bytes bytes) {
    require(EVP_DigestUpdate(_state.get(), bytes.data(), bytes.size()) == 1);
    return *this;
}

Sha256& Sha256::add(std::string_view text) {
    require(EVP_DigestUpdate(_state.get(), text.data(), text.size()) == 1);
    return *this;
}

Sha256::Digest Sha256::finishBytes() {
    Digest digest{};
    require(EVP_DigestFinal_ex(_state.get(), digest.data(), nullptr) == 1);
    begin();
    return digest;
}

std::string Sha256::finish() {
    constexpr std::string_view kHexDigits = "0123456789abcdef";
    constexpr unsigned kHalfBits = 4;
    constexpr unsigned kHalf = 0xF;
    std::string text;
    for (const std::uint8_t byte : finishBytes()) {
        text += kHexDigits[byte >> kHalfBits];
        text += kHexDigits[byte & kHalf];
    }
    return text;
}

std::string Sha256::soFar() const {
    Sha256 copy;
    require(EVP_MD_CTX_copy_ex(copy._state.get(), _state.get()) == 1);
    return copy.finish();
}

} // namespace pallax
