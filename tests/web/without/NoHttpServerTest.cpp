#include "host/AsioMainQueue.h"
#include "web/HttpServer.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(NoHttpServer, SaysThatItIsMissing) {
    AsioMainQueue queue;
    const auto refused =
        HttpServer::start({.queue = queue,
                           .listener = Listener{Descriptor(), "127.0.0.1", 1, true},
                           .answer = [](const WebRequest&) { return WebResponse(); }});
    ASSERT_FALSE(refused);
    EXPECT_EQ(refused.error().sentence,
              "This build of Pallax cannot serve pages: it was made without libmicrohttpd.");
}

} // namespace
} // namespace pallax
