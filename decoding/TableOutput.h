#pragma once

#include "decoding/DisplayOutput.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The output of `decode --table`: one section or list of a display as a table for people. A list
/// has a row for each entry and a column for each key, with its unit in the head; another section
/// has a row for each key.
class TableOutput final : public DisplayOutput {
public:
    /// The section is named as on the screen ("Neighbor Cells List") or as in the names of its
    /// fields ("neighbor_cells_list", "lte.neighbor_cells_list").
    TableOutput(Output& output, std::string_view section, std::string_view technology);

    void beginRecording() override {}
    void show(const DisplayMoment& moment, const PropertyList& display) override;

    /// Whether the display had the section with something in it.
    bool isWritten() const { return _isWritten; }
    /// The sections that the display had, as in the names of fields.
    const std::vector<std::string>& sections() const { return _sections; }
    /// Whether that is what the section is called.
    bool isAskedFor(std::string_view section) const;

private:
    void visit(const PropertyList& value, const std::string& name);
    void write(const PropertyList& section);

    Output& _output;
    std::string _section;
    std::vector<std::string> _sections;
    bool _isWritten = false;
};

} // namespace pallax
