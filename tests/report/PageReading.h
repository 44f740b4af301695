#pragma once

#include "text/Base64.h"
#include "text/Bytes.h"

#include <zlib.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <string>
#include <string_view>

namespace pallax {

/// The content of an element of a page, inflated; empty if it has none.
inline std::string pageContent(std::string_view page, const std::string& id) {
    const std::string open = "<script type=\"text/plain\" id=\"" + id + "\">";
    const std::size_t begin = page.find(open);
    if (begin == std::string_view::npos) {
        return {};
    }
    const std::size_t end = page.find("</script>", begin);
    auto packed = parseBase64(page.substr(begin + open.size(), end - begin - open.size()));
    EXPECT_TRUE(packed);
    std::string content;
    z_stream stream{};
    constexpr int kRaw = -15;
    EXPECT_EQ(inflateInit2(&stream, kRaw), Z_OK);
    stream.next_in = packed->data();
    stream.avail_in = static_cast<uInt>(packed->size());
    int result = Z_OK;
    while (result == Z_OK) {
        std::string block(65536, '\0');
        stream.next_out = reinterpret_cast<Bytef*>(block.data());
        stream.avail_out = static_cast<uInt>(block.size());
        result = inflate(&stream, Z_NO_FLUSH);
        content.append(block, 0, block.size() - stream.avail_out);
    }
    EXPECT_EQ(result, Z_STREAM_END);
    (void)inflateEnd(&stream);
    return content;
}

/// The words of `numbers-N`.
class PageWords {
public:
    explicit PageWords(std::string bytes) : _bytes(std::move(bytes)) {}

    std::uint32_t next() {
        std::uint32_t word = 0;
        for (unsigned byte = 0; byte < 4; ++byte) {
            word |= std::uint32_t{static_cast<std::uint8_t>(_bytes.at(_at++))} << (8 * byte);
        }
        return word;
    }
    bool isAtEnd() const { return _at == _bytes.size(); }

private:
    std::string _bytes;
    std::size_t _at = 0;
};

} // namespace pallax
