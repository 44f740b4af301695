#pragma once

#include "simulator/Scenario.h"
#include "text/Bytes.h"

#include <cstddef>
#include <deque>

namespace pallax {

/// Records that an event has brought, to be sent in this order before any report.
class RecordQueue {
public:
    /// Room for one more record, which the caller writes.
    ByteBuffer& add() { return _records.emplace_back(); }
    bool empty() const { return _records.empty(); }
    std::size_t size() const { return _records.size(); }
    /// The queue is not empty.
    void take(ByteBuffer& out) {
        out.swap(_records.front());
        _records.pop_front();
    }

private:
    std::deque<ByteBuffer> _records;
};

/// A modem of one technology: puts what happens in a scenario into its log records.
class Modem {
public:
    Modem() = default;
    Modem(const Modem&) = delete;
    Modem& operator=(const Modem&) = delete;
    virtual ~Modem() = default;

    /// Queues the records of what the scenario's latest step has changed. The first call is for
    /// the first moment.
    virtual void observe(const Scenario& scenario, RecordQueue& queue) = 0;
    /// Writes the next of the reports that come again and again. `random` is that of the reports:
    /// measurement noise.
    virtual void report(const Scenario& scenario, Random& random, ByteBuffer& out) = 0;
    /// False for a modem whose messages are no log records.
    virtual bool sendsRecords() const { return true; }
};

} // namespace pallax
