#pragma once

#include "decoding/DisplayOutput.h"
#include "decoding/FieldSelection.h"

#include <string_view>
#include <utility>

namespace pallax {

/// Passes on what displays have of some fields.
class SelectedOutput final : public DisplayOutput {
public:
    SelectedOutput(DisplayOutput& output, FieldSelection selection)
        : _output(output), _selection(std::move(selection)) {}

    void nameRecording(std::string_view name) override { _output.nameRecording(name); }
    void beginRecording() override { _output.beginRecording(); }
    void show(const DisplayMoment& moment, const PropertyList& display) override {
        _output.show(moment, _selection.of(display));
    }

private:
    DisplayOutput& _output;
    FieldSelection _selection;
};

} // namespace pallax
