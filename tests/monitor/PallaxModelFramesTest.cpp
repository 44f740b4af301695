#include "tests/doubles/ModelFixture.h"

namespace pallax {
namespace {

using namespace std::chrono_literals;
using doubles::FakeGenerator;
using Paths = std::vector<std::string>;

class KeptFrames final : public FrameObserver {
public:
    void frameMade(const FrameRef& frame) override {
        frames.push_back(frame);
        if (onFrame) {
            onFrame();
        }
    }

    std::vector<FrameRef> frames;
    std::function<void()> onFrame;
};

/// A generator that reports one time of reading for all its values.
class AgingGenerator final : public FakeGenerator {
public:
    using FakeGenerator::FakeGenerator;
    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment) {
        return std::make_unique<AgingGenerator>(environment);
    }
    SectionAges agesIn(const Dictionary& /*state*/) const override {
        SectionAges ages;
        ages.note("/", readAt);
        return ages;
    }

    Time readAt;
};

constexpr Technology kAgingTechnologies[] = {{"Fake", &AgingGenerator::generator}};

class PallaxModelFramesTest : public doubles::ModelFixture {
protected:
    void SetUp() override {
        ModelFixture::SetUp();
        start();
    }
    std::shared_ptr<KeptFrames> observe() {
        auto frames = std::make_shared<KeptFrames>();
        model->observeFrames(frames);
        return frames;
    }
    /// Receives a packet that changes the display to `display`, up to the next tick.
    void tick(const PropertyList& display) {
        ports.deliver({1});
        queue.runReady();
        generator().display = display;
        clock.advance(PallaxModel::kDisplayInterval);
        queue.advance(PallaxModel::kDisplayInterval);
    }
};

TEST_F(PallaxModelFramesTest, EachObserverGetsTheSameFrameOfEachTickWithNewData) {
    const auto first = observe();
    const auto second = observe();
    tick(Dictionary{{"A", "1"}});
    queue.advance(2s); // without new data
    tick(Dictionary{{"A", "2"}, {"B", "3"}});
    ASSERT_EQ(first->frames.size(), 2U);
    EXPECT_EQ(first->frames, second->frames);
    const Frame& frame = *first->frames.back();
    EXPECT_EQ(frame.number(), 2U);
    EXPECT_EQ(frame.time(), clock.now());
    EXPECT_EQ(frame.changed(), (Paths{"/A", "/B"}));
    EXPECT_EQ(first->frames.front()->nodeAtPath("/A")->value()->string(), "1") << "it stays";
}

TEST_F(PallaxModelFramesTest, TheTreeIsTheOneThatTheApplicationHasPulledAndIsBuiltOnce) {
    NodeRef pulled;
    observer.onUpdate = [&] { pulled = model->topLevelNodes(); };
    const auto frames = observe();
    tick(Dictionary{{"A", "1"}});
    ASSERT_EQ(frames->frames.size(), 1U);
    EXPECT_EQ(frames->frames.front()->root(), pulled);
    EXPECT_EQ(frames->frames.front()->nodeAtPath("/A"), model->nodeAtPath("/A"));
    EXPECT_EQ(generator().displaysMade, 1);
    observer.onUpdate = {};
    tick(Dictionary{{"A", "2"}});
    EXPECT_EQ(frames->frames.back()->root(), model->topLevelNodes());
    EXPECT_EQ(generator().displaysMade, 2);
}

TEST_F(PallaxModelFramesTest, WithoutAnObserverNothingIsBuilt) {
    auto frames = observe();
    tick(Dictionary{{"A", "1"}});
    EXPECT_EQ(generator().displaysMade, 1);
    const std::weak_ptr<const Frame> last = frames->frames.back();
    frames.reset();
    tick(Dictionary{{"A", "2"}});
    EXPECT_EQ(generator().displaysMade, 1);
    EXPECT_TRUE(last.expired()) << "the model keeps no frame for later observers";
    const auto later = observe();
    tick(Dictionary{{"A", "3"}});
    EXPECT_EQ(later->frames.back()->number(), 1U);
    EXPECT_EQ(later->frames.back()->changed(), Paths{});
}

TEST_F(PallaxModelFramesTest, ObservingByItselfMakesNoFrame) {
    const auto frames = observe();
    model->refresh();
    queue.runReady();
    EXPECT_TRUE(frames->frames.empty());
    EXPECT_EQ(generator().displaysMade, 0);
}

TEST_F(PallaxModelFramesTest, TwoTicksBeforeTheQueueRunsMakeOneFrame) {
    const auto frames = observe();
    generator().display = Dictionary{{"A", "1"}};
    for (int each = 0; each < 2; ++each) {
        model->updateWithData({});
        model->refresh();
    }
    queue.runReady();
    EXPECT_EQ(observer.updates, 2);
    EXPECT_EQ(frames->frames.size(), 1U);
    EXPECT_EQ(generator().displaysMade, 1);
}

TEST_F(PallaxModelFramesTest, ADisplayThatIsNotThereIsAnEmptyFrame) {
    const auto frames = observe();
    tick({});
    ASSERT_EQ(frames->frames.size(), 1U);
    EXPECT_EQ(frames->frames.front()->root(), nullptr);
    tick(Dictionary{{"A", "1"}});
    EXPECT_EQ(frames->frames.back()->changed(), Paths{"/A"});
}

TEST_F(PallaxModelFramesTest, AgesAreThoseThatTheGeneratorKnows) {
    const auto frames = observe();
    platform.technologies = kAgingTechnologies;
    model = std::make_unique<PallaxModel>(platform, observer);
    model->observeFrames(frames);
    start();
    dynamic_cast<AgingGenerator&>(generator()).readAt = clock.now();
    tick(Dictionary{{"A", "1"}});
    ASSERT_EQ(frames->frames.size(), 1U);
    const Frame& frame = *frames->frames.front();
    EXPECT_EQ(frame.age(*frame.nodeAtPath("/A")), 2s);
}

TEST_F(PallaxModelFramesTest, TheModelMayEndInsideTheViewUpdateOrAFrame) {
    const auto frames = observe();
    const auto second = observe();
    observer.onUpdate = [this] { model.reset(); };
    tick(Dictionary{{"A", "1"}});
    EXPECT_TRUE(frames->frames.empty());

    observer.onUpdate = {};
    model = std::make_unique<PallaxModel>(platform, observer);
    start();
    model->observeFrames(frames);
    model->observeFrames(second);
    frames->onFrame = [this] { model.reset(); };
    tick(Dictionary{{"A", "1"}});
    EXPECT_EQ(frames->frames.size(), 1U);
    EXPECT_EQ(second->frames, frames->frames) << "both get the frame of the same tick";
}

TEST_F(PallaxModelFramesTest, AnObserverMayAskForAnotherOneWithinAFrame) {
    const auto frames = observe();
    std::shared_ptr<KeptFrames> added;
    frames->onFrame = [&] { added = added ? added : observe(); };
    tick(Dictionary{{"A", "1"}});
    ASSERT_NE(added, nullptr);
    EXPECT_TRUE(added->frames.empty());
    tick(Dictionary{{"A", "2"}});
    EXPECT_EQ(added->frames.size(), 1U);
}

} // namespace
} // namespace pallax
