#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// One of the four cell sets that the UMTS searcher's cell list rebuilds; each is a list section
/// that every accepted packet empties and fills again with the cells it shows.
///
///   0x417A, at least 16 bytes, little-endian
///   byte             width    field
///   13               16       receive AGC, signed
///   15               8        cell count N
///   16 + 15i         15 byte  cell entry i
///   16 + 15N + 44i   44 byte  path record of cell i, eleven 32-bit words
class SearcherSet : public Base {
public:
    std::span<const LogCode> getLogCodeArray() const final;
    SectionKind sectionKind() const final { return SectionKind::List; }
    void updateWithData(const LogRecord& record, LogCode logCode) final;
    bool replacesShown(const LogRecord& record, LogCode logCode) const final;
    RecordDescription describe() const override;

protected:
    /// `logLine` is logged on every call; it must live as long as the program.
    explicit SearcherSet(std::string_view logLine) : _logLine(logLine) {}

    /// What the set shows of `record`, which is long enough and holds at least one cell. A set
    /// that overrides nothing is emptied by every packet.
    virtual Array cellsOf(const LogRecord& record) const;

    static std::size_t cellCount(const LogRecord& record);

    /// Of cell entry 0; the path records follow behind the last entry.
    static constexpr std::size_t kCellsStart = 16;
    static constexpr std::size_t kCellCountOffset = 15;

private:
    std::string_view _logLine;
};

} // namespace pallax
