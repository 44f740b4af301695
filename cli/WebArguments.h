#pragma once

#include "web/WebOptions.h"

namespace CLI {
class App;
} // namespace CLI

namespace pallax {

/// The options must outlive the app.
void addWeb(CLI::App& app, WebOptions& options);

} // namespace pallax
