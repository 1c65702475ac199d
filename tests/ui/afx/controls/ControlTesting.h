#pragma once

/// @file
/// A dialog that one control is put into and tried out in.

#include "tests/ui/afx/dialogs/DialogTesting.h"

constexpr int controlId = 500;
constexpr DWORD shown = WS_CHILD | WS_VISIBLE | WS_TABSTOP;

template <class Control>
class ControlTest : public testing::Test {
protected:
    /// Runs `use` with the control made and focused.
    void with(DWORD style, const std::function<void()>& use) {
        dialog.prepare = [&, style] { make(style); };
        dialog.script = [&] {
            control.SetFocus();
            dialog.commands.clear();
            use();
        };
        EXPECT_EQ(dialog.DoModal(), ScriptedDialog::scriptDone);
    }
    virtual void make(DWORD style) = 0;
    int told(int code) const {
        return dialog.codes(controlId, code);
    }

    ScriptedDialog dialog{IDD_EMPTY};
    Control control;
    const CRect place{10, 10, 210, 110};
};

/// The same for a list box.
template <class List>
class ListTest : public ControlTest<List> {
protected:
    /// A point in the middle of a line.
    QPoint middle(int index) const {
        CRect rect;
        this->control.GetItemRect(index, &rect);
        return {20, rect.CenterPoint().y};
    }
    /// The selected lines of a list with several.
    std::vector<int> selected() const {
        std::vector<int> indices(static_cast<std::size_t>(this->control.GetCount()));
        indices.resize(static_cast<std::size_t>(this->control.GetSelItems(this->control.GetCount(), indices.data())));
        return indices;
    }
};
