#include "platform/afx/controls/detail/EditWindow.h"
#include "platform/afx/controls/detail/TreeWindow.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Loop.h"

#include <QAbstractScrollArea>

#include <algorithm>

// How users change labels.

namespace tvx::afx {

namespace {

/// The class of the field that stands over a label.
constexpr const char* labelClass = "TvxTreeLabel";

/// Ends by the keys and with the keyboard, whatever a dialog around the tree would do with these keys.
class TreeLabel : public EditWindow {
public:
    using EditWindow::EditWindow;
    UINT dialogCode(const MSG* msg) const override {
        return EditWindow::dialogCode(msg) | DLGC_WANTALLKEYS;
    }
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message == WM_KEYDOWN && (wParam == VK_RETURN || wParam == VK_ESCAPE || wParam == VK_TAB)) {
            end(wParam == VK_ESCAPE, wParam == VK_TAB);
            return 0;
        }
        const LRESULT result = EditWindow::defaultProc(message, wParam, lParam);
        if (message == WM_KILLFOCUS) {
            end(false, false);
        }
        return result;
    }

private:
    void end(bool cancel, bool goesOn) {
        auto* tree = dynamic_cast<TreeWindow*>(parent());
        if (!tree || isDestroyed()) {
            return;
        }
        const HWND around = tree->handle();
        tree->endEdit(cancel);
        if (goesOn) {
            PostMessageA(around, WM_KEYDOWN, VK_TAB, 1); // it leads on from the tree
        }
    }
};

std::unique_ptr<Window> makeLabel(const CREATESTRUCT& cs) {
    return std::make_unique<TreeLabel>(cs);
}

const WindowClassEntry labelEntry(labelClass, &makeLabel);

std::string textOfField(HWND field) {
    std::string text(static_cast<std::size_t>(SendMessageA(field, WM_GETTEXTLENGTH, 0, 0)) + 1, '\0');
    const LRESULT length = SendMessageA(field, WM_GETTEXT, text.size(), reinterpret_cast<LPARAM>(text.data()));
    text.resize(static_cast<std::size_t>(length));
    return text;
}

} // namespace

bool TreeWindow::isEditable() const {
    return (style() & TVS_EDITLABELS) != 0;
}

/// Makes the field, hidden: the parent may set it up when it is asked.
HWND TreeWindow::makeField(const std::string& text) {
    CREATESTRUCT cs{};
    cs.lpszClass = labelClass;
    cs.lpszName = text.c_str();
    cs.style = WS_CHILD | WS_BORDER | ES_AUTOHSCROLL;
    cs.hwndParent = handle();
    const HWND field = createWindow(cs, nullptr);
    SendMessageA(field, WM_SETFONT, reinterpret_cast<WPARAM>(font), FALSE);
    return field;
}

HWND TreeWindow::editLabel(HTREEITEM item) {
    m_editLater->stop();
    if (!isEditable() || !m_nodes.find(item)) {
        return nullptr;
    }
    endEdit(false);
    ensureVisible(item);
    std::string text = textOf(item);
    if (isDestroyed() || !m_nodes.find(item)) {
        return nullptr;
    }
    m_field = makeField(text);
    m_edited = item;
    NMTVDISPINFO asked{};
    asked.item = about(item);
    asked.item.mask |= TVIF_TEXT;
    asked.item.pszText = text.data();
    const HWND field = m_field;
    if (tell(asked.hdr, TVN_BEGINLABELEDIT) != 0 || isDestroyed() || m_field != field || !m_nodes.find(item)) {
        dropField();
        return nullptr;
    }
    placeField();
    ShowWindow(m_field, SW_SHOW);
    SendMessageA(m_field, EM_SETSEL, 0, -1);
    SetFocus(m_field);
    return m_field;
}

void TreeWindow::dropField() {
    m_edited = nullptr;
    if (const HWND field = std::exchange(m_field, nullptr)) {
        DestroyWindow(field);
    }
}

bool TreeWindow::endEdit(bool cancel) {
    if (!m_field) {
        return false;
    }
    const HTREEITEM item = m_edited;
    const HWND field = std::exchange(m_field, nullptr); // it must not end twice, as it loses the keyboard
    std::string text = textOfField(field);
    if (GetFocus() == field && !isDestroyed()) {
        SetFocus(handle());
    }
    m_field = field;
    dropField();
    TreeNode* node = m_nodes.find(item);
    if (!node || isDestroyed()) {
        return true;
    }
    refresh();
    NMTVDISPINFO told{};
    told.item = about(item);
    told.item.mask |= TVIF_TEXT;
    told.item.pszText = cancel ? nullptr : text.data();
    told.item.cchTextMax = static_cast<int>(text.size()) + 1;
    const bool isTaken = tell(told.hdr, TVN_ENDLABELEDIT) != 0;
    node = isTaken && !cancel && !isDestroyed() ? m_nodes.find(item) : nullptr;
    if (node && !node->asksText) {
        node->text = told.item.pszText ? told.item.pszText : "";
        contentChanged();
    }
    return true;
}

/// Puts the field over its label, as wide as its text.
void TreeWindow::placeField() {
    constexpr int room = 16;
    Window* field = from(m_field);
    if (!field) {
        return;
    }
    const TreeNode* node = m_nodes.find(m_edited);
    const QRect label = node ? labelRect(*node, field->text()) : QRect();
    if (label.isEmpty()) {
        endEdit(true); // it has gone
        return;
    }
    const int widest = std::max(m_area->viewport()->width() - label.left(), room);
    const QRect place(label.left(), label.top(), std::min(label.width() + room, widest), label.height());
    guarded([&] { field->setWindowRect(place); });
}

} // namespace tvx::afx
