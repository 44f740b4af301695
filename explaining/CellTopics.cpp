#include "explaining/Topics.h"
#include "knowledge/CellIdentity.h"
#include "text/Format.h"

#include <cmath>

namespace pallax {

namespace {

AnswersResult explainCell(std::string_view topic, Words operands, const Library& /*library*/) {
    const auto identity = numberIn(topic, operands[0]);
    if (!identity) {
        return identity.error();
    }
    const auto lte = lteCell(*identity);
    const auto umts = umtsCell(*identity);
    if (!lte || !umts) {
        return unknown(formatText("A cell identity has 28 bits; %@ has more.", {*identity}));
    }
    const auto number = PropertyList::integer(*identity);
    Answers answers;
    answers.answers.push_back(
        {formatText("LTE cell %@", {*identity}),
         {{"eNodeB", std::to_string(lte->eNodeB)}, {"sector", std::to_string(lte->sector)}},
         {{"about", "cell"},
          {"system", "lte"},
          {"identity", number},
          {"enodeb", PropertyList::integer(lte->eNodeB)},
          {"sector", PropertyList::integer(lte->sector)}}});
    answers.answers.push_back(
        {formatText("UMTS cell %@", {*identity}),
         {{"RNC", std::to_string(umts->rnc)}, {"cell", std::to_string(umts->cell)}},
         {{"about", "cell"},
          {"system", "umts"},
          {"identity", number},
          {"rnc", PropertyList::integer(umts->rnc)},
          {"cell", PropertyList::integer(umts->cell)}}});
    return answers;
}

AnswersResult explainBsic(std::string_view topic, Words operands, const Library& /*library*/) {
    const auto bsic = numberIn(topic, operands[0]);
    if (!bsic) {
        return bsic.error();
    }
    const auto codes = colourCodesOf(*bsic);
    if (!codes) {
        return unknown(formatText("A BSIC has 6 bits; %@ has more.", {*bsic}));
    }
    return Answers{{{formatText("BSIC %@", {*bsic}),
                     {{"network colour code", std::to_string(codes->ncc)},
                      {"base station colour code", std::to_string(codes->bcc)}},
                     {{"about", "bsic"},
                      {"bsic", PropertyList::integer(*bsic)},
                      {"ncc", PropertyList::integer(codes->ncc)},
                      {"bcc", PropertyList::integer(codes->bcc)}}}}};
}

void addTimingAdvance(Answers& answers, RadioSystem system, const char* name, std::uint32_t steps) {
    const auto metres = timingAdvanceMetres(system, steps);
    if (!metres) {
        return;
    }
    const double step = timingAdvanceMetres(system, 1).value();
    answers.answers.push_back({formatText("%@ timing advance %@", {name, steps}),
                               {{"distance", formatText("about %@ m", {std::llround(*metres)})},
                                {"one step", numberText(step) + " m"}},
                               {{"about", "ta"},
                                {"system", std::string(nameOf(system))},
                                {"steps", PropertyList::integer(steps)},
                                {"metres", PropertyList::real(*metres)}}});
}

AnswersResult explainTimingAdvance(std::string_view topic, Words operands,
                                   const Library& /*library*/) {
    const auto steps = numberIn(topic, operands[0]);
    if (!steps) {
        return steps.error();
    }
    Answers answers;
    addTimingAdvance(answers, RadioSystem::Gsm, "GSM", *steps);
    addTimingAdvance(answers, RadioSystem::Lte, "LTE", *steps);
    if (answers.answers.empty()) {
        return unknown(formatText("No timing advance has %@ steps.", {*steps}));
    }
    return answers;
}

AnswersResult explainResourceBlocks(std::string_view topic, Words operands,
                                    const Library& /*library*/) {
    const auto blocks = numberIn(topic, operands[0]);
    if (!blocks) {
        return blocks.error();
    }
    const auto megahertz = lteBandwidthMegahertz(*blocks);
    if (!megahertz) {
        return unknown(formatText("No LTE carrier has %@ resource blocks.", {*blocks}));
    }
    return Answers{{{formatText("LTE carrier of %@ resource blocks", {*blocks}),
                     {{"bandwidth", numberText(*megahertz) + " MHz"}},
                     {{"about", "prb"},
                      {"system", "lte"},
                      {"resource_blocks", PropertyList::integer(*blocks)},
                      {"mhz", PropertyList::real(*megahertz)}}}}};
}

} // namespace

std::vector<Topic> cellTopics() {
    return {{"cell", "a cell identity", 1, 1, explainCell},
            {"bsic", "a base station identity code", 1, 1, explainBsic},
            {"ta", "a timing advance in steps", 1, 1, explainTimingAdvance},
            {"prb", "a number of resource blocks", 1, 1, explainResourceBlocks}};
}

} // namespace pallax
