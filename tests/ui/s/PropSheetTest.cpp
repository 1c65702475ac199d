// Property sheets as a user meets them, by keys and mouse, and what their pages are told.
#include "s/PropSheet.h"

#include "afxdlgs.h"
#include "platform/sec/TreeCtrl.h"
#include "res/resource.h"
#include "tests/ui/afx/AccessibleTree.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"
#include "tests/ui/afx/frames/SettingsFolder.h"

#include <gtest/gtest.h>

#include <QWheelEvent>

#include <cmath>
#include <functional>
#include <string>
#include <vector>

namespace {

using Log = std::vector<std::string>;
using Items = std::vector<Gui_PropItem*>;

Log events;                            // what was made and told, in order
bool answersFocus = true;              // whether pages follow the focus notifications
std::function<void()> onApply = [] {}; // what a page does when it is to apply

constexpr const char* names[] = {"activate", "reactivate", "deactivate", "apply", "help", "first", "last"};

CWnd* makePage(Gui_PropItem* item, Gui_PropSheet* sheet) {
    const std::string name = item->GetName().c_str();
    events.push_back("make " + name);
    auto page = std::make_unique<CDialog>();
    EXPECT_TRUE(page->Create(name == "Tall" ? 102 : 101, sheet));
    page->SendDlgItemMessage(202, CB_ADDSTRING, 0, reinterpret_cast<LPARAM>("one"));
    page->SendDlgItemMessage(202, CB_ADDSTRING, 0, reinterpret_cast<LPARAM>("two"));
    page->SendDlgItemMessage(202, CB_SETCURSEL, 0);
    return page.release();
}

void notifyPage(Gui_PropItem* item, CWnd* page, Gui_PropItem::Notification what) {
    const bool shown = page && page->IsWindowVisible();
    events.push_back(std::string(names[what]) + " " + item->GetName().c_str() + (shown ? " shown" : ""));
    if (what == Gui_PropItem::NotifyApply) {
        onApply();
    } else if (answersFocus && what == Gui_PropItem::NotifyFocusFirst) {
        page->GetDlgItem(201)->SetFocus();
    } else if (answersFocus && what == Gui_PropItem::NotifyFocusLast) {
        page->GetDlgItem(203)->SetFocus();
    }
}

Gui_PropItem* pageItem(const char* name, Gui_PropItem::InitialState state = Gui_PropItem::StateDefault) {
    auto* item = new Gui_PropItem(name, makePage, notifyPage, state);
    item->SetPageTitle((std::string(name) + " & more").c_str());
    item->SetPageSubTitle("what it is for");
    return item;
}

/// A sheet that a test works in once it is shown.
class Sheet : public Gui_PropSheet {
public:
    explicit Sheet(const char* title = "Preferences", bool multiple = false)
        : Gui_PropSheet(title, nullptr, multiple) {}
    std::function<void()> script;

    int work(const std::function<void()>& action) {
        script = action;
        events.clear();
        return DoModal();
    }
    SECTreeCtrl& tree() const {
        return static_cast<SECTreeCtrl&>(*GetDlgItem(GUI_IDC_PROP_TREE));
    }
    HTREEITEM node(const char* label) const {
        HTREEITEM node = tree().GetRootItem();
        while (node && tree().GetItemText(node) != label) {
            node = tree().GetNextItem(node);
        }
        return node;
    }
    void clickNode(const char* label, Qt::KeyboardModifiers modifiers = Qt::NoModifier) const {
        CRect rect;
        ASSERT_TRUE(tree().GetItemRect(node(label), &rect, TRUE)) << label;
        click(&tree(), QPoint(rect.left + 4, rect.top + rect.Height() / 2), modifiers);
    }
    /// The labels of all nodes, with their depth in blanks.
    Log labels() const {
        Log result;
        for (HTREEITEM at = tree().GetRootItem(); at; at = tree().GetNextItem(at)) {
            std::string label = tree().GetItemText(at).GetString();
            for (HTREEITEM up = tree().GetParentItem(at); up; up = tree().GetParentItem(up)) {
                label.insert(0, " ");
            }
            result.push_back(label);
        }
        return result;
    }
    int focus() const {
        return GetFocus() ? GetFocus()->GetDlgCtrlID() : 0;
    }
    CRect rectOf(const CWnd* control) const {
        CRect rect;
        control->GetWindowRect(&rect);
        ScreenToClient(&rect);
        return rect;
    }
    CRect rectOf(int id) const {
        return rectOf(GetDlgItem(id));
    }
    std::string caption() const {
        return textOf(this);
    }
    std::string bandText() const {
        return textOf(GetDlgItem(GUI_IDC_PROP_TITLE));
    }

protected:
    BOOL OnInitDialog() override {
        const BOOL result = Gui_PropSheet::OnInitDialog();
        PostMessage(WM_APP);
        return result;
    }
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message != WM_APP) {
            return Gui_PropSheet::WindowProc(message, wParam, lParam);
        }
        EXPECT_TRUE(waitForActive(*this));
        script();
        if (m_hWnd && IsWindowVisible()) {
            EndDialog(99);
        }
        return 0;
    }
};

