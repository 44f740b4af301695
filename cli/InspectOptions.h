#pragma once

namespace CLI {
class App;
} // namespace CLI

namespace pallax {

struct InfoOptions;

/// The options of the commands that describe files. They must outlive the app.
void addInfo(CLI::App& app, InfoOptions& options);

} // namespace pallax
