// The data that a dictionary keeps for speed must never be visible.

#include "plist/PropertyList.h"
#include "tests/doubles/InOrder.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {
namespace {

using doubles::sameInOrder;

/// A dictionary in its simplest form.
class Model {
public:
    void set(const std::string& key, const std::string& value) {
        for (auto& entry : _entries) {
            if (entry.first == key) {
                entry.second = value;
                return;
            }
        }
        _entries.emplace_back(key, value);
    }
    bool remove(const std::string& key) {
        return std::erase_if(_entries, [&](const auto& entry) { return entry.first == key; }) != 0;
    }
    void truncate(std::size_t count) {
        if (count < _entries.size()) {
            _entries.resize(count);
        }
    }
    bool isLike(const Dictionary& dictionary) const {
        if (dictionary.size() != _entries.size()) {
            return false;
        }
        auto at = dictionary.begin();
        for (const auto& [key, value] : _entries) {
            const PropertyList* found = dictionary.find(key);
            if (at->key.view() != key || !(at->value == PropertyList(value)) ||
                found != &at->value) {
                return false;
            }
            ++at;
        }
        return true;
    }

private:
    std::vector<std::pair<std::string, std::string>> _entries;
};

TEST(DictionaryProperty, AfterAnyOperationsItEqualsAPlainList) {
    EXPECT_TRUE(doubles::holds([] {
        Dictionary dictionary;
        Model model;
        const auto steps = doubles::any::between(0, 120);
        for (int step = 0; step < steps; ++step) {
            const std::string key = std::to_string(doubles::any::between(0, 40));
            const std::string value = std::to_string(step);
            switch (doubles::any::between(0, 12)) {
            case 0:
                RC_ASSERT(dictionary.remove(key) == model.remove(key));
                break;
            case 1: {
                const auto count = doubles::any::index(50);
                dictionary.truncate(count);
                model.truncate(count);
                break;
            }
            case 2:
                dictionary = Dictionary(dictionary);
                break;
            case 3: {
                Dictionary taken = std::move(dictionary);
                dictionary = std::move(taken);
                break;
            }
            default:
                dictionary.set(key, value);
                model.set(key, value);
                break;
            }
            RC_ASSERT(model.isLike(dictionary));
        }
    }));
}

TEST(Dictionary, WhatWasMovedFromIsEmptyAndUsable) {
    for (const int size : {3, 100}) {
        Dictionary from;
        for (int index = 0; index < size; ++index) {
            from.set(std::to_string(index), "value");
        }
        const Dictionary to = std::move(from);
        EXPECT_EQ(to.size(), static_cast<std::size_t>(size));
        EXPECT_NE(to.find("2"), nullptr);
        EXPECT_TRUE(from.empty()); // NOLINT(bugprone-use-after-move): tests this
        EXPECT_EQ(from.find("2"), nullptr);
        from.setFixed("2", "new");
        EXPECT_EQ(*from.find("2"), PropertyList("new"));
    }
}

TEST(Dictionary, AValueToSetIsTheOneThereOrANewOne) {
    Dictionary dictionary{{"A", "1"}, {"B", "2"}};
    dictionary.valueToSet("B").assign(Text("3"));
    dictionary.valueToSet("A").assign(Text("4"));
    EXPECT_TRUE(dictionary.valueToSet("C").isNull());
    EXPECT_TRUE(sameInOrder(dictionary, Dictionary{{"A", "4"}, {"B", "3"}, {"C", PropertyList()}}));
}

/// Fills a dictionary again from its start.
void refill(Dictionary& dictionary, const std::vector<std::string_view>& keys) {
    dictionary.startOver();
    for (const std::string_view key : keys) {
        dictionary.valueInOrder(key).assign(Text(key));
    }
}

TEST(Dictionary, FilledAgainInOrderItKeepsWhatHasNotBeenReached) {
    Dictionary dictionary{{"A", "1"}, {"B", "2"}, {"C", "3"}};
    refill(dictionary, {"A", "B"});
    EXPECT_TRUE(sameInOrder(dictionary, Dictionary{{"A", "A"}, {"B", "B"}, {"C", "3"}}));
    dictionary.dropRest();
    EXPECT_TRUE(sameInOrder(dictionary, Dictionary{{"A", "A"}, {"B", "B"}}));
    refill(dictionary, {"A", "B", "D"});
    EXPECT_TRUE(sameInOrder(dictionary, Dictionary{{"A", "A"}, {"B", "B"}, {"D", "D"}}));
}

TEST(Dictionary, AKeyOutOfOrderRemovesAllThatFollow) {
    Dictionary dictionary{{"A", "1"}, {"B", "2"}, {"C", "3"}, {"D", "4"}};
    refill(dictionary, {"A", "C"});
    EXPECT_TRUE(sameInOrder(dictionary, Dictionary{{"A", "A"}, {"C", "C"}}))
        << "C was there, but not next";
    EXPECT_EQ(dictionary.find("B"), nullptr);
    EXPECT_EQ(dictionary.find("D"), nullptr);
    EXPECT_TRUE(dictionary.valueInOrder("B").isNull()) << "a new one";
    refill(dictionary, {"C"});
    EXPECT_TRUE(sameInOrder(dictionary, Dictionary{{"C", "C"}}));
}

TEST(Dictionary, StartedOverAndNotFilledItHasNothingButTheRest) {
    Dictionary dictionary{{"A", "1"}, {"B", "2"}};
    dictionary.startOver();
    dictionary.dropRest();
    EXPECT_TRUE(dictionary.empty());
    refill(dictionary, {"B"});
    EXPECT_TRUE(sameInOrder(dictionary, Dictionary{{"B", "B"}}));
}

TEST(Dictionary, ALargeOneThatIsFilledAgainFindsExactlyItsKeys) {
    static const std::vector<std::string> kNames = [] {
        std::vector<std::string> names;
        for (int index = 0; index < 100; ++index) {
            names.push_back(std::to_string(index));
        }
        return names;
    }();
    Dictionary dictionary;
    refill(dictionary, {kNames.begin(), kNames.end()});
    ASSERT_EQ(dictionary.size(), 100U);
    refill(dictionary, {kNames.begin(), kNames.begin() + 40});
    dictionary.dropRest();
    EXPECT_EQ(dictionary.size(), 40U);
    EXPECT_EQ(*dictionary.find("39"), PropertyList("39"));
    EXPECT_EQ(dictionary.find("40"), nullptr);
    refill(dictionary, {kNames.begin() + 1, kNames.end()});
    EXPECT_EQ(dictionary.size(), 99U);
    EXPECT_EQ(dictionary.find("0"), nullptr);
    EXPECT_EQ(*dictionary.find("99"), PropertyList("99"));
}

} // namespace
} // namespace pallax
