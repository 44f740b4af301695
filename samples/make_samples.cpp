// Writes the sample recordings of the repository into a folder: make_samples samples

#include "samples/Samples.h"

#include <cstdio>
#include <string>

int main(int argc, char** argv) {
    if (argc != 2) {
        (void)std::fprintf(stderr, "usage: %s FOLDER\n", argv[0]);
        return 2;
    }
    for (const pallax::SampleRecording& sample : pallax::samples()) {
        const std::string path = std::string(argv[1]) + "/" + std::string(sample.fileName);
        if (const auto error = pallax::writeSample(sample, path)) {
            (void)std::fprintf(stderr, "%s\n", error->c_str());
            return 1;
        }
        (void)std::printf("%s\n", path.c_str());
    }
    return 0;
}
