#include "browsing/TreePrinter.h"

#include "platform/Clock.h"
#include "text/Printable.h"

namespace pallax {

namespace {

constexpr std::size_t kIndentationPerLevel = 2;
constexpr std::string_view kChanged = "* ";

} // namespace

void TreePrinter::updateViewControllerFromModel() {
    std::string& text = _output.text();
    text += "== ";
    text += dateText(dateOf(_clock.now()));
    text += '\n';
    Values values;
    if (const NodeRef root = _nodes()) {
        if (root->childNodes() == nullptr) {
            printLeaf(*root, "/", 0, values);
        } else {
            printChildren(*root, "/", 0, values);
        }
    }
    _values = std::move(values);
    _hasPrinted = true;
    _output.flush();
}

void TreePrinter::showConnection(bool isConnected) {
    if (!isConnected && !_toldConnecting) {
        _output.text() += "Connecting...\n";
        _output.flush();
    }
    _toldConnecting = !isConnected;
}

void TreePrinter::printChildren(const PallaxModelNode& node, const std::string& path,
                                std::size_t depth, Values& values) {
    for (const NodeRef& child : *node.childNodes()) {
        std::string childsPath = childPath(path, child->displayName());
        if (child->childNodes() == nullptr) {
            printLeaf(*child, std::move(childsPath), depth, values);
            continue;
        }
        _output.text().append(depth * kIndentationPerLevel, ' ');
        appendPrintable(_output.text(), child->displayName());
        _output.text() += '\n';
        printChildren(*child, childsPath, depth + 1, values);
    }
}

void TreePrinter::printLeaf(const PallaxModelNode& leaf, std::string path, std::size_t depth,
                            Values& values) {
    std::string value;
    (void)leaf.value()->appendString(value);
    while (values.contains(path)) {
        path += '/'; // unique: no child's path ends with it; for another leaf at the same path
    }
    const auto before = _values.find(path);
    const bool changed = _hasPrinted && (before == _values.end() || before->second != value);

    std::string& text = _output.text();
    const std::size_t start = text.size();
    text.append(depth * kIndentationPerLevel, ' ');
    if (changed) {
        text.replace(start, depth > 0 ? kChanged.size() : 0, kChanged);
    }
    appendPrintable(text, leaf.displayName());
    text += ": ";
    appendPrintable(text, value);
    text += '\n';
    values.emplace(std::move(path), std::move(value));
}

} // namespace pallax