/// A sheet with the items Drawing (Grid, Colors, Empty) and Files.
class PropSheet : public testing::Test {
protected:
    PropSheet() {
        answersFocus = true;
        onApply = [] {};
        sheet.AddItem(drawing, false);
        sheet.AddItem(grid, drawing, false);
        sheet.AddItem(colors, drawing, false);
        sheet.AddItem(empty, drawing, false);
        sheet.AddItem(files, false);
    }
    Sheet sheet;
    Gui_PropItem* drawing = pageItem("Drawing", Gui_PropItem::StateExpanded);
    Gui_PropItem* grid = pageItem("Grid");
    Gui_PropItem* colors = pageItem("Colors");
    Gui_PropItem* empty = new Gui_PropItem("Empty", nullptr, nullptr, Gui_PropItem::StateDefault);
    Gui_PropItem* files = new Gui_PropItem("Files", nullptr, nullptr, Gui_PropItem::StateDefault);
};

/// A control of a host's, whose value the wheel changes.
class Slider : public CWnd {
public:
    int turns = 0;

protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        turns += message == WM_MOUSEWHEEL ? 1 : 0;
        return message == WM_MOUSEWHEEL ? 0 : CWnd::WindowProc(message, wParam, lParam);
    }
};

void turnWheel(const CWnd* over) {
    QWidget* widget = tvx::afx::peerOf(over->m_hWnd);
    const QPointF point = widget->rect().center();
    QWheelEvent event(point, widget->mapToGlobal(point), {}, {0, -120}, Qt::NoButton, Qt::NoModifier, Qt::NoScrollPhase,
                      false);
    QSpontaneKeyEvent::setSpontaneous(&event);
    qApp->notify(widget, &event); // sendEvent would take the mark away
}

} // namespace

