#include "platform/afx/controls/detail/FieldCommands.h"

#include "platform/afx/core/Clipboard.h"
#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Menu.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/MenuRequest.h"
#include "platform/afx/core/detail/OwnText.h"
#include "platform/afx/core/detail/PastedText.h"
#include "platform/win/FrameworkIds.h"

#include <QApplication>
#include <QClipboard>
#include <QKeyEvent>

#include <utility>

namespace tvx::afx {

std::optional<FieldCommand> fieldCommandOf(const QKeyEvent& event) {
    const auto is = [&event](Qt::KeyboardModifiers modifiers, Qt::Key key) {
        return event.modifiers() == modifiers && event.key() == key;
    };
    if (is(Qt::ControlModifier | Qt::ShiftModifier, Qt::Key_Insert)) {
        return FieldCommand::PasteSelection;
    }
    // Two that the desktops do not agree on.
    if (is(Qt::AltModifier, Qt::Key_Backspace)) {
        return FieldCommand::Undo;
    }
    if (is(Qt::ControlModifier, Qt::Key_Y) || is(Qt::ControlModifier | Qt::ShiftModifier, Qt::Key_Z)) {
        return FieldCommand::Redo;
    }
    using Standard = std::pair<QKeySequence::StandardKey, FieldCommand>;
    for (const auto& [keys, command] :
         {Standard(QKeySequence::Undo, FieldCommand::Undo), Standard(QKeySequence::Redo, FieldCommand::Redo),
          Standard(QKeySequence::Cut, FieldCommand::Cut), Standard(QKeySequence::Copy, FieldCommand::Copy),
          Standard(QKeySequence::Paste, FieldCommand::Paste),
          Standard(QKeySequence::SelectAll, FieldCommand::SelectAll),
          Standard(QKeySequence::DeleteEndOfLine, FieldCommand::CutToEnd),
          Standard(QKeySequence::DeleteCompleteLine, FieldCommand::CutAll)}) {
        if (event.matches(keys)) {
            return command;
        }
    }
    return std::nullopt;
}

namespace {

bool hasSelection(const TextField& field) {
    const TextRange range = field.selection();
    return range.anchor != range.caret;
}

/// Selects from a position to the end.
void selectFrom(const FieldControl& control, int position) {
    const HWND handle = control.window.handle();
    const int bytes = control.field.bytesAt(position);
    if (control.kind == FieldControl::Kind::ComboBox) {
        SendMessageA(handle, CB_SETEDITSEL, 0, MAKELONG(bytes, -1));
    } else {
        SendMessageA(handle, EM_SETSEL, static_cast<WPARAM>(bytes), -1);
    }
}

/// Takes the text from a position on away, to the clipboard unless it is secret.
void cutFrom(const FieldControl& control, int position) {
    if (control.readOnly) {
        return;
    }
    const HWND handle = control.window.handle();
    selectFrom(control, position);
    SendMessageA(handle, control.secret ? WM_CLEAR : WM_CUT, 0, 0);
}

void paste(const FieldControl& control, const PastedText& source) {
    if (!control.readOnly) {
        SendMessageA(control.window.handle(), WM_PASTE, 0, 0);
    }
}

QString desktopSelection() {
    const QClipboard& clipboard = *QApplication::clipboard();
    return clipboard.supportsSelection() ? clipboard.text(QClipboard::Selection) : QString();
}

void pasteSelection(const FieldControl& control) {
    if (const QString text = desktopSelection(); !text.isEmpty()) {
        paste(control, PastedText(text));
    }
}

} // namespace

void carryOut(const FieldControl& control, FieldCommand command) {
    const HWND handle = control.window.handle();
    switch (command) {
    case FieldCommand::Undo:
        // The message brings back what it has undone when there is no more to undo. A user who holds the key means
        // less.
        if (control.field.canUndo()) {
            SendMessageA(handle, WM_UNDO, 0, 0);
        }
        break;
    case FieldCommand::Redo:
        if (!control.readOnly && control.field.canRedo()) {
            guarded([&] { control.field.redo(); });
        }
        break;
    case FieldCommand::Cut:
        SendMessageA(handle, WM_CUT, 0, 0);
        break;
    case FieldCommand::CutToEnd:
        cutFrom(control, control.field.selection().caret);
        break;
    case FieldCommand::CutAll:
        cutFrom(control, 0);
        break;
    case FieldCommand::Copy:
        SendMessageA(handle, WM_COPY, 0, 0);
        break;
    case FieldCommand::Paste:
        paste(control, PastedText());
        break;
    case FieldCommand::PasteSelection:
        pasteSelection(control);
        break;
    case FieldCommand::SelectAll:
        selectFrom(control, 0);
        break;
    }
}

// --- pointer ---

void pasteSelectionAt(const FieldControl& control, QPoint point) {
    if (control.readOnly || desktopSelection().isEmpty()) {
        return;
    }
    const int place = control.field.positionNear(point);
    guarded([&] { control.field.select({place, place}); });
    pasteSelection(control);
}

namespace {

/// Takes away what was dragged from. Answers how many units went, none where the host keeps the text.
int removeMoved(const FieldControl& control, const TextRange& from) {
    const auto before = control.field.text().size();
    guarded([&] { control.field.select(from); });
    const HWND handle = control.window.handle();
    SendMessageA(handle, WM_CLEAR, 0, 0);
    return Window::from(handle) ? static_cast<int>(before - control.field.text().size()) : 0;
}

} // namespace

void takeDropped(const FieldControl& control, const DroppedText& dropped) {
    const auto& from = dropped.movedFrom;
    const bool onItself = from && dropped.position >= from->first() && dropped.position <= from->last();
    if (control.readOnly || onItself) {
        return;
    }
    const HWND handle = control.window.handle();
    SetFocus(handle);
    const int removed = from && Window::from(handle) ? removeMoved(control, *from) : 0;
    if (!Window::from(handle)) {
        return;
    }
    const int place = from && dropped.position > from->last() ? dropped.position - removed : dropped.position;
    const auto before = control.field.text().size();
    guarded([&] { control.field.select({place, place}); });
    paste(control, PastedText(dropped.text));
    // A host that refuses the paste has not asked for the text to go.
    if (Window::from(handle) && removed > 0 && control.field.text().size() == before) {
        guarded([&] { control.field.undo(); });
    }
}

// --- the menu ---

namespace {

/// The caret's foot for a menu that the keyboard asked for, in screen coordinates, else where the pointer asked.
QPoint menuPlace(const FieldControl& control, LPARAM place) {
    const QPoint at(GET_X_LPARAM(place), GET_Y_LPARAM(place));
    if (at != QPoint(-1, -1)) {
        return at;
    }
    const QWidget& client = *control.window.clientWidget();
    const QWidget& field = *control.field.widget();
    const QPoint foot = field.inputMethodQuery(Qt::ImCursorRectangle).toRect().bottomLeft();
    const QWidget& origin = field.isAncestorOf(&client) ? client : field;
    const QRect seen = origin.rect();
    return origin.mapToGlobal(
        QPoint(std::clamp(foot.x(), seen.left(), seen.right()), std::clamp(foot.y(), seen.top(), seen.bottom())));
}

struct MenuEntry {
    UINT command; ///< As help knows it.
    UINT text;
    bool enabled;
};

HMENU makeMenu(const FieldControl& control) {
    const bool selected = hasSelection(control.field);
    const bool writes = !control.readOnly;
    const TextRange range = control.field.selection();
    const auto all = control.field.text().size();
    const HMENU menu = CreatePopupMenu();
    for (const auto& [command, text, enabled] :
         {MenuEntry{ID_EDIT_UNDO, TVX_IDS_EDIT_UNDO, writes && control.field.canUndo()}, MenuEntry{0, 0, false},
          MenuEntry{ID_EDIT_CUT, TVX_IDS_EDIT_CUT, selected && writes && !control.secret},
          MenuEntry{ID_EDIT_COPY, TVX_IDS_EDIT_COPY, selected && !control.secret},
          MenuEntry{ID_EDIT_PASTE, TVX_IDS_EDIT_PASTE, writes && IsClipboardFormatAvailable(CF_TEXT)},
          MenuEntry{ID_EDIT_CLEAR, TVX_IDS_EDIT_DELETE, selected && writes}, MenuEntry{0, 0, false},
          MenuEntry{ID_EDIT_SELECT_ALL, TVX_IDS_EDIT_SELECT_ALL, range.last() - range.first() < all}}) {
        if (command == 0) {
            AppendMenuA(menu, MF_SEPARATOR, 0, nullptr);
        } else {
            AppendMenuA(menu, MF_STRING | (enabled ? MF_ENABLED : MF_GRAYED), command, fromQt(ownText(text)).c_str());
        }
    }
    return menu;
}

std::optional<FieldCommand> fieldCommandOf(UINT command) {
    switch (command) {
    case ID_EDIT_UNDO:
        return FieldCommand::Undo;
    case ID_EDIT_CUT:
        return FieldCommand::Cut;
    case ID_EDIT_COPY:
        return FieldCommand::Copy;
    case ID_EDIT_PASTE:
        return FieldCommand::Paste;
    case ID_EDIT_SELECT_ALL:
        return FieldCommand::SelectAll;
    default:
        return std::nullopt;
    }
}

} // namespace

void showFieldMenu(const FieldControl& control, WPARAM wParam, LPARAM lParam) {
    const HWND handle = control.window.handle();
    if (parentsTakeMenu(control.window, wParam, lParam) || !Window::from(handle)) {
        return;
    }
    const QPoint at = menuPlace(control, lParam);
    const HMENU menu = makeMenu(control);
    const auto chosen = static_cast<UINT>(
        TrackPopupMenu(menu, TPM_RETURNCMD | TPM_NONOTIFY | TPM_RIGHTBUTTON, at.x(), at.y(), 0, handle, nullptr));
    DestroyMenu(menu);
    if (!Window::from(handle)) {
        return;
    }
    if (chosen == ID_EDIT_CLEAR) {
        SendMessageA(handle, WM_CLEAR, 0, 0);
    } else if (const auto command = fieldCommandOf(chosen)) {
        carryOut(control, *command);
    }
}

// --- what the messages do ---

std::optional<LRESULT> clipboardProc(const FieldControl& control, UINT message) {
    TextField& field = control.field;
    switch (message) {
    case WM_CUT:
        if (control.readOnly) {
            field.copy();
        } else if (!control.secret) {
            guarded([&] { field.cut(); });
        }
        return 0;
    case WM_COPY:
        field.copy();
        return 0;
    case WM_CLEAR:
        if (!control.readOnly && hasSelection(field)) {
            guarded([&] { field.insert(QString(), Undo::Keep); });
            field.setModified(true);
        }
        return 0;
    case WM_UNDO:
        if (control.readOnly) {
            return FALSE;
        }
        // One step each way, as hosts know it: undone twice, the change is there again.
        guarded([&] { field.canUndo() ? field.undo() : field.redo(); });
        return TRUE;
    default:
        return std::nullopt;
    }
}

} // namespace tvx::afx
