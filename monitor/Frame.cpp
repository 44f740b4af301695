#include "monitor/Frame.h"

#include "LogGenerator/SectionAges.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

using Children = std::vector<NodeRef>;

/// The children of a branch in the previous frame, each of which can be taken once. Several may
/// have the same name.
class FormerChildren {
public:
    explicit FormerChildren(const PallaxModelNode* branch)
        : _children(branch != nullptr ? branch->childNodes() : nullptr),
          _isTaken(_children != nullptr ? _children->size() : 0) {}

    /// The child after the one taken last, if it has that name (the usual case), or else the first
    /// one of that name, or null.
    const PallaxModelNode* take(const std::string& name) {
        if (_next < _isTaken.size() && !_isTaken[_next] && nameAt(_next) == name) {
            return takeAt(_next);
        }
        indexNames();
        const auto found = _places.find(name);
        while (found != _places.end() && !found->second.empty()) {
            const std::size_t place = found->second.back();
            found->second.pop_back();
            if (!_isTaken[place]) {
                return takeAt(place);
            }
        }
        return nullptr;
    }

    std::vector<std::string_view> namesLeft() const {
        std::vector<std::string_view> names;
        for (std::size_t place = 0; place < _isTaken.size(); ++place) {
            if (!_isTaken[place]) {
                names.push_back(nameAt(place));
            }
        }
        return names;
    }

private:
    const std::string& nameAt(std::size_t place) const {
        return (*_children)[place]->displayName();
    }
    const PallaxModelNode* takeAt(std::size_t place) {
        _isTaken[place] = true;
        _next = place + 1;
        return (*_children)[place].get();
    }
    void indexNames() {
        if (_places.empty()) {
            for (std::size_t place = _isTaken.size(); place > 0; --place) {
                _places[nameAt(place - 1)].push_back(place - 1);
            }
        }
    }

    const Children* _children;
    std::vector<bool> _isTaken;
    std::size_t _next = 0;
    std::unordered_map<std::string_view, std::vector<std::size_t>> _places; // in reverse order
};

} // namespace

/// Walks the trees of two frames side by side, in the display order of the new one.
class Frame::Comparison {
public:
    Comparison(Frame& frame, const Frame* before, const SectionAges* ages)
        : _frame(frame), _before(before), _ages(ages) {}

    /// `readAbove` is the time at which the branch above was read.
    Stamp node(const PallaxModelNode& now, const PallaxModelNode* before, const std::string& path,
               std::optional<Time> readAbove) {
        const std::optional<Time> own = _ages != nullptr ? _ages->lastRead(path) : std::nullopt;
        const std::optional<Time> read = own ? own : readAbove;
        const Stamp made = now.childNodes() != nullptr ? branch(now, before, path, read)
                                                       : leaf(now, before, path, read);
        _frame._stamps.emplace(&now, made);
        return made;
    }

private:
    Stamp leaf(const PallaxModelNode& now, const PallaxModelNode* before, const std::string& path,
               std::optional<Time> read) {
        if (before != nullptr && before->value() != nullptr && *before->value() == *now.value()) {
            return {_before->stamp(*before).since, read, false};
        }
        (void)noteGone(FormerChildren(before), path);
        if (_before != nullptr) {
            _frame._changed.push_back(path);
        }
        return {_frame.time(), read, _before != nullptr};
    }

    Stamp branch(const PallaxModelNode& now, const PallaxModelNode* before, const std::string& path,
                 std::optional<Time> read) {
        const bool wasBranch = before != nullptr && before->childNodes() != nullptr;
        Stamp made = wasBranch ? Stamp{_before->stamp(*before).since, read, false}
                               : Stamp{_frame.time(), read, _before != nullptr};
        FormerChildren former(before);
        std::optional<Time> readBelow;
        for (const NodeRef& child : *now.childNodes()) {
            const std::string& name = child->displayName();
            const Stamp below = node(*child, former.take(name), childPath(path, name), read);
            made.since = below.isChanged ? _frame.time() : made.since;
            made.isChanged = made.isChanged || below.isChanged;
            readBelow = std::max(readBelow, below.read);
        }
        if (noteGone(former, path)) {
            made.since = _frame.time();
            made.isChanged = true;
        }
        made.read = read ? read : readBelow;
        return made;
    }

    /// Adds the remaining children to the frame's `gone`. False when there are none.
    bool noteGone(const FormerChildren& former, const std::string& path) {
        const std::vector<std::string_view> names = former.namesLeft();
        for (const std::string_view name : names) {
            _frame._gone.push_back(childPath(path, name));
        }
        return !names.empty();
    }

    Frame& _frame;
    const Frame* _before;
    const SectionAges* _ages;
};

Frame::Frame(Picture picture, const Frame* before, const SectionAges* ages)
    : _picture(std::move(picture)), _number(before != nullptr ? before->number() + 1 : 1) {
    const std::string path = "/";
    const PallaxModelNode* former = before != nullptr ? before->root().get() : nullptr;
    if (root() == nullptr) {
        if (former != nullptr) {
            _gone.push_back(path);
        }
        return;
    }
    _stamps.reserve(_picture.paths->size());
    (void)Comparison(*this, before, ages).node(*root(), former, path, std::nullopt);
}

NodeRef Frame::nodeAtPath(std::string_view path) const {
    if (_picture.paths == nullptr) {
        return nullptr;
    }
    const auto found = _picture.paths->find(std::string(path));
    return found != _picture.paths->end() ? found->second : nullptr;
}

std::chrono::nanoseconds Frame::age(const PallaxModelNode& node) const {
    const Stamp& its = stamp(node);
    const Time seen = its.read.value_or(its.since);
    return std::max<std::chrono::nanoseconds>(time() - seen, std::chrono::nanoseconds::zero());
}

} // namespace pallax
