#include "ui/contents/Graph.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(Graph, HasAtMostSixValues) {
    Graph graph;
    for (int index = 1; index <= 6; ++index) {
        EXPECT_EQ(graph.toggle({"field " + std::to_string(index), "", ""}),
                  "In the graph (" + std::to_string(index) + " of 6): V opens it.");
    }
    EXPECT_EQ(graph.toggle({"field 7", "", ""}),
              "The graph has 6 values already: v takes one away.");
    EXPECT_TRUE(graph.contains({"field 2", "", ""}));
    EXPECT_EQ(graph.toggle({"field 2", "", ""}), "No longer in the graph.");
    EXPECT_FALSE(graph.contains({"field 2", "", ""}));
    EXPECT_EQ(graph.leaves().size(), 5U);
    EXPECT_EQ(graph.leaves()[1].field, "field 3");
}

} // namespace
} // namespace pallax
