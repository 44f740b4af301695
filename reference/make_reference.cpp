// Writes the files that are generated from the records' descriptions into the source tree:
// make_reference .

#include "host/DirectoryResources.h"
#include "reference/ReferenceFiles.h"

#include <cstdio>
#include <exception>
#include <filesystem>
#include <fstream>
#include <string>

namespace {

int writeInto(const std::filesystem::path& tree) {
    const std::string program = pallax::dissectorProgram(tree.string());
    const pallax::DirectoryResources resources((tree / "resources").string());
    for (const pallax::ReferenceFile& file : pallax::referenceFiles(resources, program)) {
        const std::filesystem::path path = tree / file.path;
        std::filesystem::create_directories(path.parent_path());
        std::ofstream out(path, std::ios::binary);
        out << file.text;
        if (!out.flush()) {
            (void)std::fprintf(stderr, "%s cannot be written.\n", path.c_str());
            return 1;
        }
        (void)std::printf("%s\n", path.c_str());
    }
    return 0;
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 2) {
        (void)std::fprintf(stderr, "usage: %s SOURCE-TREE\n", argv[0]);
        return 2;
    }
    try {
        return writeInto(argv[1]);
    } catch (const std::exception& error) {
        (void)std::fprintf(stderr, "%s\n", error.what());
        return 1;
    }
}
