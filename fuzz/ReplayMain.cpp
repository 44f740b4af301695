// Runs a fuzz target over every file of a corpus folder, each also cut at every length, so that the
// corpus is tested even without the fuzzer.

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace {

std::vector<std::uint8_t> contentOf(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

void replay(const std::vector<std::uint8_t>& content) {
    for (std::size_t length = 0; length < content.size(); ++length) {
        // A separate copy, so that a sanitizer detects reads past the cut.
        const std::vector<std::uint8_t> cut(content.begin(),
                                            content.begin() + static_cast<std::ptrdiff_t>(length));
        (void)LLVMFuzzerTestOneInput(cut.data(), cut.size());
    }
    (void)LLVMFuzzerTestOneInput(content.data(), content.size());
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 2) {
        (void)std::fprintf(stderr, "usage: %s CORPUS-FOLDER\n", argv[0]);
        return 2;
    }
    std::size_t count = 0;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(argv[1])) {
        if (entry.is_regular_file()) {
            replay(contentOf(entry.path()));
            ++count;
        }
    }
    if (count == 0) {
        (void)std::fprintf(stderr, "%s holds no file\n", argv[1]);
        return 1;
    }
    (void)std::printf("%zu files replayed\n", count);
    return 0;
}
