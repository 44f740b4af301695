#pragma once

namespace CLI {
class App;
} // namespace CLI

namespace pallax {

struct DiffOptions;
struct InfoOptions;
struct SnapshotOptions;
struct SqlOptions;
struct StatusOptions;
struct WatchOptions;

/// The options of the commands that look into files. They must outlive the app.
void addDiff(CLI::App& app, DiffOptions& options);
void addInfo(CLI::App& app, InfoOptions& options);
void addSnapshot(CLI::App& app, SnapshotOptions& options);
void addSql(CLI::App& app, SqlOptions& options);
void addStatus(CLI::App& app, StatusOptions& options);
void addWatch(CLI::App& app, WatchOptions& options);

} // namespace pallax
