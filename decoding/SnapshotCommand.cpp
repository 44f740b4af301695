#include "decoding/SnapshotCommand.h"

#include "console/Output.h"
#include "decoding/Preconditions.h"
#include "host/Complaint.h"
#include "host/Descriptor.h"
#include "host/Files.h"
#include "host/Recording.h"
#include "host/Snapshot.h"
#include "text/Format.h"

#include <fcntl.h>
#include <filesystem>
#include <system_error>
#include <unistd.h>

namespace pallax {

namespace {

ExitStatus failed(const std::string& sentence) {
    complain(sentence);
    return kExitFailure;
}

ExitStatus write(const std::string& output, std::string_view content) {
    if (output == "-") {
        writeToDescriptor(STDOUT_FILENO, "Standard output")(content);
        return kExitSuccess;
    }
    std::error_code error;
    const auto status = std::filesystem::status(output, error);
    if (std::filesystem::exists(status) && !std::filesystem::is_regular_file(status)) {
        // Renaming a file would replace a device or a pipe, which is written to.
        const Descriptor file(::open(output.c_str(), O_WRONLY | O_CLOEXEC));
        if (file) {
            writeToDescriptor(file.number(), output)(content);
            return kExitSuccess;
        }
    } else if (replaceFile(output, content, FileMode::Usual)) {
        return kExitSuccess;
    }
    return failed(formatText("%@ cannot be written.", {output}));
}

} // namespace

ExitStatus runSnapshot(const SnapshotOptions& options) {
    if (options.output == "-" && ::isatty(STDOUT_FILENO) != 0) {
        complain("Standard output is a terminal; name a file with --output.");
        return kExitWrongUsage;
    }
    if (const auto loss = outputIntoRecording({&options.file, 1})) {
        return failed(*loss);
    }
    const std::string name = options.file == "-" ? "standard input" : options.file;
    const auto opened = Recording::openInput({options.file, {}, complain});
    using Kind = RecordingError::Kind;
    if (!opened && opened.error().kind != Kind::NoCapture && opened.error().kind != Kind::Empty) {
        return failed(opened.error().sentence);
    }
    const Snapshot* snapshot = opened ? snapshotOf(**opened) : nullptr;
    if (snapshot == nullptr) {
        return failed(name + " is not a snapshot.");
    }
    if (snapshot->dlf == nullptr) {
        return failed(name + " holds no DLF log.");
    }
    if (recordingAmong({&options.file, 1}, regularFile(options.output))) {
        return failed(formatText("The DLF log would replace the snapshot %@.", {options.file}));
    }
    return write(options.output, {reinterpret_cast<const char*>(snapshot->dlf->data()), // NOLINT
                                  snapshot->dlf->size()});
}

} // namespace pallax
