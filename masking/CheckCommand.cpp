#include "masking/CheckCommand.h"

#include "console/Output.h"
#include "host/CapturePieces.h"
#include "host/Complaint.h"
#include "masking/FileCheck.h"
#include "text/Format.h"

#include <unistd.h>

namespace pallax {

ExitStatus CheckCommand::run(const std::vector<std::string>& files, Output& output) {
    bool isClean = true;
    for (const std::string& file : files) {
        isClean = check(file, output) && isClean;
        output.flush();
    }
    return isClean ? kExitSuccess : kExitFailure;
}

bool CheckCommand::check(const std::string& file, Output& output) {
    const std::string name = file == "-" ? "standard input" : file;
    auto opened = openRecordingContent({file, {}, _environment.report}, name);
    if (!opened) {
        _environment.report(opened.error().sentence);
        return opened.error().kind == RecordingError::Kind::Empty;
    }
    std::uint64_t count = 0;
    FileCheck check(_environment.resources, [&](const FileFind& find) {
        ++count;
        output.text() += formatText("%@: %@\n", {name, find.text()});
        output.lineDone();
    });
    const auto error = check.run(std::move(opened).value(), name);
    if (error) {
        _environment.report(error->sentence);
    }
    return count == 0 && !error;
}

ExitStatus runCheck(const std::vector<std::string>& files, const Resources& resources) {
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    return CheckCommand({resources, complain}).run(files, output);
}

} // namespace pallax
