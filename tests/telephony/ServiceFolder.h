#pragma once

#include "host/RecordingWriter.h"
#include "plist/PropertyList.h"
#include "tests/doubles/PortPair.h"

#include <stdexcept>
#include <string>

namespace pallax {

using doubles::openDirectory;
using doubles::OtherProcess;
using doubles::runUntil;

/// The stamp of the first packet of every recording made here.
inline constexpr Time kRecordingStart{std::chrono::seconds(1700000000)};

/// A message for comparison; null for none.
inline PropertyList comparable(const std::optional<Dictionary>& message) {
    return message ? PropertyList(*message) : PropertyList();
}

/// A log record that is only a header: `type` 1 or 0xFF, and the 16-bit code.
inline ByteBuffer logRecord(std::uint8_t type, std::uint16_t code) {
    constexpr std::size_t kHeaderSize = 13;
    ByteBuffer bytes(kHeaderSize);
    bytes[0] = type;
    bytes[3] = static_cast<std::uint8_t>(code & 0xFFU);
    bytes[4] = static_cast<std::uint8_t>(code >> 8U);
    return bytes;
}

/// Writes a recording of `count` packets with the codes 1, 2, 3, …, 100 ms apart.
inline std::string recordLte(const doubles::RuntimeFolder& folder, int count) {
    constexpr int kZorellLte = 150;
    const std::string path = folder.file("lte.pcap");
    auto writer = RecordingWriter::create(path, kZorellLte);
    if (!writer) {
        throw std::runtime_error(writer.error().sentence);
    }
    for (int index = 0; index < count; ++index) {
        (void)(*writer).get()->write(kRecordingStart + index * std::chrono::milliseconds(100),
                                     logRecord(1, static_cast<std::uint16_t>(index + 1)));
    }
    return path;
}

} // namespace pallax
