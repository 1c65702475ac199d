#include "platform/afx/controls/detail/EditWindow.h"

#include "platform/afx/controls/AutoComplete.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/PastedText.h"
#include "platform/base/Text.h"

#include <QAbstractScrollArea>
#include <QApplication>
#include <QLineEdit>

#include <algorithm>
#include <cstring>
#include <limits>

namespace tvx::afx {

namespace {

/// What can be typed into a control that no limit was set for.
constexpr int defaultLimit = 30000;
/// What stands for the absence of a limit.
constexpr int noLimit = 0;

std::unique_ptr<Window> makeEdit(const CREATESTRUCT& cs) {
    return std::make_unique<EditWindow>(cs);
}

const WindowClassEntry editEntry("Edit", &makeEdit);

} // namespace

EditWindow::EditWindow(const CREATESTRUCT& cs) : Control(cs), m_limit(defaultLimit) {}

QWidget* EditWindow::makeWidget(QWidget* parent) {
    if (!isMultiLine()) {
        m_field = makeLineField(parent, fieldEvents());
        return m_field->widget();
    }
    AreaOptions options;
    options.wraps = (style() & (ES_AUTOHSCROLL | WS_HSCROLL)) == 0;
    options.verticalBar = (style() & WS_VSCROLL) != 0;
    options.horizontalBar = (style() & WS_HSCROLL) != 0;
    m_field = makeAreaField(parent, options, fieldEvents());
    return m_field->widget();
}

FieldEvents EditWindow::fieldEvents() {
    return {[this] { changed(); }, [this](FieldCommand command) { carryOut(fieldControl(), command); },
            [this](const DroppedText& dropped) { takeDropped(fieldControl(), dropped); }};
}

FieldControl EditWindow::fieldControl() {
    return {*this, *m_field, FieldControl::Kind::Edit, isReadOnly(), !isMultiLine() && (style() & ES_PASSWORD) != 0};
}

void EditWindow::widgetMade() {
    Control::widgetMade();
    const QString text = Control::text();
    applyStyle();
    m_passwordChar = (style() & ES_PASSWORD) != 0 ? '*' : 0;
    // The parent is not told of the text that the control is created with.
    ++m_quiet;
    m_field->setText(isMultiLine() ? plainLines(text) : firstLine(text));
    --m_quiet;
}

QWidget* EditWindow::clientWidget() const {
    auto* area = dynamic_cast<QAbstractScrollArea*>(widget());
    return area ? area->viewport() : widget();
}

bool EditWindow::completeFolders() {
    auto* field = qobject_cast<QLineEdit*>(m_field ? m_field->widget() : nullptr);
    if (field && !m_completion) {
        m_completion = std::make_unique<FolderCompletion>(*field);
    }
    return field != nullptr;
}

void EditWindow::applyStyle() {
    guarded([this] {
        m_field->setFrame(hasBorder());
        m_field->setReadOnly(isReadOnly());
        m_field->setPassword((style() & ES_PASSWORD) != 0);
        m_field->setAlignment((style() & ES_RIGHT) != 0    ? Qt::AlignRight
                              : (style() & ES_CENTER) != 0 ? Qt::AlignHCenter
                                                           : Qt::AlignLeft);
    });
    applyPalette();
}

QPalette EditWindow::ownPalette() const {
    QPalette palette;
    // A field that cannot be typed into looks like the window around it.
    if (isReadOnly()) {
        palette.setColor(QPalette::Base, QApplication::palette(widget()).color(QPalette::Window));
    }
    return palette;
}

void EditWindow::styleChanged(DWORD oldStyle, DWORD oldExStyle) {
    Control::styleChanged(oldStyle, oldExStyle);
    constexpr DWORD shown = ES_READONLY | ES_PASSWORD | ES_RIGHT | ES_CENTER | WS_BORDER;
    if (((oldStyle ^ style()) & shown) != 0 || oldExStyle != exStyle()) {
        applyStyle();
    }
}

QString EditWindow::text() const {
    if (!m_field || !widget()) {
        return Control::text();
    }
    QString text = m_field->text();
    return isMultiLine() ? text.replace(QLatin1Char('\n'), QLatin1String("\r\n")) : text;
}

void EditWindow::setText(const QString& text) {
    if (!m_field || !widget()) {
        return;
    }
    // Many lines set by the program are no change that the program is told of.
    m_quiet += isMultiLine() ? 1 : 0;
    guarded([&] { m_field->setText(isMultiLine() ? plainLines(text) : firstLine(text)); });
    m_quiet -= isMultiLine() ? 1 : 0;
    m_field->setModified(false);
}

void EditWindow::changed() {
    if (m_quiet != 0) {
        return;
    }
    const HWND self = handle();
    notify(EN_UPDATE);
    if (from(self)) {
        notify(EN_CHANGE);
    }
}

void EditWindow::focusMoved(bool got) {
    notify(got ? EN_SETFOCUS : EN_KILLFOCUS);
}

UINT EditWindow::dialogCode(const MSG* msg) const {
    UINT code = DLGC_HASSETSEL | DLGC_WANTCHARS | DLGC_WANTARROWS;
    if (msg && msg->message == WM_KEYDOWN && m_completion && m_completion->wantsKey(msg->wParam)) {
        return code | DLGC_WANTALLKEYS;
    }
    if (!isMultiLine() || !msg) {
        return code;
    }
    const bool control = isKeyDown(VK_CONTROL);
    const bool enter = msg->wParam == VK_RETURN && ((style() & ES_WANTRETURN) != 0 || control);
    const bool tab = msg->wParam == VK_TAB && control;
    return enter || tab ? code | DLGC_WANTALLKEYS : code;
}

UINT EditWindow::colorMessage() const {
    return isReadOnly() || !isEnabled() ? WM_CTLCOLORSTATIC : WM_CTLCOLOREDIT;
}

void EditWindow::applyColors(QPalette& palette, const QColor& text, const QColor& background) const {
    applyFieldColors(palette, text, background);
}

// --- typing ---

void EditWindow::insert(QString text, Source source, Undo undo) {
    text = isMultiLine() ? plainLines(text) : firstLine(text);
    if ((style() & ES_UPPERCASE) != 0) {
        text = text.toUpper();
    } else if ((style() & ES_LOWERCASE) != 0) {
        text = text.toLower();
    }
    // The limit is the user's: the program may set and insert longer texts.
    if (source == Source::User) {
        const TextRange selection = m_field->selection();
        const int replaced = m_field->bytesAt(selection.last()) - m_field->bytesAt(selection.first());
        const int kept = m_field->bytes() - replaced;
        const int limit = m_limit == noLimit ? std::numeric_limits<int>::max() : m_limit;
        const int units = toolkitUnits(text, std::max(limit - kept, 0));
        if (units < text.size()) {
            text.truncate(units);
            const HWND self = handle();
            notify(EN_MAXTEXT);
            if (!from(self) || text.isEmpty()) {
                return;
            }
        }
    }
    guarded([&] { m_field->insert(text, undo); });
    m_field->setModified(true);
}

void EditWindow::paste() {
    const QMimeData* data = pastedData();
    if (isReadOnly() || !data) {
        return;
    }
    QString text = data->text();
    if ((style() & ES_NUMBER) != 0) {
        text.removeIf([](QChar c) { return !c.isDigit(); });
    }
    if (!text.isEmpty()) {
        insert(text, Source::User);
    }
}

/// Characters are inserted here, so that limits and case apply; everything else is the toolkit's.
bool EditWindow::typed(UINT message, WPARAM character) {
    const bool control = isKeyDown(VK_CONTROL) && !isKeyDown(VK_MENU);
    switch (character) {
    case '\r':
    case '\n':
        if (isMultiLine() && !isReadOnly()) {
            insert(QStringLiteral("\n"), Source::User);
        }
        return true;
    case '\t':
        if (m_completion) {
            return true; // the key has completed
        }
        break;
    default:
        if (control || character < ' ' || character == 0x7F) {
            return false;
        }
        break;
    }
    const bool digit = character >= '0' && character <= '9';
    if (isReadOnly()) {
        return true;
    }
    if ((style() & ES_NUMBER) != 0 && !digit) {
        QApplication::beep();
        return true;
    }
    const auto codePoint = static_cast<char32_t>(character);
    insert(QString::fromUcs4(&codePoint, 1), Source::User);
    return true;
}

// --- selection and lines ---

void EditWindow::select(LONG_PTR start, LONG_PTR end) {
    const auto position = [&](LONG_PTR bytes) {
        return m_field->positionAt(bytes < 0 ? m_field->bytes() : text::clampToInt32(bytes));
    };
    const int caret = m_field->selection().caret;
    const TextRange range = start == -1 ? TextRange{caret, caret} : TextRange{position(start), position(end)};
    guarded([&] { m_field->select(range); });
}

LRESULT EditWindow::selectedBytes(WPARAM start, LPARAM end) const {
    const TextRange range = m_field->selection();
    const int first = m_field->bytesAt(range.first());
    const int last = range.first() == range.last() ? first : m_field->bytesAt(range.last());
    if (start != 0) {
        *reinterpret_cast<DWORD*>(start) = static_cast<DWORD>(first);
    }
    if (end != 0) {
        *reinterpret_cast<DWORD*>(end) = static_cast<DWORD>(last);
    }
    // Both places in one number where they fit; who has longer texts passes pointers.
    return first > 0xFFFF || last > 0xFFFF ? -1 : MAKELONG(first, last);
}

bool EditWindow::hasLine(int number) const {
    return number >= 0 && number < m_field->lineCount();
}

LRESULT EditWindow::copyLine(int number, char* buffer) const {
    if (!hasLine(number)) {
        return 0;
    }
    // The buffer's first word tells its size; no zero is written behind the text.
    WORD capacity = 0;
    std::memcpy(&capacity, buffer, sizeof(capacity));
    const std::string text = fromQt(m_field->line(number).text);
    const std::size_t length = text::characterStart(text, std::min<std::size_t>(capacity, text.size()));
    std::copy_n(text.data(), length, buffer);
    return static_cast<LRESULT>(length);
}

LRESULT EditWindow::lineProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    const auto number = static_cast<int>(wParam);
    const bool current = number == -1;
    switch (message) {
    case EM_GETLINECOUNT:
        return m_field->lineCount();
    case EM_LINEINDEX: {
        const int line = current ? m_field->lineAt(m_field->selection().caret) : number;
        return hasLine(line) ? m_field->bytesAt(m_field->line(line).start) : -1;
    }
    case EM_LINELENGTH: {
        const int position = current ? m_field->selection().caret : m_field->positionAt(number);
        return hostBytes(m_field->line(m_field->lineAt(position)).text);
    }
    case EM_LINEFROMCHAR:
        return m_field->lineAt(current ? m_field->selection().first() : m_field->positionAt(number));
    case EM_GETLINE:
        return copyLine(number, reinterpret_cast<char*>(lParam));
    default:
        known = false;
        return 0;
    }
}

