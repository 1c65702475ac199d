#pragma once

/// @file
/// What list boxes and combo boxes have in common.

#include "platform/afx/controls/detail/Control.h"
#include "platform/afx/controls/detail/ListItems.h"

namespace tvx::afx {

/// By what the two kinds differ where they do the same. What their messages answer are the same numbers (LB_ERR is
/// CB_ERR), so one function answers for either.
struct ListKind {
    UINT ownerType; ///< ODT_...: what owners are told that a line is of
    DWORD drawn;    ///< styles of which one has the owner draw the lines
    DWORD strings;  ///< style by which lines drawn by the owner have texts nevertheless
};

/// A control with lines, which are texts or, drawn by their owner, mere numbers or pointers.
class TVX_PLATFORM_API ListControl : public Control {
public:
    ListControl(const CREATESTRUCT& cs, const ListKind& kind) : Control(cs), m_kind(kind) {}

    bool isOwnerDrawn() const {
        return (style() & m_kind.drawn) != 0;
    }
    bool hasStrings() const {
        return !isOwnerDrawn() || (style() & m_kind.strings) != 0;
    }
    const ListItems& items() const {
        return m_items;
    }

protected:
    void applyColors(QPalette& palette, const QColor& text, const QColor& background) const override;

    /// The line that a message brings: a text, or what stands for one.
    ListItems::Item newItem(LPARAM text) const;
    /// Has the owner say how high its lines are, in pixels; it may leave it at `standard`.
    int askHeight(int standard);
    /// Hosts free what the data of an owner-drawn line points to when they are told of its end.
    void tellDeleted(int index);
    void tellAllDeleted();

    // --- answers to messages: LB_ERR for a line that does not exist ---
    LRESULT find(WPARAM after, LPARAM text, ListItems::Match match) const;
    LRESULT copyText(WPARAM index, LPARAM buffer) const;
    LRESULT textLength(WPARAM index) const;
    LRESULT itemData(WPARAM index) const;
    LRESULT setItemData(WPARAM index, LPARAM data);

    ListItems m_items;

private:
    ListKind m_kind;
};

} // namespace tvx::afx
