#include <gtest/gtest.h>

#include "platform/afx/core/App.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/win/FrameworkIds.h"
#include "tests/ui/afx/AccessibleTree.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

#include <QScreen>
#include <QWindow>

#include <algorithm>
#include <map>
#include <stdexcept>

namespace {

class ShapeDialog : public ScriptedDialog {
public:
    explicit ShapeDialog(CWnd* parent = nullptr) : ScriptedDialog(IDD_SHAPE, parent) {}
    CRect rectOf(int id) const {
        CRect rect;
        GetDlgItem(id)->GetWindowRect(&rect);
        ScreenToClient(&rect);
        return rect;
    }
    bool isChecked(int id) const {
        return IsDlgButtonChecked(id) != 0;
    }
};

/// A main window, shown and active, as dialogs stand over.
class Owner : public CWnd {
public:
    Owner() {
        CreateEx(0, nullptr, "Owner", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 50, 50, 400, 300, nullptr, nullptr);
        EXPECT_TRUE(waitForActive(*this));
    }
    int saves = 0;

protected:
    afx_msg void OnSave() {
        ++saves;
    }
    DECLARE_MESSAGE_MAP()
};

// clang-format off
BEGIN_MESSAGE_MAP(Owner, CWnd)
    ON_COMMAND(ID_FILE_SAVE, &Owner::OnSave)
END_MESSAGE_MAP()
// clang-format on

TEST(DialogTemplates, PlaceControlsInUnitsOfTheFont) {
    ShapeDialog dialog;
    dialog.script = [&] {
        EXPECT_EQ(textOf(&dialog), "Shape");
        CRect units(0, 0, 4, 8);
        dialog.MapDialogRect(&units);
        EXPECT_EQ(units, CRect(0, 0, 6, 13)); // 8 points are 11 pixels
        EXPECT_EQ(dialog.rectOf(IDC_NAME), CRect(75, 11, 225, 34));
        EXPECT_EQ(dialog.rectOf(IDOK), CRect(245, 11, 320, 34));
        CRect client;
        dialog.GetClientRect(&client);
        EXPECT_EQ(client, CRect(0, 0, 330, 260));
        // A combo box's height is that of its open list.
        EXPECT_LT(dialog.rectOf(IDC_COLOR).Height(), 30);
        CRect open;
        static_cast<CComboBox*>(dialog.GetDlgItem(IDC_COLOR))->GetDroppedControlRect(&open);
        EXPECT_EQ(open.Height(), 98);
        // Lists show whole lines.
        CRect list;
        dialog.GetDlgItem(IDC_LAYERS)->GetClientRect(&list);
        EXPECT_EQ(list.Height() % dialog.SendDlgItemMessage(IDC_LAYERS, LB_GETITEMHEIGHT), 0);
    };
    EXPECT_EQ(dialog.DoModal(), ScriptedDialog::scriptDone);
}

TEST(DialogTemplates, FollowTheFontSizeOfTheDesktop) {
    const QFont before = QApplication::font();
    const auto shownUnits = [](int desktopPixels) {
        QFont font = QApplication::font();
        font.setPixelSize(desktopPixels);
        QApplication::setFont(font);
        CDialog dialog;
        EXPECT_TRUE(dialog.Create(IDD_EMPTY));
        const QFontInfo shown(tvx::afx::peerOf(dialog.m_hWnd)->font());
        EXPECT_EQ(shown.family(), QFontInfo(font).family()) << "one font for menus, boxes and dialogs";
        EXPECT_GE(shown.pixelSize(), desktopPixels);
        CRect units(0, 0, 4, 8);
        dialog.MapDialogRect(&units);
        dialog.DestroyWindow();
        return units.Size();
    };
    EXPECT_EQ(shownUnits(9), shownUnits(10)) << "never smaller than the template says";
    const CSize usual = shownUnits(12);
    const CSize twice = shownUnits(24);
    EXPECT_NEAR(twice.cx, 2 * usual.cx, 1);
    EXPECT_NEAR(twice.cy, 2 * usual.cy, 1);
    QApplication::setFont(before);
}

TEST(DialogTemplates, OpenWithControlsOfUnknownClassesAndFillBoxes) {
    ShapeDialog dialog;
    dialog.script = [&] {
        EXPECT_TRUE(dialog.GetDlgItem(IDC_TREE)->IsWindowVisible());
        EXPECT_EQ(dialog.SendDlgItemMessage(IDC_COLOR, CB_GETCOUNT), 2);
        EXPECT_EQ(dialog.SendDlgItemMessage(IDC_COLOR, CB_GETCURSEL), -1);
        EXPECT_EQ(dialog.SendDlgItemMessage(IDC_COLOR, CB_FINDSTRINGEXACT, static_cast<WPARAM>(-1),
                                            reinterpret_cast<LPARAM>("two")),
                  1);
    };
    dialog.DoModal();
}

TEST(DialogTemplates, TellOnceOfAClassThatNobodyRegistered) {
    testing::internal::CaptureStderr();
    for (int round = 0; round < 2; ++round) {
        CDialog dialog;
        EXPECT_TRUE(dialog.Create(IDD_STRANGE));
        EXPECT_NE(dialog.GetDlgItem(IDC_NAME), nullptr) << "its pane stands there nevertheless";
        dialog.DestroyWindow();
    }
    const std::string told = testing::internal::GetCapturedStderr();
    const auto first = told.find("StrangeGauge");
    EXPECT_NE(first, std::string::npos) << told;
    EXPECT_EQ(told.find("StrangeGauge", first + 1), std::string::npos) << told;
}

TEST(DialogTemplates, AnswerMinusOneWhenMissing) {
    CDialog dialog(4711U);
    EXPECT_EQ(dialog.DoModal(), -1);
    CDialog modeless;
    EXPECT_FALSE(modeless.Create(4711U));
}

TEST(DialogKeys, TabGoesThroughTheStopsInOrder) {
    ShapeDialog dialog;
    dialog.prepare = [&] {
        dialog.SetDlgItemText(IDC_NAME, "Größe");
        dialog.CheckRadioButton(IDC_LINE, IDC_ARC, IDC_CIRCLE);
    };
    dialog.script = [&] {
        EXPECT_EQ(dialog.focus(), IDC_NAME);
        int start = 0;
        int end = 0;
        static_cast<CEdit*>(dialog.GetDlgItem(IDC_NAME))->GetSel(start, end);
        EXPECT_EQ(start, 0);
        EXPECT_EQ(end, 7); // bytes; the keyboard's coming selects all
        std::vector<int> order;
        for (int step = 0; step < 11; ++step) {
            key(Qt::Key_Tab);
            order.push_back(dialog.focus());
        }
        // The group of radio buttons is entered at the one that is marked; the unknown control takes no keyboard.
        const std::vector<int> expected{IDC_SCALE, IDC_CIRCLE, IDC_VISIBLE, IDC_LAYERS,   IDC_COLOR, IDC_FONT,
                                        IDOK,      IDCANCEL,   IDC_APPLY,   ID_FILE_SAVE, IDC_NAME};
        EXPECT_EQ(order, expected);
        key(Qt::Key_Backtab, Qt::ShiftModifier);
        EXPECT_EQ(dialog.focus(), ID_FILE_SAVE);
        dialog.GetDlgItem(IDC_APPLY)->EnableWindow(FALSE);
        key(Qt::Key_Backtab, Qt::ShiftModifier);
        EXPECT_EQ(dialog.focus(), IDCANCEL);
    };
    dialog.DoModal();
}

TEST(DialogKeys, ArrowsMoveTheMarkThroughItsGroup) {
    ShapeDialog dialog;
    dialog.prepare = [&] { dialog.CheckRadioButton(IDC_LINE, IDC_ARC, IDC_LINE); };
    dialog.script = [&] {
        dialog.GetDlgItem(IDC_LINE)->SetFocus();
        key(Qt::Key_Down);
        EXPECT_EQ(dialog.focus(), IDC_CIRCLE);
        EXPECT_EQ(dialog.GetCheckedRadioButton(IDC_LINE, IDC_ARC), IDC_CIRCLE);
        EXPECT_FALSE(dialog.isChecked(IDC_LINE));
        EXPECT_EQ(dialog.codes(IDC_CIRCLE, BN_CLICKED), 1);
        key(Qt::Key_Down);
        key(Qt::Key_Down);
        EXPECT_EQ(dialog.focus(), IDC_LINE); // around, not on to the check box
        key(Qt::Key_Up);
        EXPECT_EQ(dialog.GetCheckedRadioButton(IDC_LINE, IDC_ARC), IDC_ARC);
    };
    dialog.DoModal();
}

TEST(DialogKeys, EnterPressesTheFocusedButtonElseTheDefaultOne) {
    ShapeDialog dialog;
    dialog.script = [&] {
        dialog.GetDlgItem(IDC_APPLY)->SetFocus();
        key(Qt::Key_Return);
        EXPECT_EQ(dialog.codes(IDC_APPLY, BN_CLICKED), 1);
        EXPECT_TRUE(dialog.IsWindowVisible());
        dialog.GetDlgItem(IDC_NAME)->SetFocus();
        key(Qt::Key_Return);
    };
    EXPECT_EQ(dialog.DoModal(), IDOK);

    ShapeDialog changed;
    changed.script = [&] {
        changed.SetDefID(IDC_APPLY);
        changed.GetDlgItem(IDC_NAME)->SetFocus();
        key(Qt::Key_Return);
        EXPECT_EQ(changed.codes(IDC_APPLY, BN_CLICKED), 1);
        key(Qt::Key_Escape);
    };
    EXPECT_EQ(changed.DoModal(), IDCANCEL);
}

TEST(DialogKeys, ProgramsMoveTheKeyboardAsTheUserDoes) {
    ShapeDialog dialog;
    dialog.script = [&] {
        dialog.SetDlgItemText(IDC_SCALE, "100");
        dialog.GotoDlgCtrl(dialog.GetDlgItem(IDC_SCALE));
        EXPECT_EQ(dialog.focus(), IDC_SCALE);
        EXPECT_EQ(dialog.SendDlgItemMessage(IDC_SCALE, EM_GETSEL), MAKELONG(0, 3));
        dialog.PrevDlgCtrl();
        EXPECT_EQ(dialog.focus(), IDC_NAME);
        dialog.PrevDlgCtrl();
        EXPECT_EQ(dialog.focus(), ID_FILE_SAVE) << "around";
        dialog.NextDlgCtrl();
        EXPECT_EQ(dialog.focus(), IDC_NAME);
        EXPECT_EQ(dialog.GetDefID(), static_cast<DWORD>(MAKELONG(IDOK, DC_HASDEFID)));
        dialog.SetDefID(0);
        EXPECT_EQ(dialog.GetDefID(), 0U);
    };
    dialog.DoModal();
}

TEST(DialogKeys, MnemonicsActOnce) {
    ShapeDialog dialog;
    dialog.script = [&] {
        key(Qt::Key_S, Qt::AltModifier);
        EXPECT_EQ(dialog.focus(), IDC_SCALE); // a label hands on to what stands behind it
        type("v");
        EXPECT_EQ(textOf(dialog.GetDlgItem(IDC_SCALE)), "v");
        EXPECT_FALSE(dialog.isChecked(IDC_VISIBLE));
        key(Qt::Key_V, Qt::AltModifier);
        EXPECT_TRUE(dialog.isChecked(IDC_VISIBLE));
        EXPECT_EQ(dialog.codes(IDC_VISIBLE, BN_CLICKED), 1);
        type("v"); // a check box wants no characters
        EXPECT_FALSE(dialog.isChecked(IDC_VISIBLE));
        key(Qt::Key_Space);
        EXPECT_TRUE(dialog.isChecked(IDC_VISIBLE));
        type("r");
        EXPECT_TRUE(dialog.isChecked(IDC_ARC));
        // On a Russian layout, by the place of S.
        QKeyEvent russian(QEvent::KeyPress, 0x42B, Qt::AltModifier, 39, 0, 0, QStringLiteral("ы"));
        QSpontaneKeyEvent::setSpontaneous(&russian);
        QApplication::instance()->notify(QApplication::focusWidget(), &russian);
        EXPECT_EQ(dialog.focus(), IDC_SCALE);
        dialog.GetDlgItem(IDC_APPLY)->EnableWindow(FALSE);
        key(Qt::Key_A, Qt::AltModifier);
        EXPECT_EQ(dialog.codes(IDC_APPLY, BN_CLICKED), 0);
    };
    dialog.DoModal();
}

TEST(ModalDialogs, CloseButtonIsCancel) {
    ShapeDialog dialog;
    dialog.script = [&] { dialog.GetState()->widget()->close(); };
    EXPECT_EQ(dialog.DoModal(), IDCANCEL);
    EXPECT_EQ(dialog.m_hWnd, nullptr);

    ShapeDialog refused;
    refused.prepare = [&] { refused.GetDlgItem(IDCANCEL)->EnableWindow(FALSE); };
    refused.script = [&] {
        refused.GetState()->widget()->close();
        key(Qt::Key_Escape);
        EXPECT_TRUE(refused.IsWindowVisible());
    };
    EXPECT_EQ(refused.DoModal(), ScriptedDialog::scriptDone);
}

TEST(ModalDialogs, EndedBeforeTheyAreSeen) {
    class Ended : public CDialog {
    public:
        Ended() : CDialog(static_cast<UINT>(IDD_SHAPE)) {}
        bool seen = false;

    protected:
        BOOL OnInitDialog() override {
            EndDialog(7);
            return TRUE;
        }
        LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
            seen = seen || (message == WM_SHOWWINDOW && wParam != 0);
            return CDialog::WindowProc(message, wParam, lParam);
        }
    } dialog;
    EXPECT_EQ(dialog.DoModal(), 7);
    EXPECT_FALSE(dialog.seen);
}

