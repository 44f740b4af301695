#include "report/Figures.h"

#include "decoding/DisplayJson.h"
#include "tests/overview/ValuesFixture.h"

namespace pallax {
namespace {

std::string json(const Dictionary& object, std::string_view key) {
    std::string text;
    appendJson(text, *object.find(key));
    return text;
}

TEST(Figures, HaveTheirTimesInSecondsOfWholeMilliseconds) {
    EXPECT_EQ(pageSeconds(Time(std::chrono::nanoseconds(1'700'000'000'123'999'999))),
              1700000000.123);
    EXPECT_EQ(pageSeconds(Time(std::chrono::nanoseconds(0))), 0);
}

TEST(Figures, TellWhatTheReportHas) {
    const NetworkNames names;
    const auto profile = parseProfile("source = a test\nrsrp = good -90, poor -110\n", "own", "f");
    ASSERT_TRUE(profile);
    ReportBuilder report(names, *profile);
    ValuesFixture values("lte");
    for (int second = 0; second < 60; second += 2) {
        const Dictionary display{
            {"Serving Cell Info", Dictionary{{"Physical Cell ID", second < 40 ? "182" : "183"}}},
            {"Serving Cell Measurements",
             Dictionary{{"Measured RSRP", second < 40 ? "-80.00 dBm" : "-120.00 dBm"}}},
            {"Neighbor Cells List",
             Array{Dictionary{{"Physical Cell ID", "9"}, {"Measured RSRP", "-83.00 dBm"}}}}};
        values.values.clear();
        values.read(second, display);
        report.take({ValuesFixture::at(second), values.values, display});
    }
    report.finish();
    const std::vector<Event> events{
        {EventKind::PingPong, ValuesFixture::at(39), 7, "serving cell 182 → 183", {"lte.x"}},
        {EventKind::Gap, ValuesFixture::at(50), 9, "a gap", {}}};
    const Dictionary figures = figuresOf({.title = "<b>",
                                          .label = "phone A",
                                          .recording = "drive.pcap",
                                          .technology = "LTE",
                                          .version = "1.2.3",
                                          .packets = 30,
                                          .notes = {"It was cut."}},
                                         report, events, values.fields);
    const std::string head = json(figures, "head");
    EXPECT_TRUE(head.starts_with(
        R"({"title":"<b>","label":"phone A","recording":"drive.pcap","technology":"LTE","operator":"",)"
        R"("from":1700000000,"to":1700000058,"packets":30,"ticks":30,"interval":2,"gaps":1,)"
        R"("timeSteps":0,"cellChanges":1,"pingPongs":1,"version":"1.2.3",)"
        R"("identities":"left out","where":"","notes":["It was cut."],"profile":)"
        R"({"name":"own","source":"a test","borders":{"rsrp":[{"grade":"good","value":-90},)"
        R"({"grade":"poor","value":-110}]},"graded":[)"))
        << head;
    EXPECT_TRUE(head.ends_with(R"("stretches":[{"from":1700000000,"to":1700000058,"ticks":30}]})"))
        << head;
    EXPECT_EQ(
        json(figures, "measures"),
        R"([{"id":1,"name":"RSRP","system":"LTE","unit":"dBm","measure":"rsrp",)"
        R"("meaning":"LTE reference signal received power","worst":-140,"best":-44,)"
        R"("borders":[{"grade":"good","value":-90},{"grade":"poor","value":-110}],"seconds":60,)"
        R"("shares":[{"grade":"good","share":0.6666666666666666},{"grade":"poor","share":0},)"
        R"({"grade":"none","share":0.3333333333333333}],)"
        R"("quantiles":{"p5":-120,"p50":-80,"p95":-80,"least":-120,"most":-80},)"
        R"("worstStretch":{"from":1700000000,"to":1700000060,"mean":-93.333,"stretch":0}}])");
    EXPECT_EQ(json(figures, "cells"),
              R"([{"system":"LTE","cell":"PCI 182","details":[],"from":1700000000,)"
              R"("to":1700000040,"stretch":0,"pingPong":false},{"system":"LTE","cell":"PCI 183",)"
              R"("details":[],"from":1700000039,"to":1700000060,"stretch":0,"pingPong":true}])")
        << "a change is as exact as its event";
    EXPECT_EQ(json(figures, "neighbours"),
              R"([{"id":2,"system":"LTE","cell":"PCI 9","unit":"dBm","measure":"rsrp",)"
              R"("seconds":60,"best":-83,"median":-83,"near":60,"stronger":20,"detected":0,)"
              R"("served":false,"unlisted":0},{"id":4,"system":"LTE","cell":"PCI 183","unit":"",)"
              R"("measure":"","seconds":0,"best":null,"median":null,"near":0,"stronger":0,)"
              R"("detected":0,"served":true,"unlisted":1}])");
    EXPECT_EQ(
        json(figures, "events"),
        R"([{"time":1700000039,"packet":7,"kind":"ping-pong",)"
        R"("words":"serving cell 182 → 183","stretch":0},{"time":1700000050,"packet":9,"kind":"gap",)"
        R"("words":"a gap","stretch":0}])");
    EXPECT_EQ(json(figures, "states"), "[]");
    EXPECT_EQ(json(figures, "contexts"), "[]");
}

TEST(Figures, TellOfWhichStretchOfTimeSomethingIs) {
    const NetworkNames names;
    const QualityProfile profile = *builtInProfile(kDefaultProfile);
    ReportBuilder report(names, profile);
    ValuesFixture values("lte");
    const Dictionary display{
        {"Serving Cell Info", Dictionary{{"Physical Cell ID", "182"}}},
        {"Serving Cell Measurements", Dictionary{{"Measured RSRP", "-80.00 dBm"}}}};
    values.read(0, display);
    report.take({ValuesFixture::at(0), values.values, display, false, 1});
    report.take({ValuesFixture::at(2), values.values, display, false, 1});
    report.take({ValuesFixture::at(0), values.values, display, true, 9});
    report.finish();
    const std::vector<Event> events{
        {EventKind::CellChange, ValuesFixture::at(-1), 8, "of the first stretch", {}},
        {EventKind::TimeStep, ValuesFixture::at(-1), 9, "of the second stretch", {}}};
    const Dictionary figures = figuresOf({.recording = "", .technology = "", .version = ""}, report,
                                         events, values.fields);
    EXPECT_EQ(json(figures, "cells"),
              R"([{"system":"LTE","cell":"PCI 182","details":[],"from":1699999999,)"
              R"("to":1700000004,"stretch":0,"pingPong":false},{"system":"LTE","cell":"PCI 182",)"
              R"("details":[],"from":1700000000,"to":1700000002,"stretch":1,"pingPong":false}])")
        << "the change is not that of the second stay, whose time is the same";
    EXPECT_EQ(json(figures, "events"),
              R"([{"time":1699999999,"packet":8,"kind":"cell-change",)"
              R"("words":"of the first stretch","stretch":0},{"time":1699999999,"packet":9,)"
              R"("kind":"time-step","words":"of the second stretch","stretch":1}])");
}

TEST(Figures, NameAContextIfThatIdentifiesNobody) {
    const NetworkNames names;
    const QualityProfile profile = *builtInProfile(kDefaultProfile);
    const std::vector<Event> events{
        {EventKind::ContextUp, ValuesFixture::at(0), 1, "context up: internet", {}},
        {EventKind::ContextDown, ValuesFixture::at(0), 1, "context down: a: b", {}}};
    const auto words = [&](const char* technology, bool hasIdentities) {
        ReportBuilder report(names, profile);
        const ValuesFixture values(technology);
        report.take({ValuesFixture::at(0), values.values, PropertyList()});
        report.finish();
        const ReportHead head{
            .recording = "", .technology = "", .version = "", .hasIdentities = hasIdentities};
        return json(figuresOf(head, report, events, values.fields), "events");
    };
    EXPECT_EQ(words("lte", false),
              R"([{"time":1700000000,"packet":1,"kind":"context-up","words":"context up",)"
              R"("stretch":0},{"time":1700000000,"packet":1,"kind":"context-down",)"
              R"("words":"context down","stretch":0}])");
    EXPECT_NE(words("lte", true).find("context down: a: b"), std::string::npos);
    EXPECT_NE(words("ifx", false).find("context down: a: b"), std::string::npos)
        << "the mask keeps the access points of its connections";
}

} // namespace
} // namespace pallax
