#include "monitor/PallaxModel.h"

#include "platform/Clock.h"
#include "platform/MainQueue.h"

#include <utility>

namespace pallax {

PallaxModel::PallaxModel(const Platform& platform, ModelObserver& observer)
    : _queue(platform.queue), _clock(platform.generators.clock), _observer(observer),
      _link(platform, *this), _alive(std::make_shared<PallaxModel*>(this)) {}

void PallaxModel::updateWithData(Bytes data) {
    const Time time = _clock.now();
    _driver.update(data, {.time = time});
    if (_packetRead) {
        _packetRead(data, time);
    }
}

void PallaxModel::generatorChosen(const std::string& technology) {
    _observer.generatorChosen(technology, _driver.keepsDisplay());
}

void PallaxModel::displayTick() {
    if (!_driver.takeUpdated()) {
        return;
    }
    _nodes.reset();
    _nodesByPath.reset();
    _queue.async([model = std::weak_ptr(_alive)] {
        if (const auto alive = model.lock()) {
            (*alive)->_observer.updateViewControllerFromModel();
        }
        if (const auto alive = model.lock()) { // the observer may end the model
            (*alive)->handOutFrame();
        }
    });
}

void PallaxModel::handOutFrame() {
    std::erase_if(_frameObservers, [](const auto& observer) { return observer.expired(); });
    if (_frameObservers.empty()) {
        _frame.reset();
        return;
    }
    NodeRef root = topLevelNodes();
    if (_frame && _frame->root() == root) { // the block of an earlier tick made this frame
        return;
    }
    const SectionAges ages = _driver.sectionAges();
    _frame = std::make_shared<Frame>(Frame::Picture{std::move(root), _nodesByPath, _clock.now()},
                                     _frame.get(), &ages);
    // Copies, because an observer may add another or end the model.
    const FrameRef frame = _frame;
    const auto observers = _frameObservers;
    for (const auto& each : observers) {
        if (const auto observer = each.lock()) {
            observer->frameMade(frame);
        }
    }
}

NodeRef PallaxModel::topLevelNodes() {
    if (_nodes || _nodesByPath) { // paths without a root: a display was requested and is null
        return _nodes;
    }
    if (_driver.generator() == nullptr) {
        return nullptr;
    }
    auto paths = std::make_shared<PathDictionary>();
    _nodes = PallaxModelNode::makeTreeFromObject(_driver.generate(), *paths);
    _nodesByPath = std::move(paths);
    return _nodes;
}

NodeRef PallaxModel::nodeAtPath(std::string_view path) {
    if (!_nodesByPath) {
        topLevelNodes();
    }
    if (!_nodesByPath) {
        return nullptr;
    }
    const auto found = _nodesByPath->find(std::string(path));
    return found != _nodesByPath->end() ? found->second : nullptr;
}

} // namespace pallax