TEST(ModalDialogs, KeepTheUserFromTheOwnerAndGiveItBack) {
    Owner owner;
    ShapeDialog dialog(&owner);
    dialog.script = [&] {
        EXPECT_FALSE(owner.IsWindowEnabled());
        EXPECT_EQ(dialog.GetParent(), &owner);
        click(dialog.GetDlgItem(ID_FILE_SAVE)); // a plain command goes on to the owner
        EXPECT_EQ(owner.saves, 1);
        QTest::mouseClick(owner.GetState()->widget()->windowHandle(), Qt::LeftButton, {}, QPoint(20, 20));
        EXPECT_EQ(CWnd::GetActiveWindow(), &dialog);
    };
    dialog.DoModal();
    EXPECT_TRUE(owner.IsWindowEnabled());
    EXPECT_TRUE(waitForActive(owner));
}

TEST(ModalDialogs, LetExceptionsOutWithTheWindowGone) {
    Owner owner;
    for (int round = 0; round < 2; ++round) {
        ShapeDialog dialog(&owner);
        dialog.script = [] { throw std::runtime_error("in a handler"); };
        EXPECT_THROW(dialog.DoModal(), std::runtime_error);
        EXPECT_EQ(dialog.m_hWnd, nullptr);
        EXPECT_TRUE(owner.IsWindowEnabled());
    }
    ShapeDialog dialog(&owner);
    dialog.script = [] { key(Qt::Key_Return); };
    EXPECT_EQ(dialog.DoModal(), IDOK);
}

