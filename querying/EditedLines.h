#pragma once

#include "querying/LineReader.h"
#include "querying/QueryHistory.h"
#include "querying/SqlCompletion.h"

#include <functional>
#include <memory>
#include <string_view>

namespace pallax {

/// Completes the last word of a text.
using Completer = std::function<SqlCompletion(std::string_view text)>;

/// Lines that a user edits on the terminal, with history and completion. Null if the program was
/// built without the library for it.
std::unique_ptr<LineReader> editedLines(QueryHistory history, Completer completer);

} // namespace pallax
