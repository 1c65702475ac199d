// The application's help: whatever can be asked about has a page.
#include "Resource.h"
#include "tests/unit/SampleHelp.h"

namespace {

class NotesHelp : public SampleHelp {
protected:
    NotesHelp() : SampleHelp("notes") {}
};

TEST_F(NotesHelp, HasAPageForEachCommandDialogAndMessage) {
    EXPECT_GT(expectTopics({IDR_MAINFRAME, IDR_CONTEXT}), 25);
    EXPECT_EQ(expectTopicsOfDialogs(), 5);
    expectTopic(HID_BASE_RESOURCE + IDR_MAINFRAME);
    expectTopic(HID_BASE_PROMPT + IDS_NOT_FOUND);
    expectTopic(HID_BASE_PROMPT + IDS_CHANGED);
}

} // namespace
