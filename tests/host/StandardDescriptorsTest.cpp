#include "host/StandardDescriptors.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <array>
#include <cerrno>
#include <fcntl.h>
#include <functional>
#include <sys/wait.h>
#include <unistd.h>

namespace pallax {
namespace {

/// Evaluates the condition in a child process, which may close descriptors.
bool holdsInChild(const std::function<bool()>& condition) {
    const pid_t child = ::fork();
    if (child == 0) {
        ::_exit(condition() ? 0 : 1);
    }
    int status = 1;
    (void)::waitpid(child, &status, 0);
    return child > 0 && WIFEXITED(status) && WEXITSTATUS(status) == 0;
}

TEST(StandardDescriptors, ThatAreClosedAreOpenedEmptyAndRefuseToBeWritten) {
    EXPECT_TRUE(holdsInChild([] {
        for (const int number : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
            (void)::close(number);
        }
        std::array<char, 1> byte{};
        return openStandardDescriptors() && ::read(STDIN_FILENO, byte.data(), byte.size()) == 0 &&
               ::write(STDOUT_FILENO, "x", 1) < 0 && errno == EBADF &&
               ::write(STDERR_FILENO, "x", 1) < 0 && errno == EBADF &&
               ::dup(STDIN_FILENO) > STDERR_FILENO;
    }));
}

TEST(StandardDescriptors, ThatAreOpenStayAsTheyAre) {
    const doubles::TemporaryFolder folder;
    const std::string path = folder.write("out", "");
    EXPECT_TRUE(holdsInChild([&path] {
        (void)::close(STDIN_FILENO);
        const int file = ::open(path.c_str(), O_WRONLY | O_CLOEXEC); // as standard input
        return ::dup2(file, STDOUT_FILENO) == STDOUT_FILENO && ::close(file) == 0 &&
               openStandardDescriptors() && ::write(STDOUT_FILENO, "kept", 4) == 4;
    }));
    EXPECT_EQ(doubles::contentOf(path), "kept");
}

} // namespace
} // namespace pallax
