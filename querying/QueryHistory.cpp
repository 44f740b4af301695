#include "querying/QueryHistory.h"

#include "host/Descriptor.h"
#include "host/Files.h"
#include "query/SqlTokens.h"

#include <algorithm>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

constexpr std::size_t kLargestHistory = std::size_t{4} << 20U;

} // namespace

QueryHistory::QueryHistory(std::string folder)
    : _folder(std::move(folder)), _path(_folder.empty() ? "" : _folder + "/sql-history") {}

std::vector<std::string> QueryHistory::load() {
    std::vector<std::string> statements;
    const auto content = _path.empty() ? std::nullopt : readFile(_path, kLargestHistory);
    if (!content) {
        return statements;
    }
    std::string line;
    for (const auto byte : *content) {
        if (byte != '\n') {
            line += static_cast<char>(byte);
        } else if (!line.empty()) {
            statements.push_back(std::exchange(line, {}));
        }
    }
    if (statements.size() > 2 * kMostStatements) {
        statements.erase(statements.begin(),
                         statements.end() - static_cast<std::ptrdiff_t>(kMostStatements));
        std::string kept;
        for (const std::string& statement : statements) {
            kept.append(statement).append("\n");
        }
        (void)writePrivateFile(_path, kept);
    }
    return statements;
}

bool QueryHistory::add(const std::string& statement) const {
    if (_path.empty()) {
        return false;
    }
    const mode_t before = ::umask(S_IRWXG | S_IRWXO);
    std::error_code failed; // the file cannot be opened then
    std::filesystem::create_directories(_folder, failed);
    const Descriptor file(
        ::open(_path.c_str(), O_WRONLY | O_CREAT | O_APPEND | O_NOFOLLOW | O_CLOEXEC | O_NONBLOCK,
               S_IRUSR | S_IWUSR));
    (void)::umask(before);
    const std::string line = lineOf(statement) + "\n";
    struct stat status {};
    // In one call, so that lines of two sessions do not mix.
    return file && ::fstat(file.number(), &status) == 0 && S_ISREG(status.st_mode) &&
           ::write(file.number(), line.data(), line.size()) == static_cast<ssize_t>(line.size());
}

std::string QueryHistory::lineOf(const std::string& statement) {
    std::string line;
    std::size_t place = 0;
    while (const auto token = sqlTokenAt(statement, place)) {
        const bool isBlank = token->kind == SqlToken::Kind::Blank; // comments, too
        const bool isSeparated = line.empty() || line.back() == ' ';
        line += !isBlank ? statement.substr(place, token->end - place) : isSeparated ? "" : " ";
        place = token->end;
    }
    std::replace(line.begin(), line.end(), '\n', ' '); // of texts
    const std::size_t begin = std::min(line.find_first_not_of(' '), line.size());
    return line.substr(begin, line.find_last_not_of(' ') + 1 - begin);
}

} // namespace pallax