TEST_F(PropSheet, MakesPagesWhenTheyAreNeededAndTellsThemInOrder) {
    EXPECT_EQ(sheet.work([&] {
        EXPECT_EQ(events, (Log{"make Drawing", "activate Drawing"}));
        EXPECT_EQ(sheet.labels(), (Log{"Drawing", " Grid", " Colors", " Empty", "Files"}));
        EXPECT_EQ(sheet.GetSelectedItems(), Items{drawing});
        EXPECT_EQ(sheet.caption(), "Preferences");
        EXPECT_EQ(sheet.rectOf(drawing->GetCachedPage()), sheet.rectOf(GUI_IDC_PROP_PAGE_FRAME));
        EXPECT_FALSE(sheet.GetDlgItem(GUI_IDC_PROP_PAGE_FRAME)->IsWindowVisible());
        events.clear();
        sheet.clickNode("Grid");
        EXPECT_EQ(events, (Log{"make Grid", "deactivate Drawing shown", "activate Grid"}));
        EXPECT_FALSE(drawing->GetCachedPage()->IsWindowVisible());
        EXPECT_TRUE(grid->GetCachedPage()->IsWindowVisible());
        EXPECT_EQ(sheet.bandText(), "Grid & more. what it is for");
        events.clear();
        sheet.clickNode("Drawing");
        sheet.clickNode("Empty"); // shows the page of the item above it
        EXPECT_EQ(events, (Log{"deactivate Grid shown", "activate Drawing", "deactivate Drawing shown",
                               "activate Drawing shown"}));
        EXPECT_EQ(sheet.GetPageItem({empty}), drawing);
        events.clear();
        sheet.clickNode("Files"); // has none, nor anybody above it
        EXPECT_EQ(events, (Log{"deactivate Drawing shown"}));
        EXPECT_EQ(sheet.GetCurrentPage(), nullptr);
        EXPECT_EQ(sheet.bandText(), "");
        click(sheet.GetDlgItem(GUI_IDC_PROP_APPLY));
        click(sheet.GetDlgItem(GUI_IDC_HELP));
        EXPECT_EQ(colors->GetCachedPage(), nullptr);
        EXPECT_EQ(events.size(), 1u);
        click(sheet.GetDlgItem(IDOK));
    }),
              IDOK);
    EXPECT_EQ(sheet.GetChildItems(drawing), (Items{grid, colors, empty}));
    EXPECT_EQ(sheet.GetChildItems(nullptr), (Items{drawing, files}));
}

TEST_F(PropSheet, AppliesAndClosesAsThePageWants) {
    bool wanted = false;
    onApply = [&] { wanted = sheet.WantsToClose(); };
    EXPECT_EQ(sheet.work([&] {
        events.clear();
        click(sheet.GetDlgItem(GUI_IDC_PROP_APPLY));
        EXPECT_FALSE(wanted);
        onApply = [&] {
            wanted = sheet.WantsToClose();
            sheet.DontClose();
        };
        click(sheet.GetDlgItem(IDOK));
        EXPECT_TRUE(wanted);
        EXPECT_TRUE(sheet.IsWindowVisible());
        click(sheet.GetDlgItem(GUI_IDC_HELP));
        key(Qt::Key_F1);
        drawing->GetCachedPage()->GetDlgItem(201)->SetFocus();
        key(Qt::Key_F1);
        EXPECT_EQ(events, (Log{"apply Drawing shown", "apply Drawing shown", "help Drawing shown", "help Drawing shown",
                               "help Drawing shown"}));
        grid->SetName("Raster");
        sheet.RefreshItemTree(true);
        EXPECT_NE(sheet.node("Raster"), nullptr);
        EXPECT_EQ(events.back(), "reactivate Drawing shown");
        sheet.ChangeCancelToClose();
        EXPECT_EQ(textOf(sheet.GetDlgItem(IDCANCEL)), "Close");
        onApply = [] {};
        key(Qt::Key_Enter); // in the page
    }),
              IDOK);
    const std::size_t before = events.size();
    EXPECT_EQ(sheet.work([&] {
        events.clear();
        key(Qt::Key_Escape);
        EXPECT_TRUE(events.empty());
    }),
              IDCANCEL);
    EXPECT_GT(before, 0u);
}

TEST_F(PropSheet, LeadsTheKeyboardThroughTreePageAndButtons) {
    for (const bool answers : {true, false}) {
        answersFocus = answers;
        sheet.work([&] {
            std::vector<int> forward;
            std::vector<int> backward;
            EXPECT_EQ(sheet.focus(), GUI_IDC_PROP_TREE);
            for (int i = 0; i < 8; ++i) {
                key(Qt::Key_Tab);
                forward.push_back(sheet.focus());
            }
            EXPECT_EQ(forward, (std::vector<int>{201, 202, 203, IDOK, IDCANCEL, GUI_IDC_PROP_APPLY, GUI_IDC_HELP,
                                                 GUI_IDC_PROP_TREE}));
            for (int i = 0; i < 8; ++i) {
                key(Qt::Key_Tab, Qt::ShiftModifier);
                backward.push_back(sheet.focus());
            }
            std::reverse(forward.begin(), forward.end() - 1);
            EXPECT_EQ(backward, forward);
            key(Qt::Key_Down);
            EXPECT_EQ(sheet.GetSelectedItems(), Items{grid});
            key(Qt::Key_W, Qt::AltModifier);
            EXPECT_EQ(GetFocus(), grid->GetCachedPage()->GetDlgItem(201)->m_hWnd);
            key(Qt::Key_C, Qt::AltModifier);
            EXPECT_EQ(sheet.focus(), GUI_IDC_PROP_TREE);
        });
        EXPECT_NE(std::ranges::find(events, "first Drawing shown"), events.end());
        EXPECT_NE(std::ranges::find(events, "last Drawing shown"), events.end());
    }
}

