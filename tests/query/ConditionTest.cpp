#include "query/Condition.h"

#include "monitor/TickGrid.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/query/QueryFixture.h"

namespace pallax {
namespace {

using Lines = std::vector<std::string>;
using About = QueryCondition::About;

QueryKnowledge noKnowledge() {
    return {[] { return nullptr; },
            [](std::string_view) -> std::optional<QualityProfile> { return std::nullopt; }};
}

/// The values after each packet of a journal, as a command that reads it once has them.
class Reading {
public:
    explicit Reading(TimelineFixture& fixture)
        : fields(fixture.technology, fixture.resources), values(fields, entries),
          _replay(fixture.source()), _reader(fixture.journal.reader(1)) {}

    bool next() {
        const auto packet = _reader->next();
        if (packet) {
            _replay.update(*packet, &values);
            moment = {packet->time, packet->number};
        }
        return packet.has_value();
    }

    FieldTable fields;
    EntryTable entries;
    CurrentValues values;
    StateMoment moment;

private:
    Replay _replay;
    std::unique_ptr<PacketReader> _reader;
};

std::string sentenceOf(std::string_view technology, std::string_view text,
                       About about = About::State) {
    TimelineFixture fixture(technology);
    const FieldTable fields(fixture.technology, fixture.resources);
    const auto condition = QueryCondition::compile(text, fields, about, noKnowledge());
    return condition ? "compiled" : condition.error();
}

class ConditionOfTechnologyTest : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(All, ConditionOfTechnologyTest, testing::ValuesIn(technologyNames()));

TEST_P(ConditionOfTechnologyTest, HoldsAtTheTicksThatAQueryFinds) {
    // The messages of an object stream are whole pictures.
    const int seconds = std::string_view(GetParam()) == "ifx" ? 15 : 60;
    QueryFixture fixture(GetParam(), 5, std::chrono::seconds(seconds));
    auto columns = fixture.database.prepare("select * from state").value().columns();
    const Lines ticks = fixture.ask("select packet, time, tick from state");
    std::size_t found = 0;
    for (std::size_t place = 3; place < columns.size(); place += 7) {
        const std::string name = "\"" + columns[place] + "\"";
        for (const std::string& text : {name + " > 3", name + " is null",
                                        name + " like '%a%' or \"" + columns[place] +
                                            "_age\" between 1 and 8 and tick % 3 = 1"}) {
            Reading reading(fixture);
            const auto condition =
                QueryCondition::compile(text, reading.fields, About::State, noKnowledge());
            ASSERT_TRUE(condition) << condition.error();
            Lines held;
            for (const std::string& line : ticks) {
                StateMoment tick;
                tick.packet = std::stoull(line);
                tick.time =
                    Time(std::chrono::microseconds(std::stoll(line.substr(line.find('|') + 1))));
                tick.tick = std::stoull(line.substr(line.rfind('|') + 1));
                while (reading.moment.packet < tick.packet && reading.next()) {
                }
                const auto holds = (*condition)->holds({tick}, reading.values);
                ASSERT_TRUE(holds) << holds.error();
                if (*holds) {
                    held.push_back(std::to_string(tick.packet));
                }
            }
            EXPECT_EQ(held, fixture.ask("select packet from state where " + text)) << text;
            found += held.size();
        }
    }
    EXPECT_GT(found, 20U);
}

TEST(Condition, ReadsTheRowAndNothingElse) {
    for (const char* text :
         {"measured_rsrp < -100", "lte.serving_cell_measurements.measured_rsrp < -100",
          "\"measured_rsrp\" < -100 and (1 or (0))", "state.measured_rsrp between -9 and 8",
          "measured_rsrp_age > 5 -- old", "packet > 7 /* select ; ( */ and 1e3 > 1.5",
          "'select ;)' = ';' or [measured_rsrp] in (1, 2)", "time_text(time) like '2023%'",
          "band('lte', 1850) = '3'", "tick is null", "'it''s' = ''"}) {
        EXPECT_EQ(sentenceOf("lte", text), "compiled") << text;
    }
    const std::string notOne = "This is not a condition: ";
    const std::map<std::string, std::string> refused = {
        {"1) or (1", notOne + "\")\" closes nothing (line 1, column 2 of the condition)"},
        {"(1", notOne + "\"(\" is not closed (line 1, column 1 of the condition)"},
        {"1; select 2",
         notOne + "\";\" cannot be a part of it (line 1, column 2 of the condition)"},
        {"1 > ?", notOne + "\"?\" cannot be a part of it (line 1, column 5 of the condition)"},
        {"packet in (Select 1)",
         notOne + "it cannot contain a query (line 1, column 12 of the condition)"},
        {"'a", notOne + "a text is not closed (line 1, column 1 of the condition)"},
        {"1\n/* a", notOne + "a comment is not closed (line 2, column 1 of the condition)"},
        {"[a", notOne + "a name is not closed (line 1, column 1 of the condition)"},
        {" -- nothing", "There is no condition."},
        {"packet >", "This is not a whole condition."},
        {"1, 2", "near \",\": syntax error (line 1, column 2 of the condition)"},
        {"1 as integer", "This is not a whole condition."},
        {"values (1)", "near \"values\": syntax error (line 1, column 1 of the condition)"},
        {"measured_rspr < 1", "no such column: measured_rspr. Did you mean \"measured_rsrp\"? "
                              "(line 1, column 1 of the condition)"},
        {"1 and\n lte.serving_cell_measurements.measured_rspr",
         "no such column: lte.serving_cell_measurements.measured_rspr. Did you mean "
         "\"measured_rsrp\"? (line 2, column 2 of the condition)"},
        {"\"measured_rspr\" < 1", "no such column: measured_rspr. Did you mean "
                                  "\"measured_rsrp\"? (line 1, column 1 of the condition)"},
        {"count(*) > 1",
         "misuse of aggregate function count() (line 1, column 1 of the condition)"},
        {"kind = 'gap'", "no such column: kind (line 1, column 1 of the condition)"},
    };
    for (const auto& [text, sentence] : refused) {
        EXPECT_EQ(sentenceOf("lte", text), sentence) << text;
    }
    EXPECT_EQ(sentenceOf("lte", std::string_view("1\0 or 1", 7)),
              notOne + "there is a zero byte in it (line 1, column 2 of the condition)");
}

TEST(Condition, CannotLoadAnything) {
    EXPECT_NE(sentenceOf("lte", "load_extension('x')"), "compiled");
}

TEST(Condition, ComparesTheTruthOfItsValue) {
    TimelineFixture fixture("lte");
    Reading reading(fixture);
    const auto holds = [&](std::string_view text) {
        const auto condition =
            QueryCondition::compile(text, reading.fields, About::State, noKnowledge());
        return condition ? *(*condition)->holds({{{}, 3}}, reading.values) : false;
    };
    EXPECT_TRUE(holds("0.5"));
    EXPECT_TRUE(holds("packet = 3"));
    EXPECT_TRUE(holds("'2 cells'"));
    EXPECT_TRUE(holds("measured_rsrp is null and tick is null"));
    EXPECT_FALSE(holds("measured_rsrp < 0")) << "NULL";
    EXPECT_FALSE(holds("'cells'"));
    EXPECT_FALSE(holds("0 --) or (1"));
}

/// What compiles is one expression: in parentheses it means the same.
TEST(Condition, NoTextGetsOutOfItsParentheses) {
    namespace any = doubles::any;
    static const std::vector<std::string> kPieces = {
        "(",  ")",  "'", "\"",     "[",    "]",  "`",       "--",     "/*",   "*/", ";", "\n",
        " ",  ",",  "1", "packet", "tick", "or", "and",     "not",    "null", "as", "?", "integer",
        "in", "is", "<", "select", "from", "x",  "is null", "packet", "1",    " ",  ".", "end"};
    TimelineFixture fixture("lte");
    Reading reading(fixture);
    std::size_t compiled = 0;
    EXPECT_TRUE(doubles::holds([&] {
        for (int repeated = 0; repeated < 20; ++repeated) {
            std::string text;
            for (int count = any::between(1, 6); count > 0; --count) {
                text += any::elementOf(kPieces) + (any::boolean() ? " " : "");
            }
            const auto truth = [&](const std::string& whole) -> std::optional<bool> {
                const auto condition =
                    QueryCondition::compile(whole, reading.fields, About::State, noKnowledge());
                return condition ? std::optional(*(*condition)->holds({{{}, 3}}, reading.values))
                                 : std::nullopt;
            };
            if (const auto alone = truth(text)) {
                ++compiled;
                const std::string inside = "(" + text + "\n)";
                RC_ASSERT(truth(inside) == alone);
                RC_ASSERT(truth("case when " + inside + " then 1 else 0 end") == alone);
                RC_ASSERT(truth("0 and " + inside) == false);
                RC_ASSERT(truth("1 or " + inside) == true);
            }
        }
    }));
    EXPECT_GT(compiled, 3U); // of 25 cases or more
}

TEST(Condition, OnAnEventHasItsKindAndWords) {
    TimelineFixture fixture("lte");
    Reading reading(fixture);
    const auto condition =
        QueryCondition::compile("kind = 'gap' and words like '%s' and packet = 4 and kind <> words",
                                reading.fields, About::Event, noKnowledge());
    ASSERT_TRUE(condition) << condition.error();
    const Event gap{EventKind::Gap, {}, 4, "no packets for 70 s", {}};
    const Event back{EventKind::TimeStep, {}, 4, "back by 70 s", {}};
    EXPECT_TRUE(*(*condition)->holds({{{}, 4}, &gap}, reading.values));
    EXPECT_FALSE(*(*condition)->holds({{{}, 4}, &back}, reading.values));
}

TEST(Condition, TellsWhyAValueCannotBeComputed) {
    TimelineFixture fixture("lte");
    Reading reading(fixture);
    const auto condition = QueryCondition::compile(
        "quality('lte.serving_cell_measurements.measured_rsrp', packet, 'unknown') is null",
        reading.fields, About::State, noKnowledge());
    ASSERT_TRUE(condition) << condition.error();
    const auto holds = (*condition)->holds({{{}, 4}}, reading.values);
    ASSERT_FALSE(holds);
    EXPECT_EQ(holds.error(), "there is no profile \"unknown\"");
}

TEST(Condition, GivesTheColumnsThatItNamesAsTexts) {
    TimelineFixture fixture("gsm");
    fixture.journal.add(Simulation::kStart, doubles::Record(0x7132).u8(2).u8(0).u8(0).prefixed());
    Reading reading(fixture);
    const auto named = [&reading](std::string_view text) {
        const auto condition =
            QueryCondition::compile(text, reading.fields, About::State, noKnowledge());
        EXPECT_TRUE(condition) << condition.error();
        Lines lines;
        for (const auto& [column, value] : (*condition)->named({reading.moment}, reading.values)) {
            lines.push_back(column + "=" + value);
        }
        return lines;
    };
    EXPECT_EQ(
        named("Process_CO_mm_service_state like 'REG%' and state.packet = packet and tick > 0 and "
              "[process_co_mm_service_state_age] < 9 and gsm.process_co.mm_service_state <> ''"),
        (Lines{"packet=0",
               "process_co_mm_service_state=", "process_co_mm_service_state_age=", "tick="}));
    ASSERT_TRUE(reading.next());
    EXPECT_EQ(named("process_co_mm_service_state is not null or [process_co_mm_service_state_age] "
                    "> 'packet'"),
              (Lines{"process_co_mm_service_state=REG_STATE_REGISTERING",
                     "process_co_mm_service_state_age=0.0"}));
    EXPECT_EQ(named("1"), Lines{});
}

TEST(Condition, FieldsThatAnObjectStreamHasNotShownYetAreNull) {
    TimelineFixture fixture("ifx");
    const auto message = [](std::string_view xml) { return ByteBuffer(xml.begin(), xml.end()); };
    fixture.journal.add(Simulation::kStart, message("<plist><dict><key>RR</key><string>IDLE"
                                                    "</string></dict></plist>"));
    fixture.journal.add(
        Simulation::kStart,
        message("<plist><dict><key>Fan</key><dict><key>Turns</key><string>7 Hz</string>"
                "<key>Age</key><string>old</string></dict></dict></plist>"));
    Reading reading(fixture);
    const auto condition =
        QueryCondition::compile("turns > 5 and ifx.fan.turns = Turns and "
                                "fan_turns_age = 0 and state.turns and foil is null",
                                reading.fields, About::State, noKnowledge());
    ASSERT_TRUE(condition) << condition.error();
    ASSERT_TRUE(reading.next());
    EXPECT_FALSE(*(*condition)->holds({reading.moment}, reading.values));
    EXPECT_EQ((*condition)->unseen(), (Lines{"turns", "fan_turns", "fan_turns_age", "foil"}));
    ASSERT_TRUE(reading.next());
    EXPECT_TRUE(*(*condition)->holds({reading.moment}, reading.values));
    EXPECT_EQ((*condition)->unseen(), Lines{"foil"});
    EXPECT_EQ(sentenceOf("ifx", "turns >"), "This is not a whole condition.");
}

TEST(ConditionWithoutFields, ShowsItsErrorsButNotItsNames) {
    const auto error = [](std::string_view text) {
        return QueryCondition::errorBeforeFields(text, noKnowledge()).value_or("none");
    };
    for (const char* text : {"tick > 1", "kind = 'gap' or measured_rsrp < -110", "[a b] is null",
                             "lte.section.field > 1", "quality('rsrp', a) = 'good'", "1"}) {
        EXPECT_EQ(error(text), "none") << text;
    }
    EXPECT_EQ(error("x >"), "This is not a whole condition.");
    EXPECT_EQ(error("x > > 1"), "near \">\": syntax error (line 1, column 5 of the condition)");
    EXPECT_EQ(error("(x"), "This is not a condition: \"(\" is not closed (line 1, column 1 of the "
                           "condition)");
    EXPECT_EQ(error("nosuch(1)"), "no such function: nosuch (line 1, column 1 of the condition)");
    EXPECT_EQ(error(""), "There is no condition.");
}

} // namespace
} // namespace pallax
