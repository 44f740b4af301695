#include "plist/PropertyListCodec.h"
#include "tests/cli/EndToEnd.h"
#include "tests/doubles/TextPropertyList.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

/// The IFX technology, whose messages are objects without log codes.
class EndToEndObjectStream : public EndToEnd {
protected:
    static constexpr int kIfxLinkType = 147;

    static ByteBuffer bytesOf(const std::string& text) { return {text.begin(), text.end()}; }

    /// The picture of a cell in the text form, followed by a list with a header.
    static ByteBuffer picture(const std::string& arfcn, const std::string& state) {
        return bytesOf(doubles::textForm(
            Dictionary{{"Serving Cell",
                        Dictionary{{"ARFCN", arfcn}, {"RR State", Dictionary{{"Now", state}}}}},
                       {"Neighbours", Array{"header", Dictionary{{"ARFCN", "62"}}, "71"}}}));
    }

    static ByteBuffer withANumber() {
        return *serializeBinary(Dictionary{{"Serving Cell", PropertyList::integer(12)}});
    }

    /// A picture, a message with a number, one that is not a property list, and another picture.
    std::string badStream() const {
        return record("bad.pcap",
                      {{milliseconds(0), picture("12", "Idle")},
                       {seconds(3), withANumber()},
                       {milliseconds(3500), bytesOf("{ Serving")},
                       {seconds(5), picture("13", "Dedicated")}},
                      kIfxLinkType);
    }

    static constexpr const char* kUnknownType =
        "packet 2 (no log code): Unknown object of type integer encountered "
        "(LogGenerator/GSM/GSMLogGenerator, line 78)\n";
    static constexpr const char* kNotDeserialized =
        "packet 3 (no log code): Could not deserialize the object "
        "(LogGenerator/GSM/GSMLogGenerator, line 90)\n";
};

TEST_F(EndToEndObjectStream, EachMessageIsStreamedAndShownThoughNoLogCodeIsAskedFor) {
    const std::string recording =
        record("a.pcap",
               {{milliseconds(0), picture("12", "Idle")}, {seconds(3), picture("12", "Dedicated")}},
               kIfxLinkType);
    const Run played = run({recording, "--print", "--speed", "max"});
    EXPECT_EQ(played.status, 0);
    EXPECT_EQ(played.err, "");
    EXPECT_EQ(played.out, "== 2023-11-14 22:13:22 +0000\n"
                          "Serving Cell\n"
                          "  ARFCN: 12\n"
                          "  RR State: Idle\n"
                          "Neighbours\n"
                          "  0: 62\n"
                          "  1: 71\n"
                          "== 2023-11-14 22:13:24 +0000\n"
                          "Serving Cell\n"
                          "  ARFCN: 12\n"
                          "* RR State: Dedicated\n"
                          "Neighbours\n"
                          "  0: 62\n"
                          "  1: 71\n");
}

TEST_F(EndToEndObjectStream, ABadMessageEndsTheViewerWithStatus70AndOneSentence) {
    const Run stopped = run({badStream(), "--print", "--speed", "max"});
    EXPECT_EQ(stopped.status, 70);
    EXPECT_EQ(stopped.err, std::string("pallax: ") + kUnknownType);
    EXPECT_NE(stopped.out.find("  RR State: Idle\n"), std::string::npos) << stopped.out;
    EXPECT_EQ(stopped.out.find("Dedicated"), std::string::npos) << stopped.out;
}

TEST_F(EndToEndObjectStream, WithKeepGoingABadMessageIsDroppedAndLogged) {
    const Run kept =
        run({badStream(), "--print", "--speed", "max", "--keep-going", "--log-level", "3"});
    EXPECT_EQ(kept.status, 0);
    EXPECT_NE(kept.err.find(std::string("<3>") + kUnknownType), std::string::npos) << kept.err;
    EXPECT_NE(kept.err.find(std::string("<3>") + kNotDeserialized), std::string::npos) << kept.err;
    EXPECT_NE(kept.out.find("* RR State: Dedicated\n"), std::string::npos) << kept.out;
}

TEST_F(EndToEndObjectStream, DecodeReportsThePacketAndSkipsIt) {
    const std::string recording = badStream();
    const Run skipped = run({"decode", recording});
    EXPECT_EQ(skipped.status, 0);
    EXPECT_EQ(skipped.err, "pallax: " + recording + ": " + kUnknownType + "pallax: " + recording +
                               ": " + kNotDeserialized);
    EXPECT_EQ(skipped.out, "{\"Serving Cell\":{\"ARFCN\":\"13\",\"RR State\":\"Dedicated\"},"
                           "\"Neighbours\":[\"62\",\"71\"]}\n");
}

TEST_F(EndToEndObjectStream, DecodeStopsThereWithStrict) {
    const std::string recording = badStream();
    const Run strict = run({"decode", "--strict", "--every", "packet", recording});
    EXPECT_EQ(strict.status, 70);
    EXPECT_EQ(strict.err, "pallax: " + recording + ": " + kUnknownType);
    EXPECT_EQ(strict.out, "{\"packet\":1,\"time\":\"2023-11-14T22:13:20.000Z\",\"display\":"
                          "{\"Serving Cell\":{\"ARFCN\":\"12\",\"RR State\":\"Idle\"},"
                          "\"Neighbours\":[\"62\",\"71\"]}}\n");
}

TEST_F(EndToEndObjectStream, AnEmptyMessageIsUndecodableToo) {
    const std::string recording = record(
        "empty.pcap", {{milliseconds(0), picture("12", "Idle")}, {seconds(1), {}}}, kIfxLinkType);
    const std::string sentence = "packet 2 (no log code): Could not deserialize the object "
                                 "(LogGenerator/GSM/GSMLogGenerator, line 90)\n";
    EXPECT_EQ(run({"decode", recording}).err, "pallax: " + recording + ": " + sentence);
    const Run stopped = run({recording, "--print", "--speed", "max"});
    EXPECT_EQ(stopped.status, 70);
    EXPECT_EQ(stopped.err, "pallax: " + sentence);
}

} // namespace
} // namespace pallax