LRESULT EditWindow::editProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    switch (message) {
    case EM_GETSEL:
        return selectedBytes(wParam, lParam);
    case EM_SETSEL:
        select(static_cast<int>(wParam), static_cast<int>(lParam));
        return 0;
    case EM_REPLACESEL:
        insert(toQt(reinterpret_cast<const char*>(lParam)), Source::Program, wParam != 0 ? Undo::Keep : Undo::Forget);
        return 0;
    case EM_LINESCROLL:
        m_field->scrollLines(static_cast<int>(lParam));
        return TRUE;
    case EM_SCROLLCARET:
        m_field->showCaret();
        return 0;
    case EM_GETFIRSTVISIBLELINE:
        return m_field->firstVisibleLine();
    case EM_GETMODIFY:
        return m_field->isModified() ? TRUE : FALSE;
    case EM_SETMODIFY:
        m_field->setModified(wParam != 0);
        return 0;
    case EM_SETLIMITTEXT:
        m_limit = text::clampToInt32(static_cast<LONG_PTR>(wParam));
        return 0;
    case EM_GETLIMITTEXT:
        return m_limit;
    case EM_CANUNDO:
        return m_field->canUndo() || m_field->canRedo() ? TRUE : FALSE;
    case EM_UNDO:
        return call(WM_UNDO);
    case EM_EMPTYUNDOBUFFER:
        m_field->forgetUndo();
        return 0;
    case EM_SETREADONLY:
        setStyle(wParam != 0 ? (style() | ES_READONLY) : (style() & ~DWORD{ES_READONLY}), exStyle());
        return TRUE;
    case EM_SETPASSWORDCHAR:
        m_passwordChar = wParam;
        setStyle(wParam != 0 ? (style() | ES_PASSWORD) : (style() & ~DWORD{ES_PASSWORD}), exStyle());
        return 0;
    case EM_GETPASSWORDCHAR:
        return static_cast<LRESULT>(m_passwordChar);
    case EM_GETRECT:
        *reinterpret_cast<RECT*>(lParam) = fromQt(clientRect());
        return 0;
    case EM_SETTABSTOPS:
        return TRUE;
    default:
        return lineProc(message, wParam, lParam, known);
    }
}

