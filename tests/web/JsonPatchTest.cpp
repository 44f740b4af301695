#include "web/JsonPatch.h"

#include "decoding/DisplayJson.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>
#include <rapidcheck/gtest.h>

namespace pallax {
namespace {

using nlohmann::json;

json jsonOf(const PropertyList& value) {
    std::string text;
    appendJson(text, value);
    return json::parse(text);
}

/// As the page does it.
json patched(json value, const json& patch) {
    if (patch.contains("value")) {
        return patch["value"];
    }
    if (patch.contains("members")) {
        for (const auto& [key, member] : patch["members"].items()) {
            value[key] = patched(value.contains(key) ? value[key] : json(), member);
        }
        return value;
    }
    const json& items = patch["items"];
    const auto drop = items["drop"].get<std::size_t>();
    json list = json::array();
    for (std::size_t index = 0; index < items["size"].get<std::size_t>(); ++index) {
        list.push_back(value.at(drop + index));
    }
    for (const auto& [index, item] : items["at"].items()) {
        list.at(std::stoul(index)) = patched(list.at(std::stoul(index)), item);
    }
    for (const json& item : items["add"]) {
        list.push_back(item);
    }
    return list;
}

TEST(JsonPatch, OfTheSameIsEmpty) {
    const PropertyList value = Dictionary{{"a", Array{"1", Dictionary{{"b", "2"}}}}};
    EXPECT_EQ(jsonPatch(value, value.shallowCopy()), "");
    EXPECT_EQ(jsonPatch(PropertyList(), PropertyList()), "");
}

TEST(JsonPatch, HasTheMembersThatHaveChanged) {
    EXPECT_EQ(jsonPatch(Dictionary{{"a", "1"}, {"b", "2"}},
                        Dictionary{{"a", "1"}, {"b", "3"}, {"c\"", "<x>\n"}}),
              R"({"members":{"b":{"value":"3"},"c\"":{"value":"<x>\n"}}})");
    EXPECT_EQ(jsonPatch(Dictionary{{"a", "1"}, {"b", "2"}}, Dictionary{{"b", "2"}}),
              R"({"value":{"b":"2"}})")
        << "a member is gone";
    EXPECT_EQ(jsonPatch("1", Array{"1"}), R"({"value":["1"]})");
}

TEST(JsonPatch, OfAListHasWhatIsNew) {
    EXPECT_EQ(jsonPatch(Array{"1", "2"}, Array{"1", "2", "3"}),
              R"({"items":{"drop":0,"size":2,"at":{},"add":["3"]}})");
    EXPECT_EQ(jsonPatch(Array{"1", "2", "3"}, Array{"2", "3", "4"}),
              R"({"items":{"drop":1,"size":2,"at":{},"add":["4"]}})")
        << "the earliest are dropped";
    EXPECT_EQ(jsonPatch(Array{"1", "2", "3"}, Array{"1"}),
              R"({"items":{"drop":0,"size":1,"at":{},"add":[]}})");
    EXPECT_EQ(jsonPatch(Array{}, Array{"1"}), R"({"value":["1"]})");
    EXPECT_EQ(jsonPatch(Array{"1"}, Array{}), R"({"value":[]})");
}

TEST(JsonPatch, OfNestedListsIsSmall) {
    const auto lanes = [](const char* to, Array more) {
        Array spans(1000, Dictionary{{"text", "idle"}, {"to", "1"}});
        spans.emplace_back(Dictionary{{"text", "connected"}, {"to", to}});
        spans.insert(spans.end(), more.begin(), more.end());
        return PropertyList(Array{Dictionary{{"name", "RRC"}, {"spans", std::move(spans)}}});
    };
    EXPECT_EQ(jsonPatch(lanes("2", {}), lanes("3", {"x"})),
              R"({"items":{"drop":0,"size":1,"at":{"0":{"members":{"spans":{"items":{"drop":0,)"
              R"("size":1001,"at":{"1000":{"members":{"to":{"value":"3"}}}},"add":["x"]}}}}},)"
              R"("add":[]}})");
}

rc::Gen<PropertyList> valuesOfDepth(int depth) {
    const auto texts = rc::gen::map(
        rc::gen::inRange(0, 4), [](int number) { return PropertyList(std::to_string(number)); });
    if (depth == 0) {
        return texts;
    }
    const auto inner = valuesOfDepth(depth - 1);
    const auto lists =
        rc::gen::map(rc::gen::container<std::vector<PropertyList>>(inner), [](const auto& items) {
            return PropertyList(Array(items.begin(), items.end()));
        });
    const auto objects =
        rc::gen::map(rc::gen::container<std::map<int, PropertyList>>(rc::gen::inRange(0, 4), inner),
                     [](const auto& members) {
                         Dictionary object;
                         for (const auto& [key, value] : members) {
                             object.set(std::to_string(key), value);
                         }
                         return PropertyList(object);
                     });
    return rc::gen::oneOf(texts, lists, objects);
}

RC_GTEST_PROP(JsonPatchProperty, MakesTheLaterOutOfTheEarlier, ()) {
    const PropertyList before = *valuesOfDepth(2);
    const PropertyList after = *valuesOfDepth(2);
    const std::string patch = jsonPatch(before, after);
    RC_ASSERT(patch.empty() == (before == after));
    const json made = patch.empty() ? jsonOf(before) : patched(jsonOf(before), json::parse(patch));
    RC_ASSERT(made == jsonOf(after));
}

} // namespace
} // namespace pallax
