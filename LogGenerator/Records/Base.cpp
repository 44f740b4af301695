#include "LogGenerator/Records/Base.h"

#include "LogGenerator/Records/ArrayLock.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/Exceptions.h"
#include "platform/SystemLog.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace pallax {

namespace {

auto findGroup(std::span<const FieldGroup> groups, LogCode logCode) {
    return std::find_if(groups.begin(), groups.end(),
                        [logCode](const FieldGroup& each) { return each.logCode == logCode; });
}

} // namespace

void Base::initWithDict(ClassDict& classDict, CodeDict& codeDict) {
    classDict.insert_or_assign(std::string(getSectionName()), this);
    updateLogCodeDict(codeDict);
}

void Base::updateSectionRef(PropertyList section) {
    catchUp(); // what was kept is for the section before
    _sectionRef = std::move(section);
    systemLog(LogPriority::Warning, "%s", getSectionName());
}

void Base::receive(const LogRecord& record, LogCode logCode) {
    // Whoever reads the lines that records log wants each when its record arrives.
    const bool keeps =
        !SystemLog::isEnabled(LogPriority::Warning) && replacesShown(record, logCode);
    const unsigned kind = keeps ? kindOf(record) : 0;
    if (!keeps || _keptCode != logCode || _keptKind != kind) {
        catchUp();
    }
    if (!keeps) {
        return updateWithData(record, logCode);
    }
    _kept.assign(record.bytes().begin(), record.bytes().end());
    _keptCode = logCode;
    _keptKind = kind;
}

void Base::catchUp() {
    if (const auto logCode = std::exchange(_keptCode, std::nullopt)) {
        updateWithData(LogRecord(_kept), *logCode);
    }
}

bool Base::replacesShown(const LogRecord& /*record*/, LogCode /*logCode*/) const {
    return false;
}

void Base::updateWithData(const LogRecord& /*record*/, LogCode /*logCode*/) {
    throw UnrecognisedOperation("updateWithData:logCode:");
}

std::string_view Base::getSectionName() const {
    throw UnrecognisedOperation("getSectionName");
}

std::span<const LogCode> Base::getLogCodeArray() const {
    throw UnrecognisedOperation("getLogCodeArray");
}

void Base::updateLogCodeDict(CodeDict& codeDict) {
    const std::span<const LogCode> codes = getLogCodeArray();
    systemLog(LogPriority::Warning, "Array Count: %d", codes.size());
    for (const LogCode code : codes) {
        codeDict[code].push_back(this);
    }
}

void Base::clearElementsInArray(Array& array) {
    ArrayLock::lockArray();
    array.clear();
    ArrayLock::unlockArray();
}

void Base::replaceArray(Array& array, Array with) {
    ArrayLock::lockArray();
    array = std::move(with);
    ArrayLock::unlockArray();
}

void Base::show(std::string_view key, PropertyList value) {
    if (const DictionaryRef section = _sectionRef.dictionary()) {
        section->setFixed(key, std::move(value));
    }
}

void Base::show(std::span<const Field> fields, const LogRecord& record) {
    if (const DictionaryRef section = _sectionRef.dictionary()) {
        showFields(*section, fields, record);
    }
}

void Base::showGroup(std::span<const FieldGroup> groups, const LogRecord& record, LogCode logCode) {
    const auto group = findGroup(groups, logCode);
    if (group == groups.end()) {
        logUnknown(logCode);
    } else if (record.has(group->minimumLength)) {
        show(group->fields, record);
    }
}

bool Base::isOfGroup(std::span<const FieldGroup> groups, const LogRecord& record, LogCode logCode) {
    const auto group = findGroup(groups, logCode);
    return group != groups.end() && record.has(group->minimumLength);
}

void Base::removeKey(std::string_view key) {
    if (const DictionaryRef section = _sectionRef.dictionary()) {
        (void)section->remove(key);
    }
}

void Base::clearList() {
    if (const ArrayRef list = _sectionRef.array()) {
        _spares.clear();
        ArrayLock::lockArray();
        _spares.swap(*list);
        ArrayLock::unlockArray();
    }
}

void Base::replaceList(Array with) {
    if (const ArrayRef list = _sectionRef.array()) {
        replaceArray(*list, std::move(with));
    }
}

DictionaryRef Base::spareEntry() {
    while (!_spares.empty()) {
        const PropertyList spare = std::move(_spares.back());
        _spares.pop_back();
        DictionaryRef entry = spare.dictionary();
        constexpr long kSpareAndEntry = 2;
        if (entry != nullptr && entry.use_count() == kSpareAndEntry) {
            return entry;
        }
    }
    return std::make_shared<Dictionary>();
}

void Base::logUnknown(LogCode logCode) {
    systemLog(LogPriority::Error, "Received an unknown log message: %d", logCode);
}

std::int16_t Base::lookUpECNO(std::uint32_t value) {
    constexpr std::uint32_t kFullScale = 524288; // 2^19: 0 dB
    struct Band {
        std::uint32_t least;
        std::int16_t decibels;
    };
    // Each band reaches up to the one before it. The -31 band is twice as wide as its
    // neighbours, and below it there is nothing to measure.
    static constexpr Band kBands[] = {
        {417648, -1}, {331809, -2}, {263625, -3}, {209464, -4}, {166442, -5}, {132269, -6},
        {105124, -7}, {83563, -8},  {66436, -9},  {52831, -10}, {42024, -11}, {33441, -12},
        {26622, -13}, {21206, -14}, {16904, -15}, {13487, -16}, {10772, -17}, {8616, -18},
        {6903, -19},  {5543, -20},  {4462, -21},  {3604, -22},  {2922, -23},  {2241, -24},
        {1950, -25},  {1608, -26},  {1337, -27},  {1121, -28},  {950, -29},   {814, -30},
        {706, -31},
    };
    if (value >= kFullScale) {
        return 0;
    }
    const auto* band = std::find_if(std::begin(kBands), std::end(kBands),
                                    [value](const Band& row) { return value >= row.least; });
    return band != std::end(kBands) ? band->decibels : std::int16_t{0};
}

RecordDescription Base::describe() const {
    throw UnrecognisedOperation("describe");
}

} // namespace pallax