TEST(PropSheetSelection, OpensWithWhatWasAskedFor) {
    for (const bool multiple : {false, true}) {
        Sheet sheet("", multiple);
        Gui_PropItem* const category = pageItem("Category", Gui_PropItem::StateCollapsed);
        Gui_PropItem* const inner = pageItem("Inner");
        Gui_PropItem* const last = pageItem("Last");
        sheet.ChangeCancelToClose(); // too early
        sheet.AddItem(inner, category, true);
        sheet.AddItem(last, true);
        sheet.AddItem(category, false);
        sheet.work([&] {
            EXPECT_EQ(sheet.caption(), "Properties");
            EXPECT_EQ(textOf(sheet.GetDlgItem(IDCANCEL)), "Cancel");
            EXPECT_EQ(sheet.labels(), (Log{"Category", " Inner", "Last"})) << "parents come first";
            EXPECT_EQ(sheet.GetSelectedItems(), multiple ? (Items{inner, last}) : Items{inner});
            EXPECT_EQ(events, (Log{"make Inner", "activate Inner"}));
            sheet.clickNode("Last", Qt::ControlModifier);
            EXPECT_EQ(sheet.GetSelectedItems(), multiple ? Items{inner} : Items{last});
            EXPECT_EQ(events.back(), multiple ? "activate Inner shown" : "activate Last");
            sheet.SetWindowTitle("Now");
            EXPECT_EQ(sheet.caption(), "Now");
        });
    }
    Sheet none;
    EXPECT_EQ(none.work([&] {
        EXPECT_EQ(none.tree().GetCount(), 0u);
        key(Qt::Key_Tab);
        EXPECT_EQ(none.focus(), IDOK);
        key(Qt::Key_Enter);
    }),
              IDOK);
}

TEST_F(PropSheet, LaysItselfOutInItsSize) {
    sheet.work([&] {
        EXPECT_LT(sheet.rectOf(IDOK).left, sheet.rectOf(GUI_IDC_PROP_APPLY).left) << "as the template has it";
        CRect client;
        sheet.GetClientRect(&client);
        const int high = sheet.rectOf(GUI_IDC_PROP_TITLE).Height();
        const int wide = sheet.rectOf(GUI_IDC_PROP_TREE).Width();
        CRect unit(5, 5, 0, 0);
        sheet.MapDialogRect(&unit);
        sheet.SetWindowPos(nullptr, 0, 0, client.Width() + 150, client.Height() + 90, SWP_NOMOVE | SWP_NOZORDER);
        sheet.GetClientRect(&client);
        int right = client.right;
        for (const int id : {GUI_IDC_HELP, IDCANCEL, IDOK, GUI_IDC_PROP_APPLY}) {
            EXPECT_EQ(sheet.rectOf(id).right, right - unit.left);
            EXPECT_EQ(sheet.rectOf(id).bottom, client.bottom - unit.top);
            right = sheet.rectOf(id).left;
        }
        const int bottom = client.bottom - 2 * unit.top - sheet.rectOf(IDOK).Height();
        EXPECT_EQ(sheet.rectOf(GUI_IDC_PROP_TREE).bottom, bottom);
        EXPECT_EQ(sheet.rectOf(GUI_IDC_PROP_TREE).Width(), wide);
        EXPECT_EQ(sheet.rectOf(GUI_IDC_PROP_TITLE).Height(), high);
        EXPECT_EQ(sheet.rectOf(GUI_IDC_PROP_TITLE).right, client.right - unit.left);
        EXPECT_EQ(sheet.rectOf(drawing->GetCachedPage()), sheet.rectOf(GUI_IDC_PROP_PAGE_FRAME));
        EXPECT_EQ(sheet.rectOf(GUI_IDC_PROP_PAGE_FRAME).BottomRight(), CPoint(client.right - unit.left, bottom));
        sheet.SetWindowPos(nullptr, 0, 0, 10, 10, SWP_NOMOVE | SWP_NOZORDER);
        EXPECT_TRUE(QTest::qWaitFor([&] { return sheet.rectOf(GUI_IDC_PROP_APPLY).left >= 0; })) << "the least size";
    });
}

