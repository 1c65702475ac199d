// The application's help: whatever can be asked about has a page.
#include "Resource.h"
#include "tests/unit/SampleHelp.h"

namespace {

class BoardHelp : public SampleHelp {
protected:
    BoardHelp() : SampleHelp("board") {}
};

TEST_F(BoardHelp, HasAPageForEachCommandOfItsMenus) {
    EXPECT_GT(expectTopics({IDR_MAINFRAME, IDR_BOARDTYPE, IDR_CONTEXT}), 50);
    for (const UINT prompt : {AFX_IDS_SCSIZE, AFX_IDS_SCMOVE, AFX_IDS_SCMINIMIZE, AFX_IDS_SCMAXIMIZE, AFX_IDS_SCCLOSE,
                              AFX_IDS_SCRESTORE, AFX_IDS_MDICHILD}) {
        expectTopic(HID_BASE_COMMAND + prompt);
    }
}

TEST_F(BoardHelp, HasAPageForEachDialogAndTheDrawingsWindow) {
    EXPECT_EQ(expectTopicsOfDialogs(), 11);
    expectTopic(HID_BASE_RESOURCE + IDR_BOARDTYPE);
}

} // namespace