TEST(ModalDialogs, StackOverOneAnother) {
    ShapeDialog outer;
    outer.script = [&] {
        ShapeDialog inner(&outer);
        inner.script = [] { key(Qt::Key_Escape); };
        EXPECT_EQ(inner.DoModal(), IDCANCEL);
        EXPECT_TRUE(outer.IsWindowVisible());
        EXPECT_TRUE(waitForActive(outer));
        key(Qt::Key_Return);
    };
    EXPECT_EQ(outer.DoModal(), IDOK);
}

TEST(ModalDialogs, LieOnTheScreen) {
    Owner owner;
    owner.MoveWindow(5000, 5000, 400, 300);
    ShapeDialog dialog(&owner);
    dialog.script = [&] {
        CRect rect;
        dialog.GetWindowRect(&rect);
        const QRect screen = QGuiApplication::primaryScreen()->availableGeometry();
        EXPECT_TRUE(screen.contains(QRect(rect.left, rect.top, rect.Width(), rect.Height())));
    };
    dialog.DoModal();
}

TEST(Dialogs, StandOverTheMiddleOfTheirOwner) {
    Owner owner;
    CDialog dialog;
    ASSERT_TRUE(dialog.Create(IDD_SHAPE, &owner));
    CRect outer;
    CRect inner;
    owner.GetWindowRect(&outer);
    dialog.GetWindowRect(&inner);
    EXPECT_NEAR(inner.CenterPoint().x, outer.CenterPoint().x, 2);
    EXPECT_NEAR(inner.CenterPoint().y, outer.CenterPoint().y, 2);
    dialog.DestroyWindow();
}

