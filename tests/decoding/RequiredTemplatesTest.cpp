#include "decoding/RequiredTemplates.h"

#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <sys/resource.h>

namespace pallax {
namespace {

class RequiredTemplatesTest : public testing::Test {
protected:
    /// The error thrown when `ask` is called with the templates; empty if there is none.
    template <class Ask>
    std::string sentenceOf(const Ask& ask) const {
        try {
            ask(RequiredTemplates(folder.path()));
        } catch (const TemplateFailure& failure) {
            return failure.what();
        }
        return "";
    }
    std::string loading(const std::string& name) const {
        return sentenceOf([&](const Resources& templates) { (void)templates.propertyList(name); });
    }
    std::string listing() const {
        return sentenceOf([](const Resources& templates) { (void)templates.propertyListPaths(); });
    }

    doubles::TemporaryFolder folder;
};

TEST_F(RequiredTemplatesTest, AreAsOthersWhereTheyAreThere) {
    (void)folder.write("LTE.plist", "{ Cell = {}; }");
    (void)folder.write("My utran.plist", "{}");
    const RequiredTemplates templates(folder.path());
    EXPECT_EQ(templates.propertyList("LTE"), PropertyList(Dictionary{{"Cell", Dictionary()}}));
    EXPECT_EQ(templates.propertyListPaths(),
              (std::vector<std::string>{folder.path("LTE.plist"), folder.path("My utran.plist")}));
}

TEST_F(RequiredTemplatesTest, OneThatIsMissingIsThrownWhenItIsAskedForAndNotBefore) {
    EXPECT_EQ(sentenceOf([](const Resources&) {}), "");
    EXPECT_EQ(loading("LTE"), "The display template " + folder.path("LTE.plist") +
                                  " cannot be loaded: No such file or directory.");
}

TEST_F(RequiredTemplatesTest, AmongWhichThereIsNoneForUtranAreNone) {
    (void)folder.write("LTE.plist", "{}");
    EXPECT_EQ(listing(), "There is no display template for UTRAN in " + folder.path() + ".");
}

TEST_F(RequiredTemplatesTest, WithoutDescriptorsAreNotTakenForMissing) {
#ifdef PALLAX_SANITIZED
    GTEST_SKIP() << "the sanitizer needs descriptors itself";
#endif
    (void)folder.write("LTE.plist", "{}");
    (void)folder.write("UTRAN.plist", "{}");
    rlimit before{};
    ::getrlimit(RLIMIT_NOFILE, &before);
    const rlimit none{0, before.rlim_max};
    ::setrlimit(RLIMIT_NOFILE, &none);
    const std::string loaded = loading("LTE");
    const std::string listed = listing();
    ::setrlimit(RLIMIT_NOFILE, &before);
    EXPECT_EQ(loaded, "The display template " + folder.path("LTE.plist") +
                          " cannot be loaded: Too many open files.");
    EXPECT_EQ(listed, "The display templates in " + folder.path() +
                          " cannot be listed: Too many open files.");
}

} // namespace
} // namespace pallax
