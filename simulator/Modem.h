#pragma once

#include "simulator/Scenario.h"
#include "text/Bytes.h"

#include <cstddef>
#include <deque>

namespace pallax {

/// The log records of events, to be sent in this order before any report.
class RecordQueue {
public:
    /// Appends a log record for the caller to write.
    ByteBuffer& add() { return _records.emplace_back(); }
    bool empty() const { return _records.empty(); }
    std::size_t size() const { return _records.size(); }
    /// The queue must not be empty.
    void take(ByteBuffer& out) {
        out.swap(_records.front());
        _records.pop_front();
    }

private:
    std::deque<ByteBuffer> _records;
};

/// A modem of one technology: turns the events of a scenario into log records.
class Modem {
public:
    Modem() = default;
    Modem(const Modem&) = delete;
    Modem& operator=(const Modem&) = delete;
    virtual ~Modem() = default;

    /// Queues the log records for the scenario's latest step. The first call is for the start.
    virtual void observe(const Scenario& scenario, RecordQueue& queue) = 0;
    /// Writes the next periodic report. `random` provides the measurement noise.
    virtual void report(const Scenario& scenario, Random& random, ByteBuffer& out) = 0;
    /// False for a modem whose messages are not log records.
    virtual bool sendsRecords() const { return true; }
};

} // namespace pallax
