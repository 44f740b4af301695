#include "ui/gtk/QueryView.h"

#include "tests/ui/gtk/PageStage.h"

namespace pallax::gtk {
namespace {

class QueryViewTest : public PageTest {
protected:
    void openQuery(int width) {
        open(width);
        view.emplace(
            stage->frame.metrics(), stage->guard,
            QueryView::Surroundings{
                .queries = {.moment = [this] { return moment; },
                            .goTo = [this](std::uint64_t packet) { went.push_back(packet); },
                            .mayGoOn = [this] { return mayGoOn; },
                            .seams = {.earlier =
                                          [] {
                                              return std::vector<std::string>{"select 1 as one",
                                                                              "select 2 as two"};
                                          }},
                            .ahead = [] { return std::chrono::seconds(0); }},
                .work = [](const auto& query) { query(); },
                .close = [this] { ++closings; },
                .say = [this](const std::string& text) { said.push_back(text); }});
        show(view->widget(), "Ask in SQL");
        view->focus();
        settle();
    }
    void ask(const std::string& query) {
        gtk_editable_set_text(field(view->widget()), query.c_str());
        g_signal_emit_by_name(field(view->widget()), "activate");
        settle();
    }

    std::optional<QueryView> view;
    std::vector<std::string> said;
    int closings = 0;
    bool mayGoOn = true;
};

TEST_F(QueryViewTest, BeginsWithAnEmptyFieldAndAnExplanation) {
    openQuery(kPhone);
    EXPECT_EQ(dump(), R"(
button: Back
title: Ask in SQL / 
field: ""
text: Ask in SQL: select * from tables lists the tables.
)");
    ask("  ");
    EXPECT_TRUE(shows("text: Ask in SQL:")) << "blanks ask nothing";
    ask("select 1");
    EXPECT_TRUE(shows("text: There is nothing to ask yet: no packet has come."));
}

TEST_F(QueryViewTest, TheAnswerIsATable) {
    recordDrive();
    openQuery(1024);
    ask("select kind, count(*) as number, null as missing from event group by kind");
    EXPECT_EQ(dump(), R"(
button: Back
title: Ask in SQL / 
field: "select kind, count(*) as number, null as missing from event group by kind"
columns: kind | number (right) | missing
cells (cursor) (focus): cell-change | 1 | 
cells: context-down | 1 | 
cells: context-up | 2 | 
)");
    ask("select 1 where 0");
    EXPECT_TRUE(shows("text: The query gave no rows."));
    EXPECT_FALSE(shows("columns:"));
}

TEST_F(QueryViewTest, AMistakeIsASentenceAndTheQuestionStays) {
    recordDrive();
    openQuery(kPhone);
    ask("select measured_rspr from lte.serving_cell_measurements");
    EXPECT_EQ(dump(), R"(
button: Back
title: Ask in SQL / 
field: "select measured_rspr from lte.serving_cell_measurements"
text: no such column: measured_rspr. Did you mean "measured_rsrp"? (line 1, column 8 of the query)
)");
}

TEST_F(QueryViewTest, AQueryThatIsStoppedSaysSo) {
    recordDrive();
    openQuery(kPhone);
    mayGoOn = false;
    ask("with recursive n(i) as (select 1 union all select i + 1 from n) select count(*) from n");
    EXPECT_TRUE(shows("text: The query was stopped.")) << dump();
}

TEST_F(QueryViewTest, MoreThanTenThousandRowsAreCut) {
    recordDrive();
    openQuery(kPhone);
    ask("with recursive n(i) as (select 1 union all select i + 1 from n where i < 10001) "
        "select i from n");
    EXPECT_TRUE(shows("text: Only the first 10,000 rows are shown.")) << dump();
    EXPECT_TRUE(shows("cells (cursor) (focus): 1\n"));
}

TEST_F(QueryViewTest, ChoosingARowGoesToItsPacketOrItsTime) {
    recordDrive();
    openQuery(kPhone);
    ask("select packet, kind from event order by packet");
    activate(view->widget(), 0);
    EXPECT_EQ(went, (std::vector<std::uint64_t>{drive->timeline->events()[0].packet}));
    EXPECT_EQ(closings, 1);
    ask("select 'x' as letter");
    activate(view->widget(), 0);
    EXPECT_EQ(said, (std::vector<std::string>{"The row has no packet and no time to go to."}));
    EXPECT_EQ(closings, 1);
}

TEST_F(QueryViewTest, EarlierQueriesAreRecalledAndEscapeGoesBack) {
    openQuery(kPhone);
    gtk_editable_set_text(field(view->widget()), "typed");
    pressInField(view->widget(), GDK_KEY_Up);
    EXPECT_TRUE(shows("field: \"select 2 as two\""));
    pressInField(view->widget(), GDK_KEY_Up);
    pressInField(view->widget(), GDK_KEY_Up);
    EXPECT_TRUE(shows("field: \"select 1 as one\""));
    pressInField(view->widget(), GDK_KEY_Down);
    pressInField(view->widget(), GDK_KEY_Down);
    EXPECT_TRUE(shows("field: \"typed\""));
    pressInField(view->widget(), GDK_KEY_Escape);
    EXPECT_EQ(closings, 1);
}

} // namespace
} // namespace pallax::gtk
