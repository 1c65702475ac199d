#include "platform/afx/frames/FormView.h"

#include "platform/afx/controls/Controls.h"
#include "platform/afx/dialogs/DataExchange.h"
#include "tests/ui/afx/frames/FrameTesting.h"

using namespace frametest;

namespace {

/// A note's text and what else is known of it.
class PartView : public CFormView {
    DECLARE_DYNCREATE(PartView)

public:
    PartView() : CFormView(IDD_TESTFORM) {}
    CString name = "gear";
    int done = BST_CHECKED;

    void DoDataExchange(CDataExchange* dx) override {
        DDX_Text(dx, IDC_TEST_TEXT, name);
        DDX_Check(dx, IDC_FORM_DONE, done);
    }
    std::string textOf(int id) const {
        return titleOf(*GetDlgItem(id));
    }
    /// The control that has the keyboard, 0 for none of the form's.
    int focus() const {
        const HWND window = ::GetFocus();
        return ::IsChild(m_hWnd, window) ? CWnd::FromHandle(window)->GetDlgCtrlID() : 0;
    }

    afx_msg void OnGo() {
        note("go");
    }
    afx_msg void OnNameChanged() {
        note("name changed");
    }
    afx_msg void OnGrid() {
        note("grid");
    }
    afx_msg HBRUSH OnCtlColor(CDC* dc, CWnd* window, UINT kind) {
        return window == this ? static_cast<HBRUSH>(yellow) : CFormView::OnCtlColor(dc, window, kind);
    }

    CBrush yellow{RGB(255, 255, 0)};

protected:
    DECLARE_MESSAGE_MAP()
};

IMPLEMENT_DYNCREATE(PartView, CFormView)

// clang-format off
BEGIN_MESSAGE_MAP(PartView, CFormView)
    ON_BN_CLICKED(IDC_FORM_GO, &PartView::OnGo)
    ON_EN_CHANGE(IDC_TEST_TEXT, &PartView::OnNameChanged)
    ON_COMMAND(ID_TEST_GRID, &PartView::OnGrid)
    ON_WM_CTLCOLOR()
END_MESSAGE_MAP()
// clang-format on

class Form : public FrameTest {
protected:
    void SetUp() override {
        FrameTest::SetUp();
        frame = &openBoards();
        parts = new CMultiDocTemplate(IDR_TESTBOARD, RUNTIME_CLASS(Note), RUNTIME_CLASS(CMDIChildWnd),
                                      RUNTIME_CLASS(PartView));
        AfxGetApp()->AddDocTemplate(parts);
        form = openPart();
        ASSERT_NE(form, nullptr);
    }
    PartView* openPart() {
        parts->OpenDocumentFile(nullptr);
        settle();
        auto* active = dynamic_cast<PartView*>(frame->GetActiveFrame()->GetActiveView());
        return active;
    }
    BoardsFrame* frame = nullptr;
    CMultiDocTemplate* parts = nullptr;
    PartView* form = nullptr;
};

} // namespace

TEST_F(Form, ExchangesValuesAndHearsItsControls) {
    EXPECT_EQ(form->textOf(IDC_TEST_TEXT), "gear");
    EXPECT_EQ(form->IsDlgButtonChecked(IDC_FORM_DONE), UINT{BST_CHECKED});
    EXPECT_NE(form->GetDocument(), nullptr);
    EXPECT_EQ(form->GetDlgCtrlID(), AFX_IDW_PANE_FIRST);
    EXPECT_FALSE(noted("name changed")) << "the exchange is nobody's change";
    form->SetDlgItemText(IDC_TEST_TEXT, "wheel");
    EXPECT_TRUE(noted("name changed"));
    EXPECT_TRUE(form->UpdateData(TRUE));
    EXPECT_EQ(form->name, "wheel");
    form->GetDlgItem(IDC_FORM_GO)->SendMessage(BM_CLICK);
    EXPECT_TRUE(noted("go"));
}

