#pragma once

#include "LogGenerator/Records/Base.h"
#include "platform/StandardOutput.h"

#include <memory>
#include <string>
#include <string_view>
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

    /// Every record by its section name.
    const ClassDict& classes() const { return classDict; }
    /// The record of that section, or null.
    Base* getClass(std::string_view sectionName) const;
    /// The records subscribed to the code in call order, or null when nobody wants it. Valid as
    /// long as the index.
    const std::vector<Base*>* getSubscribers(LogCode logCode) const;
    /// Every code that has a subscriber, as decimal text, ascending.
    std::vector<std::string> getAllLogCodes() const;
    /// Brings every section up to the latest record.
    void catchUp() const;
    /// Logs what the section dictionary is.
    void status() const;

protected:
    /// Creates a record and registers it.
    template <class Record>
    std::unique_ptr<Record> create() {
        auto record = std::make_unique<Record>();
        record->initWithDict(classDict, codeDictionary);
        return record;
    }

    StandardOutput& output() const { return _output; }

    ClassDict classDict;
    CodeDict codeDictionary;

private:
    StandardOutput& _output;
};

} // namespace pallax