TEST_F(PropSheet, FindsItemsAndLeavesTheirPagesAlone) {
    colors->SetKeywords("Palette background");
    sheet.SetSearch(true);
    EXPECT_EQ(sheet.work([&] {
        EXPECT_EQ(sheet.focus(), GUI_IDC_PROP_SEARCH);
        sheet.clickNode("Grid");
        events.clear();
        key(Qt::Key_F, Qt::ControlModifier);
        type("PALETTE back");
        EXPECT_EQ(sheet.labels(), (Log{"Drawing", " Colors"}));
        EXPECT_TRUE(events.empty());
        EXPECT_TRUE(grid->GetCachedPage()->IsWindowVisible()) << "it stays while its node is hidden";
        key(Qt::Key_Enter);
        EXPECT_EQ(sheet.GetSelectedItems(), Items{colors});
        EXPECT_EQ(events, (Log{"make Colors", "deactivate Grid shown", "activate Colors"}));
        key(Qt::Key_Escape);
        EXPECT_EQ(sheet.labels().size(), 5u);
        EXPECT_EQ(sheet.GetSelectedItems(), Items{colors});
        EXPECT_TRUE(sheet.tree().GetItemState(sheet.node("Drawing"), TVIS_EXPANDED) & TVIS_EXPANDED);
        type("drawing");
        EXPECT_EQ(sheet.labels().size(), 4u) << "with all that is below it";
        type("x");
        EXPECT_EQ(sheet.labels().size(), 0u);
        key(Qt::Key_Escape);
        type("grid");
        key(Qt::Key_Down);
        EXPECT_EQ(sheet.focus(), GUI_IDC_PROP_TREE);
        EXPECT_EQ(sheet.GetSelectedItems(), Items{grid});
        key(Qt::Key_Escape);
    }),
              IDCANCEL);
}

TEST_F(PropSheet, MarksChangesAndAsksBeforeTheyAreLost) {
    sheet.SetChangeMarks(true);
    grid->SetDefaultsFunction([](Gui_PropItem* item, CWnd* page) {
        page->SetDlgItemText(201, "default");
        item->SetChanged(true);
    });
    EXPECT_EQ(sheet.work([&] {
        EXPECT_EQ(sheet.GetDlgItem(GUI_IDC_PROP_DEFAULTS), nullptr);
        sheet.clickNode("Grid");
        click(sheet.GetDlgItem(GUI_IDC_PROP_DEFAULTS));
        EXPECT_EQ(textOf(grid->GetCachedPage()->GetDlgItem(201)), "default");
        EXPECT_NE(sheet.node("Grid *"), nullptr);
        {
            BoxAnswer no; // Enter presses the default button
            key(Qt::Key_Escape);
            EXPECT_NE(no.text.find("discard"), std::string::npos);
        }
        EXPECT_TRUE(waitForActive(sheet));
        onApply = [&] { sheet.DontClose(); };
        click(sheet.GetDlgItem(GUI_IDC_PROP_APPLY));
        EXPECT_TRUE(grid->IsChanged());
        onApply = [] {};
        click(sheet.GetDlgItem(GUI_IDC_PROP_APPLY));
        EXPECT_NE(sheet.node("Grid"), nullptr);
        sheet.clickNode("Drawing");
        EXPECT_FALSE(sheet.GetDlgItem(GUI_IDC_PROP_DEFAULTS)->IsWindowVisible());
        key(Qt::Key_Escape);
    }),
              IDCANCEL);
}

