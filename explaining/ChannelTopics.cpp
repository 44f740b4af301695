#include "explaining/Topics.h"
#include "knowledge/Channels.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>

namespace pallax {

namespace {

struct SystemWords {
    RadioSystem system;
    std::string_view bandPrefix; ///< before the name of a band
    std::string_view channel;    ///< what its numbers are called
};

constexpr auto kSystemWords = std::to_array<SystemWords>({
    {RadioSystem::Gsm, "", "ARFCN"},
    {RadioSystem::UmtsFdd, "UMTS band ", "UARFCN"},
    {RadioSystem::UtraTdd, "UTRA TDD band ", "UARFCN"},
    {RadioSystem::Lte, "LTE band ", "EARFCN"},
    {RadioSystem::Nr, "NR band ", "NR-ARFCN"},
    {RadioSystem::Cdma, "CDMA band class ", "channel"},
});

const SystemWords& wordsOf(RadioSystem system) {
    return *std::find_if(kSystemWords.begin(), kSystemWords.end(),
                         [system](const SystemWords& each) { return each.system == system; });
}

constexpr double kHertzPerMegahertz = 1e6;

PropertyList megahertzNumber(Hertz hertz) {
    return PropertyList::real(static_cast<double>(hertz) / kHertzPerMegahertz);
}

PropertyList channelObject(const std::optional<Channel>& channel) {
    if (!channel) {
        return {};
    }
    return Dictionary{{"channel", PropertyList::integer(channel->number)},
                      {"mhz", megahertzNumber(channel->hertz)}};
}

std::string channelText(const SystemWords& words, const Channel& channel) {
    return formatText("%@ MHz, %@ %@",
                      {megahertzText(channel.hertz), words.channel, channel.number});
}

/// Of a carrier or of a part of a band.
bool isTdd(const auto& both) {
    return both.downlink && both.downlink == both.uplink;
}

/// Adds what `text` says about each direction.
void addDirections(Answer& answer, const auto& both, const auto& text) {
    if (isTdd(both)) {
        answer.rows.push_back({"both directions", text(*both.downlink)});
        return;
    }
    if (both.downlink) {
        answer.rows.push_back({"downlink", text(*both.downlink)});
    }
    if (both.uplink) {
        answer.rows.push_back({"uplink", text(*both.uplink)});
    }
}

Answer answerFor(std::string_view topic, RadioSystem system, const Carrier& carrier) {
    const SystemWords& words = wordsOf(system);
    Answer answer;
    answer.heading = std::string(words.bandPrefix).append(carrier.band);
    answer.heading += carrier.isOfUplink ? ", uplink" : "";
    addDirections(answer, carrier,
                  [&words](const Channel& channel) { return channelText(words, channel); });
    const char* direction = isTdd(carrier) ? "both" : carrier.isOfUplink ? "uplink" : "downlink";
    answer.object = Dictionary{{"about", std::string(topic)},
                               {"system", std::string(nameOf(system))},
                               {"band", std::string(carrier.band)},
                               {"direction", direction},
                               {"downlink", channelObject(carrier.downlink)},
                               {"uplink", channelObject(carrier.uplink)}};
    return answer;
}

void addAnswers(Answers& answers, std::string_view topic, RadioSystem system,
                const std::vector<Carrier>& carriers) {
    for (const Carrier& carrier : carriers) {
        answers.answers.push_back(answerFor(topic, system, carrier));
    }
}

AnswersResult explainNumber(std::string_view topic, Words operands, const Library& /*library*/) {
    static constexpr auto kSystems =
        std::to_array<std::pair<std::string_view, RadioSystem>>({{"arfcn", RadioSystem::Gsm},
                                                                 {"uarfcn", RadioSystem::UmtsFdd},
                                                                 {"uarfcn", RadioSystem::UtraTdd},
                                                                 {"earfcn", RadioSystem::Lte},
                                                                 {"nrarfcn", RadioSystem::Nr}});
    const auto number = numberIn(topic, operands[0]);
    if (!number) {
        return number.error();
    }
    Answers answers;
    std::string_view word;
    for (const auto& [name, system] : kSystems) {
        if (name == topic) {
            addAnswers(answers, topic, system, carriersOf(system, *number));
            word = wordsOf(system).channel;
        }
    }
    if (answers.answers.empty()) {
        return unknown(formatText("No band has %@ %@.", {word, *number}));
    }
    return answers;
}

AnswersResult explainCdma(std::string_view topic, Words operands, const Library& /*library*/) {
    const auto bandClass = numberIn(topic, operands[0]);
    const auto number = numberIn(topic, operands[1]);
    if (!bandClass || !number) {
        return bandClass ? number.error() : bandClass.error();
    }
    std::vector<Carrier> carriers = carriersOf(RadioSystem::Cdma, *number);
    const std::string band = std::to_string(*bandClass);
    std::erase_if(carriers, [&band](const Carrier& carrier) { return carrier.band != band; });
    if (carriers.empty()) {
        return unknown(formatText("CDMA band class %@ has no channel %@.", {*bandClass, *number}));
    }
    Answers answers;
    addAnswers(answers, topic, RadioSystem::Cdma, carriers);
    return answers;
}

Result<RadioSystem, Refusal> systemIn(std::string_view topic, const std::string& word) {
    if (const auto system = radioSystemNamed(word)) {
        return *system;
    }
    return misused(formatText("explain %@ takes gsm, umts, utran, lte, nr or cdma, not \"%@\"",
                              {topic, word}));
}

AnswersResult explainFrequency(std::string_view topic, Words operands, const Library& /*library*/) {
    constexpr double kMostMegahertz = 1e6;
    const auto system = systemIn(topic, operands[0]);
    const auto megahertz = realIn(topic, operands[1]);
    if (!system || !megahertz) {
        return system ? megahertz.error() : system.error();
    }
    Answers answers;
    if (std::abs(*megahertz) <= kMostMegahertz) {
        addAnswers(answers, topic, *system,
                   carriersAt(*system, std::llround(*megahertz * kHertzPerMegahertz)));
    }
    if (answers.answers.empty()) {
        return unknown(formatText("No channel of %@ is at %@ MHz.",
                                  {nameOf(*system), numberText(*megahertz)}));
    }
    return answers;
}

PropertyList rangeObject(const std::optional<BandPart::Range>& range) {
    if (!range) {
        return {};
    }
    return Dictionary{{"first", channelObject(range->first)}, {"last", channelObject(range->last)}};
}

std::string rangeText(const SystemWords& words, const BandPart::Range& range) {
    if (range.first == range.last) {
        return channelText(words, range.first);
    }
    return formatText("%@ to %@ MHz, %@ %@ to %@",
                      {megahertzText(range.first.hertz), megahertzText(range.last.hertz),
                       words.channel, range.first.number, range.last.number});
}

Answer answerFor(RadioSystem system, const BandPart& part) {
    const SystemWords& words = wordsOf(system);
    Answer answer{std::string(words.bandPrefix).append(part.band), {}, {}};
    addDirections(answer, part,
                  [&words](const BandPart::Range& range) { return rangeText(words, range); });
    answer.object = Dictionary{{"about", "band"},
                               {"system", std::string(nameOf(system))},
                               {"band", std::string(part.band)},
                               {"downlink", rangeObject(part.downlink)},
                               {"uplink", rangeObject(part.uplink)}};
    return answer;
}

std::string edgesText(const UnnumberedBand::Edges& edges) {
    return formatText("%@ to %@ MHz, ARFCN assigned by the network",
                      {megahertzText(edges.low), megahertzText(edges.high)});
}

PropertyList edgesObject(const UnnumberedBand::Edges& edges) {
    const auto edge = [](Hertz hertz) {
        return Dictionary{{"channel", {}}, {"mhz", megahertzNumber(hertz)}};
    };
    return Dictionary{{"first", edge(edges.low)}, {"last", edge(edges.high)}};
}

Answer answerFor(RadioSystem system, const UnnumberedBand& band) {
    return {std::string(band.band),
            {{"downlink", edgesText(band.downlink)}, {"uplink", edgesText(band.uplink)}},
            {{"about", "band"},
             {"system", std::string(nameOf(system))},
             {"band", std::string(band.band)},
             {"downlink", edgesObject(band.downlink)},
             {"uplink", edgesObject(band.uplink)}}};
}

/// "XIX" for 19: names of UMTS bands.
std::string romanNumeral(std::uint32_t number) {
    constexpr auto kNumerals = std::to_array<std::pair<std::uint32_t, std::string_view>>(
        {{10, "X"}, {9, "IX"}, {5, "V"}, {4, "IV"}, {1, "I"}});
    std::string numeral;
    for (const auto& [value, letters] : kNumerals) {
        for (; number >= value; number -= value) {
            numeral += letters;
        }
    }
    return numeral;
}

std::string lowerCase(std::string_view text) {
    std::string lower(text);
    std::transform(lower.begin(), lower.end(), lower.begin(), [](char each) {
        return each >= 'A' && each <= 'Z' ? static_cast<char>(each - 'A' + 'a') : each;
    });
    return lower;
}

/// Whether people call the band so: "3", "n78" or "78", "III" or "3", "DCS 1800" or "1800".
bool isCalled(std::string_view band, RadioSystem system, std::string_view wanted) {
    const std::string name = lowerCase(band);
    constexpr std::uint32_t kMostUmtsBand = 32;
    if (name == wanted || (system == RadioSystem::Nr && name.substr(1) == wanted)) {
        return true;
    }
    if (system == RadioSystem::Gsm) {
        return name.substr(name.rfind(' ') + 1) == wanted;
    }
    const auto number = numberIn("", std::string(wanted));
    return system == RadioSystem::UmtsFdd && number && *number <= kMostUmtsBand &&
           band == romanNumeral(*number);
}

AnswersResult explainBand(std::string_view topic, Words operands, const Library& /*library*/) {
    const auto system = systemIn(topic, operands[0]);
    if (!system) {
        return system.error();
    }
    std::string wanted;
    for (const std::string& word : operands.subspan(1)) {
        wanted.append(wanted.empty() ? "" : " ").append(lowerCase(word));
    }
    Answers answers;
    const auto add = [&](const auto& bands) {
        for (const auto& band : bands) {
            if (operands.size() == 1 || isCalled(band.band, *system, wanted)) {
                answers.answers.push_back(answerFor(*system, band));
            }
        }
    };
    add(bandsOf(*system));
    add(unnumberedBandsOf(*system));
    if (answers.answers.empty()) {
        return unknown(formatText("%@ has no band \"%@\".", {operands[0], wanted}));
    }
    return answers;
}

} // namespace

std::vector<Topic> channelTopics() {
    return {{"arfcn", "a channel number", 1, 1, explainNumber},
            {"uarfcn", "a channel number", 1, 1, explainNumber},
            {"earfcn", "a channel number", 1, 1, explainNumber},
            {"nrarfcn", "a channel number", 1, 1, explainNumber},
            {"cdma", "a band class and a channel number", 2, 2, explainCdma},
            {"band", "a system and a band", 1, 3, explainBand},
            {"mhz", "a system and a frequency in MHz", 2, 2, explainFrequency}};
}

} // namespace pallax
