#pragma once

#include "LogGenerator/Records/Sample.h"

#include <cstddef>

namespace pallax {

/// One pass for the display and another sink, over a packet that must be read once. What is kept
/// from the display goes to the other sink alone.
class DisplayAndSink final : public SampleSink {
public:
    /// Both outlive it.
    DisplayAndSink(SampleSink& display, SampleSink& sink) : _display(display), _sink(sink) {}

    void sample(const Sample& sample) override {
        each([&](SampleSink& to) { to.sample(sample); });
    }
    void keyRemoved(std::string_view key) override {
        each([&](SampleSink& to) { to.keyRemoved(key); });
    }
    void beginList(const SampleList& list) override {
        if (_hiddenLists != 0 || (list.layout != nullptr && !list.layout->isShown)) {
            ++_hiddenLists;
        }
        each([&](SampleSink& to) { to.beginList(list); });
    }
    void endList() override {
        each([](SampleSink& to) { to.endList(); });
        if (_hiddenLists != 0) {
            --_hiddenLists;
        }
    }
    void beginEntry(std::size_t index, std::int64_t name) override {
        each([&](SampleSink& to) { to.beginEntry(index, name); });
    }
    void endEntry() override {
        each([](SampleSink& to) { to.endEntry(); });
    }

private:
    template <class Give>
    void each(const Give& give) {
        if (_hiddenLists == 0) {
            give(_display);
        }
        give(_sink);
    }

    SampleSink& _display;
    SampleSink& _sink;
    std::size_t _hiddenLists = 0; ///< begun and not ended: a hidden one, and those in it
};

} // namespace pallax