TEST_F(PropSheet, MakesPagesAnewWhenItIsOpenedAgainAndKeepsTheOldObjects) {
    CWnd* first = nullptr;
    sheet.work([&] { first = drawing->GetCachedPage(); });
    EXPECT_EQ(drawing->GetCachedPage(), first);
    EXPECT_EQ(first->m_hWnd, nullptr);
    sheet.work([&] {
        EXPECT_EQ(events, (Log{"make Drawing", "activate Drawing"}));
        EXPECT_NE(drawing->GetCachedPage(), first);
        EXPECT_TRUE(drawing->GetCachedPage()->IsWindowVisible());
    });
    EXPECT_EQ(first->m_hWnd, nullptr) << "still there to be asked";
}

TEST_F(PropSheet, RemembersNodeAndSize) {
    const SettingsFolder settings;
    testApplication.SetRegistryKey("Maker");
    sheet.SetMemory("Sheet");
    CSize size;
    sheet.work([&] {
        sheet.clickNode("Colors");
        sheet.SetWindowPos(nullptr, 0, 0, 700, 500, SWP_NOMOVE | SWP_NOZORDER);
        size = sheet.rectOf(&sheet).Size();
    });
    sheet.work([&] {
        EXPECT_EQ(sheet.GetSelectedItems(), Items{colors});
        EXPECT_EQ(sheet.rectOf(&sheet).Size(), size);
    });
}

TEST(PropSheetPage, ScrollsWhereItIsLargerThanItsPlace) {
    Sheet sheet;
    Gui_PropItem* const tall = pageItem("Tall");
    sheet.AddItem(tall, false);
    sheet.SetPageScrolling(true);
    sheet.SetWheelGuard(true);
    sheet.work([&] {
        const CWnd* const page = tall->GetCachedPage();
        const auto placeOf = [&](int id) {
            CRect rect = sheet.rectOf(page->GetDlgItem(id));
            rect.OffsetRect(-sheet.rectOf(page).TopLeft());
            return rect;
        };
        const CRect start = placeOf(201);
        const int focus = sheet.focus();
        click(sheet.GetDlgItem(GUI_IDC_PROP_SCROLL_DOWN),
              QPoint(5, sheet.rectOf(GUI_IDC_PROP_SCROLL_DOWN).Height() - 5));
        EXPECT_LT(placeOf(201).top, start.top);
        EXPECT_EQ(sheet.focus(), focus) << "a bar takes no keyboard";
        EXPECT_TRUE(sheet.GetDlgItem(GUI_IDC_PROP_SCROLL_DOWN)->IsWindowVisible());
        EXPECT_EQ(sheet.rectOf(GUI_IDC_PROP_SCROLL_DOWN).right, sheet.rectOf(GUI_IDC_PROP_PAGE_FRAME).right);
        key(Qt::Key_Tab);
        key(Qt::Key_Tab, Qt::ShiftModifier);
        key(Qt::Key_Tab, Qt::ShiftModifier);
        sheet.GetDlgItem(IDOK)->SetFocus();
        key(Qt::Key_Tab, Qt::ShiftModifier); // to the last control of the page
        EXPECT_EQ(sheet.focus(), 203);
        EXPECT_LE(placeOf(203).bottom, sheet.rectOf(page).Height());
        EXPECT_LE(placeOf(203).right, sheet.rectOf(page).Width());
        EXPECT_LT(placeOf(201).bottom, 0);
        key(Qt::Key_Tab, Qt::ShiftModifier);
        key(Qt::Key_Tab, Qt::ShiftModifier);
        EXPECT_GE(placeOf(201).top, 0);
        const int before = placeOf(202).top;
        turnWheel(page->GetDlgItem(202));
        EXPECT_EQ(page->GetDlgItem(202)->SendMessage(CB_GETCURSEL), 0);
        EXPECT_LT(placeOf(202).top, before);
        key(Qt::Key_Tab);
        key(Qt::Key_Tab, Qt::ShiftModifier);
        EXPECT_GE(placeOf(201).top, 0);
        turnWheel(page->GetDlgItem(201)); // it has the keyboard, but nothing to scroll
        EXPECT_LT(placeOf(201).top, 0);
        Slider slider;
        slider.Create("Button", "", WS_CHILD | WS_VISIBLE | WS_TABSTOP, CRect(90, 90, 130, 120), tall->GetCachedPage(),
                      7);
        turnWheel(&slider);
        EXPECT_EQ(slider.turns, 0);
        slider.SetFocus();
        turnWheel(&slider);
        EXPECT_EQ(slider.turns, 1);
        page->GetDlgItem(202)->SetFocus();
        turnWheel(page->GetDlgItem(202));
        EXPECT_EQ(page->GetDlgItem(202)->SendMessage(CB_GETCURSEL), 1) << "it has the keyboard";
        sheet.SetWindowPos(nullptr, 0, 0, 780, 780, SWP_NOMOVE | SWP_NOZORDER);
        EXPECT_EQ(placeOf(201).left, start.left);
    });
}

