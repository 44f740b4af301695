#include "overview/StatusWords.h"

#include "fields/Measures.h"
#include "knowledge/CellIdentity.h"
#include "knowledge/Channels.h"
#include "text/AgeText.h"

#include <algorithm>
#include <cmath>

namespace pallax {

std::string operatorWords(const StatusOperator& network) {
    std::string words = network.name;
    if (network.code) {
        words.append(words.empty() ? "" : " ").append(network.code->mcc).append("-");
        words.append(network.code->mnc);
    }
    return words.append(network.country.empty() ? "" : " (" + network.country + ")");
}

std::optional<std::uint32_t> wholeNumber(double number) {
    constexpr double kMost = 4294967295.0;
    const bool isWhole = number >= 0 && number <= kMost && number == std::trunc(number);
    return isWhole ? std::optional(static_cast<std::uint32_t>(number)) : std::nullopt;
}

std::string siteWords(RadioSystem system, double identity) {
    const auto number = wholeNumber(identity);
    const bool isUmts = system == RadioSystem::UmtsFdd || system == RadioSystem::UtraTdd;
    if (const auto cell = number && system == RadioSystem::Lte ? lteCell(*number) : std::nullopt) {
        return formatText("eNodeB %u sector %u", {cell->eNodeB, cell->sector});
    }
    if (const auto cell = number && isUmts ? umtsCell(*number) : std::nullopt) {
        return formatText("RNC %u cell %u", {cell->rnc, cell->cell});
    }
    return "";
}

std::vector<std::string> identityWords(const StatusCell& cell) {
    std::vector<std::string> words;
    if (!cell.site.empty()) {
        words.push_back(cell.site);
    }
    for (const StatusValue& part : cell.identity) {
        if (part.name != "cell") { // it is the site
            words.push_back(part.name + " " + part.text);
        }
    }
    return words;
}

std::vector<std::string> channelWords(const StatusCell& cell) {
    if (!cell.channel) {
        return {};
    }
    std::vector<std::string> words{cell.channel->name + " " + cell.channel->text};
    if (!cell.band.empty()) {
        words.push_back("band " + cell.band);
    }
    if (cell.megahertz) {
        constexpr double kHertz = 1e6;
        words.push_back(megahertzText(static_cast<Hertz>(std::llround(*cell.megahertz * kHertz))) +
                        " MHz");
    }
    return words;
}

std::string stateWords(const StatusValue& state) {
    const bool namesItself = state.text.starts_with(state.name + "_"); // "MM_IDLE"
    return namesItself ? state.text : state.name + " " + state.text;
}

std::string contextWords(const StatusContext& context) {
    return context.state.empty() ? context.name : context.name + " " + context.state;
}

std::string_view qualityWord(const StatusValue& value) {
    return value.grade ? nameOf(*value.grade) : std::string_view();
}

std::string ageWords(std::chrono::nanoseconds age) {
    return ageText(age) + " ago";
}

std::string oldAgeWords(Time now, const std::vector<const StatusValue*>& values) {
    std::chrono::nanoseconds oldest{0};
    for (const StatusValue* value : values) {
        if (isOld(now, *value)) {
            oldest = std::max<std::chrono::nanoseconds>(oldest, now - value->read);
        }
    }
    return oldest > std::chrono::nanoseconds::zero() ? ageWords(oldest) : "";
}

std::optional<double> shareOf(const StatusValue& level) {
    const auto measure = measureOf(level.field);
    if (!measure || !std::isfinite(level.number)) {
        return std::nullopt;
    }
    const MeasureInfo& info = infoOf(*measure);
    return std::clamp((level.number - info.worst) / (info.best - info.worst), 0.0, 1.0);
}

} // namespace pallax
