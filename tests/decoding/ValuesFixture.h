#pragma once

#include "LogGenerator/Technologies/Technologies.h"
#include "tests/decoding/CommandFixture.h"
#include "tests/doubles/RecordBuilder.h"

namespace pallax {

/// Decodes records of real technologies.
class ValuesFixture : public CommandFixture {
protected:
    void add(const std::string& name, Packets packets, const char* technology = "lte") {
        options.recordings.push_back(name);
        script(name, std::move(packets), technologyOfCommandName(technology));
    }
    ExitStatus run() {
        Output output(write());
        DecodeCommand command(options, {resources, bundle, notices, technologies()}, open(),
                              report());
        return command.run(output);
    }
    /// Measured neighbour cells in connected mode, each with a level of -98.25 dBm.
    static std::string neighbors(const std::vector<std::uint16_t>& cells) {
        doubles::Record record(0xB179);
        record.padTo(27).u8(static_cast<std::uint8_t>(cells.size())).u8(0);
        for (const std::uint16_t cell : cells) {
            record.u16(cell).u16(167).u16(70);
        }
        return textOf(record.bytes());
    }

    DecodeOptions options;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
};

} // namespace pallax
