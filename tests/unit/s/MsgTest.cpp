#include "s/Msg.h"

#include "platform/win/ExtensionModule.h"
#include "res/resource.h"

#include <gtest/gtest.h>
#include <string>

namespace {

std::string expand(const char* format, std::initializer_list<const char*> parameters) {
    Gui_Msg message(format);
    for (const char* parameter : parameters) {
        message << parameter;
    }
    return std::string(message.GetValue().View());
}

} // namespace

TEST(Msg, PutsParametersIntoTheirPlaces) {
    EXPECT_EQ(expand("%2 %1", {"a", "b"}), "b a");
    EXPECT_EQ(expand("%1%1", {"a"}), "aa");
    EXPECT_EQ(expand("%10", {"a"}), "a0");
    EXPECT_EQ(expand("%9", {"1", "2", "3", "4", "5", "6", "7", "8", "9", "10"}), "9");
    EXPECT_EQ(expand("[%1]", {nullptr}), "[]");
    EXPECT_EQ(expand("none", {"a"}), "none");
}

TEST(Msg, ParametersAreNotExpandedAgain) {
    EXPECT_EQ(expand("%1%2", {"%2", "100%"}), "%2100%");
}

TEST(Msg, MarksWhatHasNoParameter) {
    EXPECT_EQ(expand("%%", {"a"}), "???");
    EXPECT_EQ(expand("%0", {"a"}), "???");
    EXPECT_EQ(expand("100%x", {"a"}), "100???");
    EXPECT_EQ(expand("%2", {"a"}), "???");
    EXPECT_EQ(expand("end %", {"a"}), "end ???");
    EXPECT_EQ(expand("%", {}), "???");
}

TEST(Msg, TakesAWholeCharacterAfterThePercentSign) {
    EXPECT_EQ(expand("%äb", {"a"}), "???b");
    EXPECT_EQ(expand("%\xC3%1", {"a"}), "???a") << "a broken byte counts as one character";
    EXPECT_EQ(expand("ä%1\xF0\x9F\x98\x80%1", {"é"}), "äé\xF0\x9F\x98\x80é");
}

TEST(Msg, NumbersAreDecimal) {
    Gui_Msg message("%1 %2 %3");
    message << -12 << 0 << 2147483647;
    EXPECT_STREQ(message, "-12 0 2147483647");
    EXPECT_STREQ(Gui_Msg::Format("%d items", 3), "3 items");
    EXPECT_STREQ(Gui_Msg::Format(nullptr, 3), "");
}

TEST(Msg, KeepsItsTextUntilItBeginsAnew) {
    Gui_Msg message("[%1]");
    EXPECT_STREQ(message, "[???]");
    message << "late";
    EXPECT_STREQ(message.GetValue(), "[???]");
    message.ClearParameters();
    message << "new";
    EXPECT_STREQ(message, "[new]");
    message.SetFormat("%1.");
    EXPECT_STREQ(message, "???.");
}

TEST(Msg, ExpandsAnEmptyTextAgain) {
    Gui_Msg message("%1");
    message << "";
    EXPECT_STREQ(message, "");
    message.SetFormat("%1%2");
    message << "";
    EXPECT_STREQ(message, "???");
}

TEST(Msg, LoadsFormatsFromTheStringTable) {
    Gui_Msg assigned(GUI_IDS_KEY_ASSIGNED);
    assigned << "Ctrl+A"
             << "Edit Copy";
    EXPECT_STREQ(assigned, "Ctrl+A is assigned to Edit Copy");

    Gui_Msg tutorial(GUI_IDS_TUTORIAL_FAILED, AfxFindStringResourceHandle(GUI_IDS_TUTORIAL_FAILED));
    EXPECT_STREQ(tutorial, "The tutorial program ??? could not be started.");
}

TEST(Msg, UnknownStringsEmptyTheFormatOnlyWithAModule) {
    constexpr unsigned int unused = 20050;
    Gui_Msg message("kept %1");
    message << "a";
    message.SetFormat(unused);
    EXPECT_STREQ(message, "kept ???") << "the parameters are forgotten all the same";
    message.SetFormat(unused, AfxFindStringResourceHandle(GUI_IDS_TUTORIAL_FAILED));
    EXPECT_STREQ(message, "");
    EXPECT_STREQ(Gui_Msg(unused), "");
}
