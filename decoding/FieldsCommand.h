#pragma once

#include "console/ExitStatus.h"

namespace pallax {

class Output;
class Resources;
struct RecordedTechnology;

/// `pallax fields`: what the display can show.
struct FieldsOptions {
    const RecordedTechnology* technology = nullptr; ///< null: all of them
    bool json = false;
};

/// Writes a line for each field: aligned columns and texts, or a JSON object. The sections are
/// those of the templates in `resources`.
void writeFields(const FieldsOptions& options, const Resources& resources, Output& output);

/// `writeFields`, wired to this machine. TemplateFailure, OutputClosed and OutputFailure leave.
ExitStatus runFields(const FieldsOptions& options);

} // namespace pallax
