#include "report/PageData.h"

#include "decoding/DisplayJson.h"
#include "text/Base64.h"
#include "text/Bytes.h"

#include <zlib.h>

#include <bit>
#include <chrono>
#include <cmath>
#include <stdexcept>

namespace pallax {

namespace {

/// The words of the page's numbers.
class Words {
public:
    void add(std::uint32_t word) {
        constexpr unsigned kByte = 8;
        for (unsigned shift = 0; shift < 4 * kByte; shift += kByte) {
            _bytes.push_back(static_cast<std::uint8_t>(word >> shift));
        }
    }
    void add(float value) { add(std::bit_cast<std::uint32_t>(value)); }
    template <class Changes, class Value>
    void addChanges(const Changes& changes, const Value& valueOf) {
        add(static_cast<std::uint32_t>(changes.size()));
        std::uint32_t before = 0;
        for (const auto& change : changes) {
            add(change.tick - before);
            before = change.tick;
        }
        for (const auto& change : changes) {
            add(valueOf(change));
        }
    }
    Bytes bytes() const { return _bytes; }

private:
    ByteBuffer _bytes;
};

ByteBuffer deflated(Bytes bytes) {
    constexpr int kRaw = -15; // without a header, the largest window
    constexpr int kMemory = 9;
    z_stream stream{};
    if (deflateInit2(&stream, Z_DEFAULT_COMPRESSION, Z_DEFLATED, kRaw, kMemory,
                     Z_DEFAULT_STRATEGY) != Z_OK) {
        throw std::bad_alloc();
    }
    ByteBuffer packed(deflateBound(&stream, static_cast<uLong>(bytes.size())));
    ByteBuffer rest(bytes.begin(), bytes.end()); // zlib wants what it may write to
    stream.next_in = rest.data();
    stream.avail_in = static_cast<uInt>(rest.size());
    stream.next_out = packed.data();
    stream.avail_out = static_cast<uInt>(packed.size());
    const int result = deflate(&stream, Z_FINISH);
    packed.resize(stream.total_out);
    (void)deflateEnd(&stream);
    if (result != Z_STREAM_END) {
        throw std::length_error("the page's data cannot be deflated");
    }
    return packed;
}

std::string element(const std::string& id, Bytes content) {
    return "<script type=\"text/plain\" id=\"" + id + "\">" + base64Text(deflated(content)) +
           "</script>\n";
}

/// Between two ticks, in whole milliseconds; the clock can be set back by years.
std::uint32_t millisecondsBetween(Time before, Time time) {
    const auto floor = [](Time each) {
        return std::chrono::floor<std::chrono::milliseconds>(each).time_since_epoch().count();
    };
    return static_cast<std::uint32_t>(floor(time) - floor(before));
}

template <class Each>
std::vector<const Each*> seriesOf(const std::deque<Each>& all) {
    std::vector<const Each*> series;
    for (const Each& each : all) {
        if (!each.series.changes().empty()) {
            series.push_back(&each);
        }
    }
    return series;
}

} // namespace

std::string pageData(const Dictionary& figures, const ReportBuilder& report, std::size_t place) {
    Words words;
    words.add(static_cast<std::uint32_t>(report.ticks().size()));
    for (std::size_t tick = 0; tick < report.ticks().size(); ++tick) {
        words.add(millisecondsBetween(report.ticks()[tick > 0 ? tick - 1 : 0],
                                      report.ticks()[tick]));
    }
    Array ids;
    const auto addAll = [&](const auto& all) {
        for (const auto* each : seriesOf(all)) {
            ids.push_back(PropertyList::unsignedInteger(each->id));
            words.addChanges(each->series.changes(),
                             [](const HeldSeries::Change& change) { return change.value; });
        }
    };
    addAll(report.measures());
    addAll(report.neighbours());
    Array paths;
    for (const DisplayColumns::Column* column : report.display().columns()) {
        paths.emplace_back(Array(column->path.begin(), column->path.end()));
        words.addChanges(column->changes,
                         [](const DisplayColumns::Change& change) { return change.text; });
    }
    Array texts;
    for (const std::string_view text : report.display().texts()) {
        texts.emplace_back(std::string(text));
    }
    std::string json;
    appendJson(json, Dictionary{{"figures", figures},
                                {"series", std::move(ids)},
                                {"paths", std::move(paths)},
                                {"texts", std::move(texts)}});
    const std::string end = "-" + std::to_string(place);
    return pageElement("figures" + end, json) + element("numbers" + end, words.bytes());
}

std::string pageElement(const std::string& id, std::string_view content) {
    return element(id, {reinterpret_cast<const std::uint8_t*>(content.data()), content.size()});
}

} // namespace pallax