LRESULT EditWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (message >= EM_GETSEL && message <= EM_GETLIMITTEXT) {
        bool known = true;
        const LRESULT result = editProc(message, wParam, lParam, known);
        if (known) {
            return result;
        }
    }
    if (const auto result = clipboardProc(fieldControl(), message)) {
        return *result;
    }
    switch (message) {
    case WM_KEYDOWN:
        return m_completion && m_completion->takeKey(wParam) ? 0 : Control::defaultProc(message, wParam, lParam);
    case WM_GETTEXTLENGTH:
        // The field counts along, so that a long text is not converted for its length alone.
        return m_field->bytes();
    case WM_CHAR:
        if (!typed(message, wParam)) {
            passEvent(*this, message);
        }
        return 0;
    case WM_SYSCHAR:
        // Alt and Backspace undo. Other characters with Alt are the menu's.
        return wParam == VK_BACK ? passEvent(*this, message) : Control::defaultProc(message, wParam, lParam);
    case WM_PASTE:
        paste();
        return 0;
    case WM_MBUTTONUP:
        pasteSelectionAt(fieldControl(), QPoint(GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)));
        return 0;
    case WM_CONTEXTMENU:
        showFieldMenu(fieldControl(), wParam, lParam);
        return 0;
    default:
        return Control::defaultProc(message, wParam, lParam);
    }
}

} // namespace tvx::afx

LONG SHAutoComplete(HWND edit, DWORD flags) {
    constexpr auto invalidArgument = static_cast<LONG>(0x80070057);
    auto* window = dynamic_cast<tvx::afx::EditWindow*>(tvx::afx::Window::from(edit));
    return window && flags == SHACF_FILESYS_DIRS && window->completeFolders() ? 0 : invalidArgument;
}
