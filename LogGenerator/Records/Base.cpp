#include "LogGenerator/Records/Base.h"

#include "LogGenerator/Records/ArrayLock.h"
#include "LogGenerator/Records/Exceptions.h"
#include "platform/SystemLog.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace pallax {

void Base::initWithDict(ClassDict& classDict, CodeDict& codeDict) {
    classDict.insert_or_assign(std::string(getSectionName()), this);
    updateLogCodeDict(codeDict);
}

void Base::updateSectionRef(PropertyList section) {
    _sectionRef = std::move(section);
    systemLog(LogPriority::Warning, "%s", getSectionName());
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

std::int16_t Base::lookUpECNO(std::uint32_t value) {
    constexpr std::uint32_t kFullScale = 524288; // 2^19: 0 dB
    struct Band {
        std::uint32_t least;
        std::int16_t decibels;
    };
    // Each band ends where the one above it begins. The -31 band is twice as wide as its
    // neighbours; values below it are too small to measure.
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

} // namespace pallax
