#pragma once

#include "app/tree/PallaxModelNode.h"
#include "console/Output.h"
#include "monitor/PallaxModel.h"

#include <cstddef>
#include <functional>
#include <string>
#include <unordered_map>

namespace pallax {

class Clock;

/// Browsing without a terminal: at each display tick with new data, prints the whole tree as text,
/// one leaf per line, and marks the changed ones.
///
///     == 2023-11-14 22:13:22 +0000
///     Serving Cell Measurements
///       E-ARFCN: 1850
///     * Measured RSRP: -94.75 dBm
///
/// The mark replaces the first two blanks, so columns stay. A new leaf counts as changed; in the
/// first block nothing is marked.
///
/// For a screen reader it prints sentences instead: only what is new, changed or gone since the
/// last tick, below the way to it where that differs from the line before.
///
///     In Serving Cell Measurements:
///     Measured RSRP: -94.75 dBm
class TreePrinter final : public ModelObserver {
public:
    /// Returns the root of the display tree, or null.
    using Nodes = std::function<NodeRef()>;

    enum class Form { Tree, Sentences };

    TreePrinter(Output& output, const Clock& clock, Nodes nodes, Form form = Form::Tree)
        : _output(output), _clock(clock), _nodes(std::move(nodes)), _form(form) {}

    void updateViewControllerFromModel() override;
    /// Treats the next block as a first one.
    void startAfresh() {
        _hasPrinted = false;
        _values.clear();
    }
    /// Call this regularly: prints "Connecting..." once each time the connection is lost.
    void showConnection(bool isConnected);

private:
    using Values = std::unordered_map<std::string, std::string>;

    void printChildren(const PallaxModelNode& node, const std::string& path, std::size_t depth,
                       Values& values);
    void printBranch(const std::string& name, std::size_t depth);
    void printGone(const Values& values);
    void printSentence(const PallaxModelNode& leaf, const std::string& path,
                       const std::string& value);
    void printLeaf(const PallaxModelNode& leaf, std::string path, std::size_t depth,
                   Values& values);

    Output& _output;
    const Clock& _clock;
    Nodes _nodes;
    Form _form;
    std::string _way; ///< to the latest sentence of this tick
    bool _toldConnecting = false;
    bool _hasPrinted = false;
    Values _values; // of the previous block, by path
};

} // namespace pallax