TEST(Dialogs, ModelessOnesLiveBesideTheirOwner) {
    Owner owner;
    CDialog dialog;
    ASSERT_TRUE(dialog.Create(IDD_SHAPE, &owner));
    EXPECT_FALSE(dialog.IsWindowVisible());
    dialog.ShowWindow(SW_SHOW);
    EXPECT_TRUE(owner.IsWindowEnabled());
    EXPECT_TRUE(waitForActive(dialog));
    key(Qt::Key_Escape);
    EXPECT_FALSE(dialog.IsWindowVisible());
    dialog.DestroyWindow();
}

/// Gives texts a colour, as validating dialogs do.
class ColouredDialog : public ScriptedDialog {
public:
    ColouredDialog() : ScriptedDialog(IDD_SHAPE) {}

protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message == WM_CTLCOLOREDIT && ::GetDlgCtrlID(reinterpret_cast<HWND>(lParam)) == IDC_NAME) {
            return reinterpret_cast<LRESULT>(static_cast<HBRUSH>(m_brush));
        }
        return ScriptedDialog::WindowProc(message, wParam, lParam);
    }

private:
    CBrush m_brush{RGB(255, 255, 0)};
};

TEST(Dialogs, ChooseTheColoursOfTheirControls) {
    ColouredDialog dialog;
    dialog.script = [&] {
        const auto colorOf = [&](int id) {
            QWidget* widget = tvx::afx::peerOf(dialog.GetDlgItem(id)->m_hWnd);
            widget->grab(); // asks while painting
            return widget->grab().toImage().pixelColor(widget->width() - 10, widget->height() / 2);
        };
        EXPECT_EQ(colorOf(IDC_NAME), QColor(255, 255, 0));
        EXPECT_EQ(colorOf(IDC_SCALE), QColor(255, 255, 255));
    };
    dialog.DoModal();
}

