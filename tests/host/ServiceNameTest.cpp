#include "host/ServiceName.h"

#include <gtest/gtest.h>

#include <string>

namespace pallax {
namespace {

TEST(ServiceName, HasOneTo32LettersDigitsDashesUnderscoresAndDots) {
    for (const std::string& name : {std::string("a"), std::string("car1"), std::string("Van-2_b.c"),
                                    std::string("_"), std::string("0"), std::string(32, 'z')}) {
        EXPECT_TRUE(isServiceName(name)) << name;
    }
    for (const std::string& name :
         {std::string(), std::string(33, 'z'), std::string("a b"), std::string("a/b"),
          std::string("\xC3\xA9"), std::string("a\n"), std::string("a\0b", 3)}) {
        EXPECT_FALSE(isServiceName(name)) << name;
    }
}

TEST(ServiceName, BeginsWithNeitherADotNorADash) {
    EXPECT_FALSE(isServiceName("."));
    EXPECT_FALSE(isServiceName(".."));
    EXPECT_FALSE(isServiceName(".car"));
    EXPECT_FALSE(isServiceName("-car"));
    EXPECT_TRUE(isServiceName("c.-"));
}

} // namespace
} // namespace pallax
