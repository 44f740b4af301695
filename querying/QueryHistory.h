#pragma once

#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// The statements of earlier sessions, a line each, in a file that only its user may read.
class QueryHistory {
public:
    static constexpr std::size_t kMostStatements = 1000;

    /// With an empty folder, nothing is kept. The folder is made when it is needed.
    explicit QueryHistory(std::string folder);

    /// The latest statements, oldest first. Shortens a file that has many more.
    std::vector<std::string> load();
    /// False if it cannot be kept.
    bool add(const std::string& statement) const;
    const std::string& path() const { return _path; }

    /// A statement as one line.
    static std::string lineOf(const std::string& statement);

private:
    std::string _folder;
    std::string _path;
};

} // namespace pallax