TEST_F(PropSheet, IsReadAloudWithThePageUnderItsTitle) {
    sheet.work([&] {
        sheet.clickNode("Grid");
        sheet.clickNode("Drawing");
        const QAccessibleInterface* const page =
            QAccessible::queryAccessibleInterface(drawing->GetCachedPage()->GetState()->widget());
        EXPECT_EQ(accessibleTree(*page).substr(0, 80),
                  "PropertyPage \"Drawing & more. what it is for\" < Drawing & more. what it is for\n ");
    });
}

TEST_F(PropSheet, HasABandInTheColourOfShadowsOrAReadableOne) {
    const auto fill = [&] {
        COLORREF color = 0;
        sheet.work([&] {
            CClientDC dc(sheet.GetDlgItem(GUI_IDC_PROP_TITLE));
            color = dc.GetPixel(1, 1);
        });
        return color;
    };
    EXPECT_EQ(fill(), GetSysColor(COLOR_BTNSHADOW));
    sheet.SetReadableBand(true);
    const double value = GetGValue(fill()) / 255.0; // of a grey
    EXPECT_GE(1.05 / (std::pow((value + 0.055) / 1.055, 2.4) + 0.05), 4.5);
}

TEST(PropSheetPage, MayBeAPropertyPageInAPageOfItsOwn) {
    static CPropertyPage inner(101);
    Sheet sheet;
    sheet.AddItem(new Gui_PropItem(
                      "Wrapped",
                      [](Gui_PropItem*, Gui_PropSheet* owner) -> CWnd* {
                          auto around = std::make_unique<CWnd>();
                          around->Create(nullptr, "", WS_CHILD, CRect(0, 0, 300, 200), owner, 0);
                          EXPECT_TRUE(inner.Create(101, around.get()));
                          inner.ShowWindow(SW_SHOW);
                          return around.release();
                      },
                      [](Gui_PropItem*, CWnd*, Gui_PropItem::Notification what) {
                          if (what == Gui_PropItem::NotifyApply) {
                              EXPECT_TRUE(inner.OnApply());
                          }
                      },
                      Gui_PropItem::StateDefault),
                  false);
    EXPECT_EQ(sheet.work([&] {
        key(Qt::Key_Tab);
        EXPECT_EQ(sheet.focus(), 201);
        key(Qt::Key_Tab, Qt::ShiftModifier);
        EXPECT_EQ(sheet.focus(), GUI_IDC_PROP_TREE);
        inner.GetDlgItem(203)->SetFocus();
        inner.SetModified();
        key(Qt::Key_Tab);
        EXPECT_EQ(sheet.focus(), IDOK);
        key(Qt::Key_Enter);
    }),
              IDOK);
}
