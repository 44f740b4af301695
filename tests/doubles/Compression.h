#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <zlib.h>
#include <zstd.h>

namespace pallax::doubles {

/// As the program gzip would write it, without a name.
inline std::string gzipOf(std::string_view content) {
    constexpr int kGzip = 15 + 16;
    constexpr int kMemory = 8;
    z_stream stream{};
    (void)::deflateInit2(&stream, Z_DEFAULT_COMPRESSION, Z_DEFLATED, kGzip, kMemory,
                         Z_DEFAULT_STRATEGY);
    std::string compressed(::deflateBound(&stream, content.size()), '\0');
    std::string input(content);
    stream.next_in = reinterpret_cast<Bytef*>(input.data());
    stream.avail_in = static_cast<uInt>(input.size());
    stream.next_out = reinterpret_cast<Bytef*>(compressed.data());
    stream.avail_out = static_cast<uInt>(compressed.size());
    (void)::deflate(&stream, Z_FINISH);
    compressed.resize(stream.total_out);
    (void)::deflateEnd(&stream);
    return compressed;
}

/// With a checksum, as the program zstd would write it.
inline std::string zstdOf(std::string_view content) {
    ZSTD_CCtx* context = ::ZSTD_createCCtx();
    (void)::ZSTD_CCtx_setParameter(context, ZSTD_c_checksumFlag, 1);
    std::string compressed(::ZSTD_compressBound(content.size()), '\0');
    compressed.resize(::ZSTD_compress2(context, compressed.data(), compressed.size(),
                                       content.data(), content.size()));
    (void)::ZSTD_freeCCtx(context);
    return compressed;
}

} // namespace pallax::doubles