/// A dialog with controls of every kind, in two of which it colours the texts.
class PaintedDialog : public ScriptedDialog {
public:
    PaintedDialog() : ScriptedDialog(IDD_EMPTY) {
        prepare = [this] {
            SetWindowPos(nullptr, 0, 0, 600, 200, SWP_NOMOVE | SWP_NOZORDER);
            constexpr std::pair<const char*, DWORD> kinds[] = {
                {"EDIT", 0},    {"EDIT", ES_READONLY},          {"EDIT", ES_READONLY | ES_MULTILINE},
                {"STATIC", 0},  {"BUTTON", BS_AUTOCHECKBOX},    {"BUTTON", BS_PUSHBUTTON},
                {"LISTBOX", 0}, {"COMBOBOX", CBS_DROPDOWNLIST}, {"BUTTON", BS_GROUPBOX}};
            for (int i = 0; i < count; ++i) {
                const auto& [kind, style] = kinds[i / 2];
                const CRect place(CPoint(10 + i / 2 * 50, 10 + i % 2 * 40), CSize(45, 30));
                controls[i].CreateEx(0, kind, "x", WS_CHILD | WS_VISIBLE | style, place, this, 500 + i);
            }
        };
    }
    /// How light most of a control is, 0 to 255.
    int lightness(const CWnd& window) const {
        QWidget* whole = tvx::afx::peerOf(m_hWnd);
        QWidget* widget = tvx::afx::peerOf(window.m_hWnd);
        whole->grab(); // asks while painting
        const QImage image = whole->grab(QRect(widget->mapTo(whole, QPoint()), widget->size())).toImage();
        std::map<QRgb, int> colors;
        for (int y = 0; y < image.height(); ++y) {
            for (int x = 0; x < image.width(); ++x) {
                ++colors[image.pixel(x, y)];
            }
        }
        return qGray(std::ranges::max_element(colors, {}, [](const auto& color) { return color.second; })->first);
    }
    static constexpr int count = 18;
    CWnd controls[count];

protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message >= WM_CTLCOLOREDIT && message <= WM_CTLCOLORSTATIC && message != WM_CTLCOLORDLG &&
            message != WM_CTLCOLORLISTBOX && ::GetDlgCtrlID(reinterpret_cast<HWND>(lParam)) % 2 == 1) {
            CDC::FromHandle(reinterpret_cast<HDC>(wParam))->SetTextColor(RGB(200, 100, 100));
            return reinterpret_cast<LRESULT>(GetStockObject(NULL_BRUSH));
        }
        return ScriptedDialog::WindowProc(message, wParam, lParam);
    }
};