TEST_F(Form, HasTheKeysOfADialogBehindThoseOfItsFrames) {
    EXPECT_EQ(form->focus(), IDC_TEST_TEXT) << "the first control, when the view is opened";
    key(Qt::Key_Tab);
    EXPECT_EQ(form->focus(), IDC_FORM_NOTES);
    key(Qt::Key_Return);
    key(Qt::Key_X);
    EXPECT_EQ(form->textOf(IDC_FORM_NOTES), "\r\nx");
    key(Qt::Key_Down);
    EXPECT_EQ(form->focus(), IDC_FORM_NOTES) << "arrows are the field's";
    key(Qt::Key_G, Qt::AltModifier);
    EXPECT_EQ(form->focus(), IDC_FORM_GO);
    EXPECT_TRUE(noted("go"));
    key(Qt::Key_N, Qt::AltModifier);
    EXPECT_EQ(form->focus(), IDC_TEST_TEXT) << "the label's field";
    key(Qt::Key_Tab, Qt::ShiftModifier);
    EXPECT_EQ(form->focus(), IDC_FORM_GO);
    journal().clear();
    key(Qt::Key_F5);
    EXPECT_TRUE(noted("grid")) << "the main frame's accelerator, the view's command";
    key(Qt::Key_Escape);
    EXPECT_TRUE(::IsWindow(form->m_hWnd));
    key(Qt::Key_W, Qt::AltModifier);
    EXPECT_NE(openMenu(), nullptr) << "a letter that no control has is the menu's";
    key(Qt::Key_Escape);
    key(Qt::Key_Escape);
}

TEST_F(Form, TheControlThatHadTheKeyboardGetsItBack) {
    key(Qt::Key_Tab);
    key(Qt::Key_Tab);
    ASSERT_EQ(form->focus(), IDC_FORM_DONE);
    PartView* other = openPart();
    ASSERT_NE(other, form);
    EXPECT_EQ(other->focus(), IDC_TEST_TEXT);
    frame->MDIActivate(form->GetParent());
    settle();
    EXPECT_EQ(form->focus(), IDC_FORM_DONE);
    frame->MDIActivate(other->GetParent());
    settle();
    EXPECT_EQ(other->focus(), IDC_TEST_TEXT);
    // A click into the form that is not active goes to the control that was clicked.
    QTest::mouseClick(tvx::afx::peerOf(form->GetDlgItem(IDC_FORM_NOTES)->m_hWnd), Qt::LeftButton);
    settle();
    EXPECT_EQ(frame->MDIGetActive(), form->GetParent());
    EXPECT_EQ(form->focus(), IDC_FORM_NOTES);
    form->GetDlgItem(IDC_FORM_NOTES)->EnableWindow(FALSE);
    form->SetFocus();
    EXPECT_EQ(form->focus(), IDC_TEST_TEXT) << "a control that cannot have it does not keep it from the others";
}

TEST_F(Form, ScrollsTheSizeOfItsTemplate) {
    CRect before;
    form->GetDlgItem(IDC_FORM_GO)->GetWindowRect(&before);
    CRect inside = before;
    form->ScreenToClient(&inside);
    EXPECT_NEAR(form->GetTotalSize().cy, inside.bottom * 120 / 114, 1);
    form->GetParent()->SetWindowPos(nullptr, 0, 0, 150, 120, SWP_NOMOVE | SWP_NOZORDER);
    settle();
    EXPECT_EQ(form->GetStyle() & (WS_HSCROLL | WS_VSCROLL), DWORD{WS_HSCROLL | WS_VSCROLL});
    key(Qt::Key_G, Qt::AltModifier);
    const CPoint at = form->GetScrollPosition();
    EXPECT_GT(at.y, 0) << "the keyboard's control is brought into sight";
    CRect after;
    form->GetDlgItem(IDC_FORM_GO)->GetWindowRect(&after);
    EXPECT_EQ(before.top - at.y, after.top) << "controls move with what is scrolled";
    CRect client;
    form->GetClientRect(&client);
    form->ScreenToClient(&after);
    EXPECT_LE(after.bottom, client.bottom);
    form->ScrollToPosition(CPoint(0, 0));
    form->SendMessage(WM_MOUSEWHEEL, MAKEWPARAM(0, -120));
    EXPECT_GT(form->GetScrollPosition().y, 0);
}

TEST_F(Form, WearsTheColourThatItsHostAnswers) {
    settle();
    const QImage picture = tvx::afx::peerOf(form->m_hWnd)->grab().toImage();
    EXPECT_EQ(picture.pixel(1, 1), qRgb(255, 255, 0));
    EXPECT_EQ(picture.pixel(picture.width() - 2, picture.height() - 2), qRgb(255, 255, 0));
}

TEST_F(Form, IsMadeByItsTemplateOrNotAtAll) {
    class Missing : public CFormView {
    public:
        Missing() : CFormView("NOBODYS_FORM") {}
        using CFormView::Create;
    };
    testing::internal::CaptureStderr();
    EXPECT_FALSE((new Missing)->Create(nullptr, nullptr, WS_CHILD, CRect(0, 0, 0, 0), frame, AFX_IDW_PANE_FIRST));
    EXPECT_NE(testing::internal::GetCapturedStderr().find("NOBODYS_FORM"), std::string::npos);
}
