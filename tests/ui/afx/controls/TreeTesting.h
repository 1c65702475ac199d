#pragma once

/// @file
/// A dialog with a tree, which notes what the tree tells it.

#include "platform/afx/core/MessageMap.h"
#include "platform/sec/TreeCtrl.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

class TreeDialog : public ScriptedDialog {
public:
    static constexpr int treeId = 500;
    static constexpr DWORD plain = TVS_HASBUTTONS | TVS_HASLINES | TVS_LINESATROOT | TVS_SHOWSELALWAYS;

    explicit TreeDialog(DWORD style = plain) : ScriptedDialog(IDD_EMPTY) {
        prepare = [this, style] {
            tree.Create(WS_CHILD | WS_VISIBLE | WS_TABSTOP | WS_BORDER | style, CRect(10, 10, 210, 170), this, treeId);
            other.Create("Other", WS_CHILD | WS_VISIBLE | WS_TABSTOP, CRect(10, 175, 100, 195), this, treeId + 1);
            tree.SetFocus();
        };
    }
    /// Runs `use` with the tree made and focused.
    void with(const std::function<void()>& use, INT_PTR result = scriptDone) {
        script = use;
        EXPECT_EQ(DoModal(), result);
    }
    /// Called for each notification, after it was noted; its answer is the tree's.
    std::function<LRESULT(NMHDR&)> answer;
    /// "selchanged a>b 2": what was told since the last call, items by their labels, with the action.
    std::vector<std::string> told() {
        return std::exchange(m_told, {});
    }
    using Lines = std::vector<std::string>;

    /// A ( a1 ( a11 ) a2 ) B ( b1 ) C
    void fill() {
        a = tree.InsertItem("A");
        a1 = tree.InsertItem("a1", a);
        tree.InsertItem("a11", a1);
        tree.InsertItem("a2", a);
        b = tree.InsertItem("B");
        tree.InsertItem("b1", b);
        c = tree.InsertItem("C");
    }
    std::string name(HTREEITEM item) const {
        return tree.GetItemText(item).GetString();
    }
    /// The labels of all lines, the selected ones in brackets.
    std::string lines() const {
        std::string all;
        HTREEITEM item = tree.GetRootItem();
        for (; item; item = tree.GetNextVisibleItem(item)) {
            const bool selected = tree.GetItemState(item, TVIS_SELECTED) != 0;
            all += (all.empty() ? "" : " ") + (selected ? "[" + name(item) + "]" : name(item));
        }
        return all;
    }
    QPoint middle(HTREEITEM item) const {
        CRect rect;
        EXPECT_TRUE(tree.GetItemRect(item, &rect, TRUE));
        return {static_cast<int>(rect.CenterPoint().x), static_cast<int>(rect.CenterPoint().y)};
    }
    QPoint button(HTREEITEM item) const {
        CRect rect;
        EXPECT_TRUE(tree.GetItemRect(item, &rect, TRUE));
        return {static_cast<int>(rect.left) - 10, static_cast<int>(rect.CenterPoint().y)};
    }
    QWidget* area() const {
        return tvx::afx::peerOf(tree.m_hWnd);
    }

    SECTreeCtrl tree;
    CButton other; ///< Takes the keyboard, too.
    HTREEITEM a = nullptr;
    HTREEITEM a1 = nullptr;
    HTREEITEM b = nullptr;
    HTREEITEM c = nullptr;

protected:
    BOOL OnNotify(WPARAM wParam, LPARAM lParam, LRESULT* result) override {
        auto& header = *reinterpret_cast<NMHDR*>(lParam);
        if (header.idFrom == treeId && header.hwndFrom == tree.m_hWnd) {
            note(header);
            *result = answer ? answer(header) : 0;
            return TRUE;
        }
        return ScriptedDialog::OnNotify(wParam, lParam, result);
    }

private:
    void note(const NMHDR& header) {
        switch (header.code) {
        case NM_CLICK:
            m_told.emplace_back("click");
            return;
        case NM_DBLCLK:
            m_told.emplace_back("dblclk");
            return;
        case NM_RCLICK:
            m_told.emplace_back("rclick");
            return;
        case TVN_SELCHANGING:
        case TVN_SELCHANGED:
        case TVN_ITEMEXPANDING:
        case TVN_ITEMEXPANDED:
        case TVN_DELETEITEM:
            noteItem(reinterpret_cast<const NMTREEVIEW&>(header));
            return;
        default:
            return;
        }
    }
    void noteItem(const NMTREEVIEW& change) {
        const std::string item = name(change.itemNew.hItem);
        const std::string action = " " + std::to_string(change.action);
        switch (change.hdr.code) {
        case TVN_SELCHANGING:
            m_told.push_back("selchanging " + name(change.itemOld.hItem) + ">" + item + action);
            break;
        case TVN_SELCHANGED:
            m_told.push_back("selchanged " + name(change.itemOld.hItem) + ">" + item + action);
            break;
        case TVN_ITEMEXPANDING:
            m_told.push_back("expanding " + item + action);
            break;
        case TVN_ITEMEXPANDED:
            m_told.push_back("expanded " + item + action);
            break;
        case TVN_DELETEITEM:
            m_told.push_back("delete " + std::to_string(change.itemOld.lParam));
            break;
        default:
            break;
        }
    }
    std::vector<std::string> m_told;
};
