#include "sources/modem/BusMessage.h"

#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <sys/socket.h>
#include <unistd.h>

namespace pallax {
namespace {

using namespace doubles;

/// A message that is written and then read. It needs a bus, whose other end says nothing.
class Message {
public:
    Message() {
        sd_bus* bus = nullptr;
        EXPECT_EQ(::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, _ends.data()), 0);
        EXPECT_GE(sd_bus_new(&bus), 0);
        _bus.reset(bus);
        EXPECT_GE(sd_bus_set_fd(bus, _ends[0], _ends[0]), 0);
        EXPECT_GE(sd_bus_start(bus), 0);
        sd_bus_message* message = nullptr;
        EXPECT_GE(sd_bus_message_new_signal(bus, &message, "/a", "a.b", "C"), 0);
        _message.reset(message);
    }
    ~Message() { (void)::close(_ends[1]); }
    Message(const Message&) = delete;
    Message& operator=(const Message&) = delete;

    sd_bus_message* get() const { return _message.get(); }
    template <class... Values>
    Message& append(const char* types, Values... values) {
        EXPECT_GE(sd_bus_message_append(get(), types, values...), 0) << types;
        return *this;
    }
    void open(char type, const char* contents) {
        EXPECT_GE(sd_bus_message_open_container(get(), type, contents), 0) << contents;
    }
    void close() { EXPECT_GE(sd_bus_message_close_container(get()), 0); }
    Array read() {
        EXPECT_GE(sd_bus_message_seal(get(), 1, 0), 0);
        EXPECT_GE(sd_bus_message_rewind(get(), 1), 0);
        return argumentsOf(get());
    }

private:
    std::array<int, 2> _ends{};
    BusHandle _bus;
    BusMessage _message;
};

Dictionary dictionaryOf(const char* key, PropertyList value) {
    Dictionary dictionary;
    dictionary.set(key, std::move(value));
    return dictionary;
}

TEST(BusMessageTest, EachTypeIsAPropertyListOfItsKind) {
    Message message;
    message.append("ynqiuxtdbsog", 7, -7, 8, -9, 10U, std::int64_t{-11}, std::uint64_t{12}, 1.5, 1,
                   "text", "/path", "a{sv}");
    EXPECT_EQ(message.read(),
              (Array{PropertyList::integer(7), PropertyList::integer(-7), PropertyList::integer(8),
                     PropertyList::integer(-9), PropertyList::integer(10),
                     PropertyList::integer(-11), PropertyList::integer(12), PropertyList::real(1.5),
                     PropertyList::boolean(true), "text", "/path", "a{sv}"}));
}

TEST(BusMessageTest, ContainersAreArraysAndDictionariesAndVariantsTheirValue) {
    Message message;
    message.append("a{sv}(ub)a{uv}aas", 1, "State", "i", 8, 61U, 1, 1, 4U, "s", "place", 2, 1, "a",
                   0);
    EXPECT_EQ(message.read(), (Array{dictionaryOf("State", PropertyList::integer(8)),
                                     Array{PropertyList::integer(61), PropertyList::boolean(true)},
                                     dictionaryOf("4", "place"), Array{Array{"a"}, Array{}}}));
}

TEST(BusMessageTest, ALongTextIsCut) {
    Message message;
    const std::string text(kLongestBusText + 1, 'x');
    message.append("s", text.c_str());
    EXPECT_EQ(message.read(), Array{text.substr(1)});
}

TEST(BusMessageTest, AfterTheMostValuesNothingIsRead) {
    Message message;
    const std::string all(kMostBusValues + 10, 'y');
    EXPECT_GE(sd_bus_message_append_array(message.get(), 'y', all.data(), all.size()), 0);
    message.append("s", "after");
    const Array read = message.read();
    ASSERT_EQ(read.size(), 1U);
    EXPECT_EQ(read[0].array()->size(), kMostBusValues - 1) << "the array itself is one";
}

TEST(BusMessageTest, ADescriptorIsNull) {
    Message message;
    message.append("hs", STDIN_FILENO, "after");
    EXPECT_EQ(message.read(), (Array{PropertyList(), "after"}));
}

TEST(BusMessageTest, AnErrorIsItsNameAndMessageAndAnAnswerItsFirstValue) {
    Message message;
    message.append("su", "first", 2U);
    EXPECT_EQ(message.read().size(), 2U);
    EXPECT_GE(sd_bus_message_rewind(message.get(), 1), 0);
    const BusReply reply = replyOf(message.get());
    ASSERT_TRUE(reply);
    EXPECT_EQ(*reply, PropertyList("first"));
    Message empty;
    EXPECT_EQ(empty.read(), Array{});
    EXPECT_EQ(replyOf(empty.get()).value(), PropertyList());
}

/// Appends a value of any type in a variant, and gives what it is read as.
PropertyList anyVariant(Message& message, int depth) {
    const int kind = any::between(0, depth > 0 ? 6 : 4);
    if (kind == 0) {
        const auto number = static_cast<std::int64_t>(any::bits());
        message.append("v", "x", number);
        return PropertyList::integer(number);
    }
    if (kind == 1) {
        const double number = any::real();
        message.append("v", "d", number);
        return PropertyList::real(number);
    }
    if (kind == 2) {
        const std::string text = any::textOf("abc \x1b\n");
        message.append("v", "s", text.c_str());
        return text;
    }
    if (kind == 3) {
        const bool truth = any::boolean();
        message.append("v", "b", static_cast<int>(truth));
        return PropertyList::boolean(truth);
    }
    const bool isArray = kind == 4;
    message.open('v', isArray ? "av" : "a{sv}");
    message.open('a', isArray ? "v" : "{sv}");
    Array elements;
    Dictionary entries;
    for (int count = any::between(0, 4); count > 0; --count) {
        if (isArray) {
            elements.push_back(anyVariant(message, depth - 1));
        } else {
            message.open('e', "sv");
            const std::string key = "key" + std::to_string(count);
            message.append("s", key.c_str());
            entries.set(Text(key), anyVariant(message, depth - 1));
            message.close();
        }
    }
    message.close();
    message.close();
    return isArray ? PropertyList(std::move(elements)) : PropertyList(std::move(entries));
}

TEST(BusMessageTest, AnyTreeOfVariantsIsReadAsItWasWritten) {
    EXPECT_TRUE(holds([] {
        Message message;
        constexpr int kDeepest = 4;
        const PropertyList written = anyVariant(message, kDeepest);
        RC_ASSERT(message.read() == Array{written});
    }));
}

TEST(BusMessageTest, VariantsDeeperThanTheBusAllowsAreNull) {
    Message message;
    constexpr int kDepth = 300;
    for (int depth = 1; depth < kDepth; ++depth) {
        message.open('v', "v");
    }
    message.append("v", "s", "bottom");
    for (int depth = 1; depth < kDepth; ++depth) {
        message.close();
    }
    message.append("s", "after");
    EXPECT_EQ(message.read(), Array{PropertyList()}) << "nothing follows, either";
}

} // namespace
} // namespace pallax
