// The layout of query dialogs: the rules in numbers, and what happens at their limits.
#include "s/QueryLayout.h"

#include <gtest/gtest.h>

namespace {

/// A short question in a font like the one of dialogs: 22 pixels of field, buttons of 75 by 23.
QueryMeasures shortQuestion() {
    QueryMeasures m;
    m.margin = CSize(14, 7);
    m.prompt = CSize(60, 16);
    m.promptClient = CSize(120, 13);
    m.field = CSize(160, 22);
    m.button = CSize(75, 23);
    m.widest = 1200;
    return m;
}

int right(const QueryMeasures& m, CPoint button) {
    return button.x + m.button.cx;
}

} // namespace

TEST(QueryLayout, PlacesPromptFieldAndButtonsByTheRules) {
    const QueryLayout layout = LayOutQuery(shortQuestion());
    // The row: 60 + 14 + 160 = 234; the buttons: 21 + 150 = 171.
    EXPECT_EQ(layout.prompt, CRect(14, 11, 74, 27));
    EXPECT_EQ(layout.field, CRect(81, 7, 234, 29));
    EXPECT_EQ(layout.ok, CPoint(45, 43));
    EXPECT_EQ(layout.cancel, CPoint(134, 43));
    EXPECT_EQ(layout.dialog, CSize(262, 87));
}

TEST(QueryLayout, IsAsWideAsTheButtonsNeed) {
    QueryMeasures m = shortQuestion();
    m.prompt.cx = 0;
    m.field.cx = 8;
    m.hasHelp = true;
    const QueryLayout layout = LayOutQuery(m);
    // Three buttons: 21 + 150 + 75 + 14 = 260.
    EXPECT_EQ(layout.dialog.cx, 260 + 28);
    EXPECT_EQ(layout.field, CRect(21, 7, 260, 29));
    EXPECT_EQ(layout.ok.x, 14);
    EXPECT_EQ(layout.help, CPoint(192, 43));
}

TEST(QueryLayout, KeepsWideQuestionsOnTheScreen) {
    QueryMeasures m = shortQuestion();
    m.widest = 600;
    EXPECT_EQ(WidestPrompt(m), 600 - 14 - 160);
    m.field.cx = 10000;
    EXPECT_EQ(WidestPrompt(m), 600 - 14 - 300); // the field keeps half
    m.prompt = CSize(WidestPrompt(m), 64);
    const QueryLayout layout = LayOutQuery(m);
    EXPECT_EQ(layout.dialog.cx, 600 + 28);
    EXPECT_EQ(layout.field.right, 600);
    EXPECT_GT(layout.field.left, layout.prompt.right);
    // The prompt has four lines: the field stands in the middle beside it, the buttons below.
    EXPECT_EQ(layout.prompt.top, 7);
    EXPECT_EQ(layout.field.top, 7 + (64 - 22) / 2);
    EXPECT_EQ(layout.ok.y, 64 + 7 + 14);
    EXPECT_GE(layout.dialog.cy, layout.ok.y + m.button.cy);
    EXPECT_LE(right(m, layout.cancel), 600);
}
