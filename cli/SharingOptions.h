#pragma once

namespace CLI {
class App;
} // namespace CLI

namespace pallax {

struct MaskOptions;

/// The options of the commands that make files fit to be passed on. They must outlive the app.
void addMask(CLI::App& app, MaskOptions& options);

} // namespace pallax
