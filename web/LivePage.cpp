#include "web/LivePage.h"

#include "decoding/DisplayJson.h"
#include "report/Page.h"
#include "web/JsonPatch.h"
#include "web/RequestGate.h"
#include "web/SeriesJson.h"

#include <algorithm>
#include <charconv>
#include <chrono>
#include <cmath>
#include <cstdint>
#include <optional>
#include <utility>
#include <vector>

namespace pallax {

namespace {

constexpr std::size_t kMostSeries = 1024;
/// Times of the page are whole milliseconds, which the real ones are rounded down to.
constexpr std::chrono::nanoseconds kWithin =
    std::chrono::milliseconds(1) - std::chrono::nanoseconds(1);
constexpr std::size_t kMostPoints = 50000; // a day has 43,200 ticks

WebResponse json(std::string content) {
    return {.type = "application/json",
            .content = std::make_shared<const std::string>(std::move(content))};
}

WebResponse badArgument(std::string_view name) {
    return textResponse(400, "The argument \"" + std::string(name) + "\" is missing or wrong.");
}

template <class Number>
std::optional<Number> numberIn(std::string_view text) {
    Number number{};
    const auto result = std::from_chars(text.data(), text.data() + text.size(), number);
    const bool isWhole = result.ec == std::errc() && result.ptr == text.data() + text.size();
    return isWhole ? std::optional(number) : std::nullopt;
}

template <class Number>
std::optional<Number> numberOf(const WebRequest& request, std::string_view name) {
    const std::string* text = request.argument(name);
    return text != nullptr ? numberIn<Number>(*text) : std::nullopt;
}

/// Seconds since 1970, as the page has them.
std::optional<Time> timeOf(const WebRequest& request, std::string_view name) {
    constexpr double kMost = 9e9; // of a time in nanoseconds
    constexpr double kMilliseconds = 1000;
    const auto seconds = numberOf<double>(request, name);
    if (!seconds || !(std::abs(*seconds) <= kMost)) {
        return std::nullopt;
    }
    return Time(std::chrono::milliseconds(std::llround(*seconds * kMilliseconds)));
}

/// "1,2"; nothing for anything else.
std::optional<std::vector<std::uint32_t>> idsOf(const WebRequest& request) {
    const std::string* text = request.argument("ids");
    std::vector<std::uint32_t> ids;
    for (std::string_view rest = text != nullptr ? *text : std::string_view(); !rest.empty();) {
        const std::string_view word = rest.substr(0, rest.find(','));
        rest.remove_prefix(std::min(word.size() + 1, rest.size()));
        const auto id = numberIn<std::uint32_t>(word);
        if (!id || ids.size() == kMostSeries) {
            return std::nullopt;
        }
        ids.push_back(*id);
    }
    return text != nullptr ? std::optional(ids) : std::nullopt;
}

std::string jsonOf(const PropertyList& value) {
    std::string text;
    appendJson(text, value);
    return text;
}

std::string eventOf(std::string_view name, std::string_view data) {
    return "event: " + std::string(name) + "\ndata: " + std::string(data) + "\n\n";
}

} // namespace

LivePage::LivePage(Setup setup)
    : _setup(std::move(setup)),
      _page(std::make_shared<const std::string>(pageHtml("", PageUse::Live))) {}

WebResponse LivePage::answer(const WebRequest& request) {
    if (request.path == "/") {
        return page();
    }
    if (request.path == "/api/figures") {
        return json(jsonOf(_setup.data.figures()));
    }
    if (request.path == "/api/series") {
        return series(request);
    }
    if (request.path == "/api/state") {
        return state(request);
    }
    if (request.path == "/api/events") {
        return stream();
    }
    if (request.path == RequestGate::kMetricsPath) {
        return metrics(request);
    }
    return textResponse(404, "There is no such page.");
}

WebResponse LivePage::page() const {
    return {.type = "text/html; charset=utf-8",
            .content = _page,
            .headers = {{"Content-Security-Policy",
                         pagePolicy(PageUse::Live) + "; frame-ancestors 'none'"}}};
}

/// What the other streams have: patches go to all of them.
const PropertyList& LivePage::toldFigures() {
    if (_setup.counts().viewers == 0) {
        _told = _setup.data.figures();
    }
    return _told;
}

/// Begins with all figures, which patches change from then on.
WebResponse LivePage::stream() {
    return {.type = "text/event-stream",
            .content = std::make_shared<const std::string>(
                eventOf("figures", jsonOf(toldFigures())) + wordsEvent()),
            .isStream = true};
}

/// The latest one if the request names none.
std::optional<std::size_t> LivePage::stretchOf(const WebRequest& request) const {
    return request.argument("stretch") != nullptr ? numberOf<std::size_t>(request, "stretch")
                                                  : _setup.data.latestStretch();
}

WebResponse LivePage::series(const WebRequest& request) const {
    const auto ids = idsOf(request);
    const auto from = timeOf(request, "from");
    const auto to = timeOf(request, "to");
    const auto points = numberOf<std::size_t>(request, "points");
    if (!ids) {
        return badArgument("ids");
    }
    if (!from || !to) {
        return badArgument(from ? "to" : "from");
    }
    if (!points || *points > kMostPoints) {
        return badArgument("points");
    }
    const auto stretch = stretchOf(request);
    if (!stretch) {
        return badArgument("stretch");
    }
    return json(_setup.data.series(*ids, {*from, *to + kWithin, *points}, *stretch));
}

WebResponse LivePage::state(const WebRequest& request) const {
    const auto at = timeOf(request, "at");
    if (!at) {
        return badArgument("at");
    }
    const auto stretch = stretchOf(request);
    if (!stretch) {
        return badArgument("stretch");
    }
    auto state = _setup.data.state(*at + kWithin, *stretch);
    return state ? json(std::move(*state)) : textResponse(404, "Nothing has come yet.");
}

WebResponse LivePage::metrics(const WebRequest& request) const {
    const std::string* accept = request.header("Accept");
    const MetricsForm form = metricsFormFor(accept != nullptr ? *accept : "");
    return {.type = metricsType(form),
            .content = std::make_shared<const std::string>(
                metricsText(_setup.data.status(), _setup.counts(), form))};
}

void LivePage::setWords(const std::string& words) {
    _hasNewWords = _hasNewWords || words != _words;
    _words = words;
}

std::string LivePage::wordsEvent() const {
    std::string data;
    appendJson(data, Dictionary{{"text", _words}});
    return eventOf("words", data);
}

std::shared_ptr<const std::string> LivePage::news() {
    std::string events;
    const PropertyList& figures = _setup.data.figures();
    if (const std::string patch = jsonPatch(_told, figures); !patch.empty()) {
        events += eventOf("patch", patch);
        _told = figures;
    }
    if (std::exchange(_hasNewWords, false)) {
        events += wordsEvent();
    }
    return events.empty() ? nullptr : std::make_shared<const std::string>(std::move(events));
}

} // namespace pallax
