#include "browsing/TreePrinter.h"

#include "platform/Clock.h"
#include "text/Printable.h"

#include <algorithm>
#include <vector>

namespace pallax {

namespace {

constexpr std::size_t kIndentationPerLevel = 2;
constexpr std::string_view kChanged = "* ";

/// "Serving Cell, ARFCN" for "/Serving Cell/ARFCN".
std::string wordsOfPath(std::string_view path) {
    std::string words;
    for (const char character : path) {
        if (character != '/') {
            words += character;
        } else if (!words.empty()) {
            words += ", ";
        }
    }
    while (words.ends_with(", ")) { // of one of several leaves at the same path
        words.erase(words.size() - 2);
    }
    return words;
}

} // namespace

void TreePrinter::updateViewControllerFromModel() {
    if (_form == Form::Tree) {
        _output.text().append("== ").append(dateText(dateOf(_clock.now()))).append(1, '\n');
    }
    _way.clear();
    Values values;
    if (const NodeRef root = _nodes()) {
        if (root->childNodes() == nullptr) {
            printLeaf(*root, "/", 0, values);
        } else {
            printChildren(*root, "/", 0, values);
        }
    }
    if (_form == Form::Sentences) {
        printGone(values);
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
        printBranch(child->displayName(), depth);
        printChildren(*child, childsPath, depth + 1, values);
    }
}

void TreePrinter::printBranch(const std::string& name, std::size_t depth) {
    if (_form == Form::Tree) {
        _output.text().append(depth * kIndentationPerLevel, ' ');
        appendPrintable(_output.text(), name);
        _output.text() += '\n';
    }
}

void TreePrinter::printGone(const Values& values) {
    std::vector<std::string> gone;
    for (const auto& [path, value] : _values) {
        if (!values.contains(path)) {
            gone.push_back(wordsOfPath(path));
        }
    }
    std::sort(gone.begin(), gone.end());
    for (const std::string& words : gone) {
        appendPrintable(_output.text(), words);
        _output.text() += " is gone.\n";
    }
}

void TreePrinter::printSentence(const PallaxModelNode& leaf, const std::string& path,
                                const std::string& value) {
    const std::string way = wordsOfPath(path.substr(0, path.rfind('/')));
    std::string& text = _output.text();
    if (!way.empty() && way != _way) {
        text += "In ";
        appendPrintable(text, way);
        text += ":\n";
    }
    _way = way;
    appendPrintable(text, leaf.displayName());
    text += ": ";
    appendPrintable(text, value);
    text += '\n';
}

void TreePrinter::printLeaf(const PallaxModelNode& leaf, std::string path, std::size_t depth,
                            Values& values) {
    std::string value;
    (void)leaf.value()->appendString(value);
    const std::string place = path;
    while (values.contains(path)) {
        path += '/'; // unique: no child's path ends with it; for another leaf at the same path
    }
    const auto before = _values.find(path);
    const bool isNews = before == _values.end() || before->second != value;
    const bool changed = _hasPrinted && isNews;
    if (_form == Form::Sentences) {
        if (isNews) {
            printSentence(leaf, place, value);
        }
        values.emplace(std::move(path), std::move(value));
        return;
    }
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
