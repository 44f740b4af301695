#pragma once

#include "LogGenerator/Records/Sample.h"

#include <cstddef>

namespace pallax {

/// Reads a packet once for the display and another sink. Values that are not shown go only to the
/// other sink.
class DisplayAndSink final : public SampleSink {
public:
    /// Both must outlive it.
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
    std::size_t _hiddenLists = 0; ///< open hidden lists, with the lists in them
};

} // namespace pallax
