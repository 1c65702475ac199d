#include "s/MessageManager.h"

#include "TestApp.h"
#include "platform/port/MsgDispatcher.h"
#include "platform/port/MsgManData.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace {

std::vector<std::string> errors;
std::vector<std::string> lines;

Port_MsgManData issuer() {
    return Port_MsgManData::createObject("tests", "MessageManagerTest", 1, "");
}

class MessageManager : public testing::Test {
protected:
    MessageManager() {
        errors.clear();
        lines.clear();
        theApp.boxes.clear();
    }

    static void useCallbacks(Gui_MessageManager& manager) {
        manager.setClean(true);
        Port_MsgDispatcher::addMsgMan(&manager);
    }
    static void takeError(CString text) {
        errors.emplace_back(text.View());
    }
    static void takeLine(CString text) {
        lines.emplace_back(text.View());
    }
};

} // namespace

TEST_F(MessageManager, HandsStatusMessagesOnLineByLine) {
    Gui_MessageManager manager(&takeError, &takeLine);
    useCallbacks(manager);
    issuer().issueStatus("one\n\nthree\n");
    issuer().issueWarning("careful");
    EXPECT_EQ(lines, (std::vector<std::string>{"one", "", "three", "careful"}));
    EXPECT_TRUE(errors.empty());
}

TEST_F(MessageManager, HandsErrorsOnWhole) {
    Gui_MessageManager manager(&takeError, &takeLine);
    useCallbacks(manager);
    issuer().issueError("first\nsecond");
    issuer().issueInternal("third");
    issuer().issueFatal(3, "fourth");
    EXPECT_EQ(errors, (std::vector<std::string>{"first\nsecond\n", "third\n", "fourth\n"}));
    EXPECT_TRUE(lines.empty());
    EXPECT_EQ(manager.getAbort(), 3);
}

TEST_F(MessageManager, SaysNothingForNothing) {
    Gui_MessageManager manager(&takeError, &takeLine);
    useCallbacks(manager);
    issuer().issueStatus("%s", "");
    EXPECT_TRUE(lines.empty());
    issuer().issueError("%s", "");
    EXPECT_EQ(errors.size(), 1u) << "an error is an error, even without words";
}

TEST_F(MessageManager, KeepsTextInUtf8AndWrapsIt) {
    Gui_MessageManager manager(&takeError, &takeLine);
    useCallbacks(manager);
    manager.setMaxLineWidth(12);
    issuer().issueStatus("Größe \xF0\x9F\x93\x90 unbekannt");
    ASSERT_EQ(lines.size(), 2u);
    EXPECT_EQ(lines[0] + " " + lines[1], "Größe \xF0\x9F\x93\x90 unbekannt");
}

TEST_F(MessageManager, WithoutCallbacksUsesBoxAndStandardOutput) {
    Gui_MessageManager manager;
    useCallbacks(manager);
    testing::internal::CaptureStdout();
    issuer().issueStatus("on its way");
    issuer().issueError("broken");
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "on its way\n");
    ASSERT_EQ(theApp.boxes.size(), 1u);
    EXPECT_EQ(theApp.boxes[0].text, "broken\n");
    EXPECT_EQ(theApp.boxes[0].type, UINT(MB_ICONERROR));
}
