#include "LogGenerator/Records/ClassIndex.h"

#include "platform/SystemLog.h"

#include <algorithm>

namespace pallax {

ClassIndex::~ClassIndex() {
    _output.printLine("Deallocing ClassIndex");
}

Base* ClassIndex::getClass(std::string_view sectionName) const {
    const auto found = classDict.find(sectionName);
    return found != classDict.end() ? found->second : nullptr;
}

const std::vector<Base*>* ClassIndex::getSubscribers(LogCode logCode) const {
    const auto found = codeDictionary.find(logCode);
    return found != codeDictionary.end() ? &found->second : nullptr;
}

std::vector<std::string> ClassIndex::getAllLogCodes() const {
    std::vector<std::string> codes;
    codes.reserve(codeDictionary.size());
    for (const auto& entry : codeDictionary) {
        codes.push_back(std::to_string(entry.first));
    }
    return codes;
}

void ClassIndex::addRows(LayoutRecord& record) {
    record.display().setLate(true);
    record.setPlace(_nextRow, _packetTime);
    _records.push_back({&record, _nextRow});
    for (const CodeLayout& code : record.layout().codes) {
        _nextRow += static_cast<FieldId>(rowCount(code));
    }
}

const ClassIndex::Numbered* ClassIndex::recordOf(std::string_view sectionName) const {
    const auto found =
        std::find_if(_records.begin(), _records.end(), [sectionName](const Numbered& each) {
            return each.record->getSectionName() == sectionName;
        });
    return found != _records.end() ? &*found : nullptr;
}

void ClassIndex::setSink(SampleSink* sink) {
    for (const auto& [record, firstRow] : _records) {
        record->setSink(sink);
    }
}

void ClassIndex::bringDisplayUpToDate() const {
    for (const auto& [record, firstRow] : _records) {
        record->display().bringUpToDate();
    }
}

void ClassIndex::status() const {
    // Always a dictionary here; log readers expect both lines.
    systemLog(LogPriority::Warning, "Dictionary = %d", 1);
    systemLog(LogPriority::Warning, "String = %d", 0);
}

} // namespace pallax
