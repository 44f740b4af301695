#include "window/StartToolkit.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(StartToolkit, AGraphicsProcessorHasADeviceForRendering) {
    const doubles::TemporaryFolder folder;
    EXPECT_FALSE(hasGraphicsProcessor(folder.path("missing")));
    EXPECT_FALSE(hasGraphicsProcessor(folder.path()));
    (void)folder.write("card0", "");
    EXPECT_FALSE(hasGraphicsProcessor(folder.path())) << "a screen, which nothing draws for";
    (void)folder.write("renderD128", "");
    EXPECT_TRUE(hasGraphicsProcessor(folder.path()));
}

} // namespace
} // namespace pallax
