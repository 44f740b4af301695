#pragma once

namespace CLI {
class App;
} // namespace CLI

namespace pallax {

struct MaskOptions;
struct ReportOptions;
struct VerifyOptions;

/// The options of the commands that make files fit to be passed on. They must outlive the app.
void addMask(CLI::App& app, MaskOptions& options);
void addReport(CLI::App& app, ReportOptions& options);
void addVerify(CLI::App& app, VerifyOptions& options);

} // namespace pallax
