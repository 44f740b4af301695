#include "app/table/FoundRows.h"

#include "app/pane/FindIgnoringCase.h"
#include "app/pane/PaneRow.h"

#include <utility>

namespace pallax {

namespace {

void appendPart(std::string& words, std::string_view part) {
    words.append(words.empty() ? "" : ", ").append(part);
}

class RowFinder {
public:
    RowFinder(std::string_view text, const EntryPartAt& partAt, std::size_t most)
        : _text(text), _partAt(partAt), _most(most) {}

    /// `path` is that of the fields ("/Neighbor Cells List/*"), and `where` that of the found rows.
    void visit(const PallaxModelNode& branch, const std::string& path, const std::string& where) {
        const bool isList = elementsOf(branch).has_value();
        _place.push_back(0);
        for (const NodeRef& child : *branch.childNodes()) {
            if (_found.size() >= _most) {
                break;
            }
            const std::string& name = child->displayName();
            const std::string value = textOf(*child).value_or("");
            if ((!isList && contains(name)) || contains(value)) {
                _found.push_back({_place, name, value, where});
            }
            if (child->childNodes() != nullptr) {
                const std::string childsPath = childPath(path, isList ? "*" : name);
                std::string inside = where;
                appendPart(inside, isList ? entryWords(*child, childsPath) : name);
                visit(*child, childsPath, inside);
            }
            ++_place.back();
        }
        _place.pop_back();
    }

    std::vector<FoundRow> found() && { return std::move(_found); }

private:
    bool contains(std::string_view text) const {
        return findIgnoringCase(text, _text) != std::string_view::npos;
    }

    /// What identifies an entry, or else its number.
    std::string entryWords(const PallaxModelNode& entry, const std::string& path) const {
        std::string words;
        for (const NodeRef& child : *entry.childNodes()) {
            const auto value = textOf(*child);
            if (value && _partAt(childPath(path, child->displayName())) != EntryPart::None) {
                appendPart(words, child->displayName() + " " + *value);
            }
        }
        return words.empty() ? entry.displayName() : words;
    }

    std::string_view _text;
    const EntryPartAt& _partAt;
    std::size_t _most;
    std::vector<std::size_t> _place;
    std::vector<FoundRow> _found;
};

} // namespace

std::vector<FoundRow> findRows(const PallaxModelNode& root, std::string_view text,
                               const EntryPartAt& partAt, std::size_t most) {
    RowFinder finder(text, partAt, most);
    if (!text.empty() && root.childNodes() != nullptr) {
        finder.visit(root, "/", "");
    }
    return std::move(finder).found();
}

} // namespace pallax
