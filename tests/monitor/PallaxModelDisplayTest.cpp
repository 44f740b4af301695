#include "tests/doubles/ModelFixture.h"

namespace pallax {
namespace {

using namespace std::chrono_literals;

class PallaxModelDisplayTest : public doubles::ModelFixture {
protected:
    void show(const PropertyList& display) {
        generator().display = display;
        model->updateWithData({});
        model->refresh();
    }
};

TEST_F(PallaxModelDisplayTest, RefreshWithNoNewPacketsNeitherRebuildsTheTreeNorNotifiesTheUi) {
    start();
    show(Dictionary{{"A", "1"}});
    queue.runReady();
    const NodeRef root = model->topLevelNodes();
    model->refresh();
    queue.runReady();
    EXPECT_EQ(observer.updates, 1);
    EXPECT_EQ(model->topLevelNodes(), root);
    EXPECT_EQ(generator().displaysMade, 1);
}

TEST_F(PallaxModelDisplayTest, ARefreshWithNewDataTellsTheApplicationAsynchronouslyAndOnce) {
    start();
    model->updateWithData({});
    model->updateWithData({});
    model->refresh();
    EXPECT_EQ(observer.updates, 0);
    queue.runReady();
    EXPECT_EQ(observer.updates, 1);
    model->refresh();
    queue.runReady();
    EXPECT_EQ(observer.updates, 1);
}

TEST_F(PallaxModelDisplayTest, ARefreshBuildsNothingByItself) {
    start();
    show(Dictionary{{"A", "1"}});
    queue.runReady();
    EXPECT_EQ(generator().displaysMade, 0);
}

TEST_F(PallaxModelDisplayTest, NewDataDropsTheTreeAtTheNextRefresh) {
    start();
    show(Dictionary{{"A", "1"}});
    const NodeRef first = model->topLevelNodes();
    generator().display = Dictionary{{"B", "2"}};
    model->updateWithData({});
    EXPECT_EQ(model->topLevelNodes(), first); // cached until the refresh
    EXPECT_NE(model->nodeAtPath("/A"), nullptr);
    model->refresh();
    const NodeRef second = model->topLevelNodes();
    EXPECT_NE(second, first);
    EXPECT_EQ(model->nodeAtPath("/A"), nullptr);
    EXPECT_EQ(model->nodeAtPath("/B")->value()->string(), "2");
    EXPECT_EQ(first->childNodes()->front()->displayName(), "A"); // its owners keep it
}

TEST_F(PallaxModelDisplayTest, TopLevelNodesAreBuiltOnceAndCached) {
    start();
    show(Dictionary{{"A", Dictionary{{"B", "1"}}}});
    const NodeRef root = model->topLevelNodes();
    ASSERT_NE(root, nullptr);
    EXPECT_EQ(root->displayName(), "Pallax");
    EXPECT_EQ(model->topLevelNodes(), root);
    EXPECT_EQ(model->nodeAtPath("/"), root);
    EXPECT_EQ(generator().displaysMade, 1);
}

TEST_F(PallaxModelDisplayTest, NodeAtPathBuildsTheTreeWhenThePathsAreMissing) {
    start();
    show(Dictionary{{"A", Dictionary{{"B", "1"}}}});
    const NodeRef node = model->nodeAtPath("/A/B");
    ASSERT_NE(node, nullptr);
    EXPECT_EQ(node->displayName(), "B");
    EXPECT_EQ(model->nodeAtPath("/A/C"), nullptr);
    EXPECT_EQ(model->nodeAtPath(""), nullptr);
    EXPECT_EQ(model->nodeAtPath("A/B"), nullptr);
    EXPECT_EQ(model->topLevelNodes()->childNodes()->front()->childNodes()->front(), node);
    EXPECT_EQ(generator().displaysMade, 1);
}

TEST_F(PallaxModelDisplayTest, WithoutAGeneratorThereIsNothingToShowOrSave) {
    EXPECT_EQ(model->topLevelNodes(), nullptr);
    EXPECT_EQ(model->nodeAtPath("/"), nullptr);
    EXPECT_TRUE(model->getSaveContents().isNull());
    EXPECT_TRUE(model->display().isNull());
}

TEST_F(PallaxModelDisplayTest, APacketWithoutAGeneratorIsLostAndStillCountsAsNewData) {
    model->updateWithData({});
    model->refresh();
    queue.runReady();
    EXPECT_EQ(observer.updates, 1);
}

TEST_F(PallaxModelDisplayTest, AGeneratorWithoutADisplayGivesNoTreeAndIsAskedOnceATick) {
    start();
    EXPECT_EQ(model->topLevelNodes(), nullptr);
    EXPECT_EQ(model->topLevelNodes(), nullptr);
    EXPECT_EQ(model->nodeAtPath("/"), nullptr); // the paths exist, but are empty
    EXPECT_EQ(generator().displaysMade, 1);
    generator().display = Dictionary{};
    ports.deliver({1});
    queue.advance(2s);
    EXPECT_NE(model->topLevelNodes(), nullptr);
    EXPECT_EQ(generator().displaysMade, 2);
    EXPECT_NE(model->nodeAtPath("/"), nullptr);
}

TEST_F(PallaxModelDisplayTest, TheApplicationPullsTheNodesFromWithinTheUpdate) {
    start();
    generator().display = Dictionary{{"A", "1"}};
    ports.deliver({1});
    std::string seen;
    observer.onUpdate = [&] {
        seen = model->topLevelNodes()->childNodes()->front()->displayName();
    };
    queue.advance(2s);
    EXPECT_EQ(seen, "A");
}

TEST_F(PallaxModelDisplayTest, SaveContentsComeFromTheGeneratorWithTheModelsState) {
    start();
    EXPECT_EQ(model->getSaveContents(), PropertyList(Array{Dictionary{}}));
    show(Dictionary{{"A", "1"}});
    model->topLevelNodes();
    EXPECT_EQ(model->getSaveContents(),
              PropertyList(Array{Dictionary{{"Display", Dictionary{{"A", "1"}}}}}));
    EXPECT_EQ(generator().caughtUp, 0);
    EXPECT_EQ(model->display(), PropertyList(Dictionary{{"A", "1"}}));
    EXPECT_EQ(generator().caughtUp, 1) << "the save contents share the display's sections";
}

} // namespace
} // namespace pallax
