#pragma once

#include "LogGenerator/Records/Base.h"
#include "LogGenerator/Records/LayoutRecord.h"
#include "platform/StandardOutput.h"

#include <memory>
#include <string>
#include <string_view>
#include <type_traits>
#include <vector>

namespace pallax {

/// The records of one technology, found by section name and by log code. A technology's subclass
/// owns one instance of every record class.
class ClassIndex {
public:
    /// `output` gets the destruction notice.
    explicit ClassIndex(StandardOutput& output) : _output(output) {}
    virtual ~ClassIndex();
    ClassIndex(const ClassIndex&) = delete;
    ClassIndex& operator=(const ClassIndex&) = delete;

    const ClassDict& classes() const { return classDict; }
    /// The record of that section, or null.
    Base* getClass(std::string_view sectionName) const;
    /// The records subscribed to the code, in call order; null when there are none. Valid as long
    /// as the index.
    const std::vector<Base*>* getSubscribers(LogCode logCode) const;
    /// Every code that has a subscriber, as decimal text, ascending.
    std::vector<std::string> getAllLogCodes() const;
    /// A record and the number of its first field; numbers follow the order of creation.
    struct Numbered {
        LayoutRecord* record;
        FieldId firstRow;
    };
    const std::vector<Numbered>& records() const { return _records; }
    /// The record of that section, or null.
    const Numbered* recordOf(std::string_view sectionName) const;
    /// Sets the time of the packet whose records follow.
    void setPacketTime(Time time) { _packetTime = time; }
    /// Also gives the samples of all records to `sink`; null stops it. The sink must outlive the
    /// index or be removed first.
    void setSink(SampleSink* sink);
    /// Brings every section up to date with the latest log record.
    void bringDisplayUpToDate() const;
    /// Logs what the section dictionary is.
    void status() const;

protected:
    /// Creates a record and registers it.
    template <class Record>
    std::unique_ptr<Record> create() {
        auto record = std::make_unique<Record>();
        record->initWithDict(classDict, codeDictionary);
        if constexpr (std::is_base_of_v<LayoutRecord, Record>) {
            addRows(*record);
        }
        return record;
    }

    StandardOutput& output() const { return _output; }

    ClassDict classDict;
    CodeDict codeDictionary;

private:
    void addRows(LayoutRecord& record);

    StandardOutput& _output;
    std::vector<Numbered> _records;
    FieldId _nextRow = 0;
    Time _packetTime{};
};

} // namespace pallax
