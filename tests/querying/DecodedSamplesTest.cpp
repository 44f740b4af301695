#include "tests/query/QueryFixture.h"
#include "tests/querying/DecodedJournal.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <algorithm>

namespace pallax {
namespace {

/// Whether its values are parts of property lists, of which the table has no numbers.
bool isObject(const std::string& field) {
    return field.find(".sim_info.") != std::string::npos || field.ends_with(".pdp_context_info");
}

/// What `decode --samples` writes, as rows of the table `sample`.
std::vector<std::string> decoded(TimelineFixture& fixture) {
    DecodeOptions options;
    options.view = DecodeView::Samples;
    const std::string written = decodedText(fixture, options);
    std::vector<std::string> rows;
    const auto text = [](const nlohmann::json& value) {
        return value.is_null()     ? "NULL"
               : value.is_string() ? value.get<std::string>()
                                   : value.dump();
    };
    for (std::size_t begin = 0; begin < written.size();) {
        const std::size_t end = written.find('\n', begin);
        const auto line = nlohmann::json::parse(written.substr(begin, end - begin));
        const auto& value = line["value"];
        const std::string field = line["field"].get<std::string>();
        rows.push_back(text(line["packet"]) + "|" + field + "|" + text(line["entry"]) + "|" +
                       text(line["raw"]) + "|" +
                       (isObject(field)     ? ""
                        : value.is_number() ? formatText("%.6f", {value.get<double>()})
                                            : text(value)));
        begin = end + 1;
    }
    return rows;
}

TEST(DecodedSamples, AreTheRowsOfTheTableOfSamples) {
    for (const char* technology : technologyNames()) {
        for (const std::uint64_t seed : {1U, 2U}) {
            QueryFixture fixture(technology, seed, std::chrono::seconds(4));
            const auto rows = fixture.ask(
                "select packet, field, entry, raw, "
                "case when field glob '*.sim_info.*' or field glob '*.pdp_context_info' then '' "
                "else coalesce(cast(number as real), text) end from sample");
            const auto lines = decoded(fixture);
            EXPECT_EQ(lines.size(), rows.size()) << technology;
            const auto [line, row] =
                std::mismatch(lines.begin(), lines.end(), rows.begin(), rows.end());
            EXPECT_EQ(line != lines.end() ? *line : "", row != rows.end() ? *row : "");
        }
    }
}

} // namespace
} // namespace pallax
