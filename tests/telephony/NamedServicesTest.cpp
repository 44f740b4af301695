#include "telephony/NamedServices.h"

#include "host/SocketDirectory.h"
#include "host/UnixSocket.h"
#include "telephony/ControlMessages.h"
#include "tests/doubles/RuntimeFolder.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using Names = std::vector<std::string>;

TEST(NamedServices, TheSentenceNamesAServiceThatHasAName) {
    EXPECT_EQ(noServiceText(""), "No telephony service is running");
    EXPECT_EQ(noServiceText("car1"), "No telephony service named car1 is running");
}

TEST(NamedServices, OnlyThoseThatRunAreListed) {
    const doubles::RuntimeFolder folder;
    EXPECT_EQ(runningServices(), Names());
    const auto control = [](const char* name) {
        return *SocketDirectory::open(name)->socketPath(kTelephonyControlPort);
    };
    const Descriptor nameless = listenAt(control(""));
    const Descriptor van = listenAt(control("van"));
    const Descriptor car = listenAt(control("car"));
    (void)listenAt(control("killed")); // closed at once, but the file remains
    const Descriptor viewer = listenAt(*SocketDirectory::open("only-a-viewer")->socketPath("port"));
    EXPECT_EQ(runningServices(), (Names{"car", "van"}));
}

} // namespace
} // namespace pallax
