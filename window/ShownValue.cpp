#include "window/ShownValue.h"

#include "overview/ValueFacts.h"

#include <cmath>

namespace pallax {

namespace {

constexpr std::size_t kCurvePoints = 400;

std::string joined(const std::vector<std::string>& words) {
    std::string text;
    for (const std::string& word : words) {
        text += (text.empty() ? "" : " · ") + word;
    }
    return text;
}

} // namespace

gtk::ValueView::Content shownValue(terminal::ShownValues& values, const std::string& path,
                                   const std::string& text) {
    gtk::ValueView::Content content{.text = text, .quality = "", .lines = {path}, .unit = ""};
    values.update();
    const CurrentValues* current = values.values();
    const auto name = current != nullptr ? leafAt(*current, path) : std::nullopt;
    const auto field = name ? current->fields().named(name->field) : std::nullopt;
    const auto value = field ? valueOf(*current, *name) : std::nullopt;
    if (!value) {
        return content;
    }
    const FieldInfo& info = current->fields()[*field];
    const ValueFacts facts = factsOf(*current, info, &*value, values.reading(*name, *value),
                                     values.names(), values.profile());
    content.text = facts.text;
    content.quality = facts.grade ? std::string(nameOf(*facts.grade)) : "";
    content.lines = {facts.meaning,
                     joined(facts.knowledge),
                     joined(facts.origin),
                     facts.borders,
                     facts.range.empty() ? "" : "range " + facts.range,
                     path};
    const CurveWindow& window = values.choose(std::nullopt);
    if (std::isfinite(value->value.number) && name->inner.empty() &&
        window.firstPacket <= window.lastPacket) {
        content.curve = values.curve(*name, kCurvePoints);
        content.from = window.from;
        content.to = window.to;
        content.ahead = values.time().ahead;
        content.unit = info.unit;
    }
    return content;
}

} // namespace pallax