TEST(Dialogs, FollowTheDesktopsColours) {
    PaintedDialog dialog;
    const QPalette before = QApplication::palette();
    dialog.script = [&] {
        for (const bool dark : {false, true, false}) {
            QApplication::setPalette(dark ? QPalette(QColor(50, 50, 50)) : before);
            const auto follows = [&](const CWnd& window) { return (dialog.lightness(window) < 128) == dark; };
            EXPECT_TRUE(QTest::qWaitFor([&] { return follows(dialog); }));
            for (const CWnd& control : dialog.controls) {
                EXPECT_TRUE(QTest::qWaitFor([&] { return follows(control); })) << control.GetDlgCtrlID();
            }
            EXPECT_EQ(GetRValue(GetSysColor(COLOR_WINDOW)) < 128, dark);
        }
    };
    EXPECT_EQ(dialog.DoModal(), ScriptedDialog::scriptDone);
}

} // namespace

// --- assistive tools ---

TEST(AccessibleDialog, TellsRolesNamesAndLabelsInTabOrder) {
    ScriptedDialog dialog(IDD_SHAPE);
    dialog.script = [&] {
        const auto partOf = [&](int id) {
            return QAccessible::queryAccessibleInterface(tvx::afx::peerOf(dialog.GetDlgItem(id)->m_hWnd));
        };
        QAccessibleInterface* whole = QAccessible::queryAccessibleInterface(tvx::afx::peerOf(dialog.m_hWnd));
        EXPECT_EQ(accessibleTree(*whole), R"(Dialog "Shape"
 StaticText "Name:"
 EditableText "Name:" < Name:
 StaticText "Scale:"
 EditableText "Scale:" < Scale:
 Grouping "Kind"
 RadioButton "Line"
 RadioButton "Circle"
 RadioButton "Arc"
 CheckBox "Visible"
 List ""
 ComboBox ""
 ComboBox ""
  EditableText ""
 Border ""
 Button "OK"
 Button "Cancel"
 Button "Apply"
 Button "Save"
)");
        QAccessibleInterface* circle = partOf(IDC_CIRCLE);
        EXPECT_EQ(whole->indexOfChild(circle), 6);
        EXPECT_FALSE(circle->state().checked);
        circle->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
        EXPECT_TRUE(circle->state().checked);
        EXPECT_EQ(dialog.codes(IDC_CIRCLE, BN_CLICKED), 1);
    };
    EXPECT_EQ(dialog.DoModal(), ScriptedDialog::scriptDone);
}
