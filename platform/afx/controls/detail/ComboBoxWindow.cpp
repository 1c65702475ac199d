#include "platform/afx/controls/detail/ComboBoxWindow.h"

#include "platform/afx/controls/detail/EditWindow.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/PastedText.h"
#include "platform/base/Text.h"
#include "platform/win/Drives.h"

#include <QAbstractItemView>
#include <QComboBox>
#include <QLineEdit>
#include <QPainter>
#include <QScopedValueRollback>
#include <QStringListModel>
#include <QStylePainter>
#include <QStyledItemDelegate>
#include <QValidator>
#include <QWheelEvent>

#include <utility>

namespace tvx::afx {

/// Shows the box's lines to the toolkit without copying them.
class ComboModel : public QAbstractListModel {
public:
    explicit ComboModel(const ComboBoxWindow& window) : m_window(window) {}

    int rowCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : m_window.items().count();
    }
    QVariant data(const QModelIndex& index, int role) const override {
        if (role == Qt::DisplayRole || role == Qt::EditRole) {
            return toQt(m_window.items().at(index.row()).text.c_str());
        }
        return {};
    }
    template <class Change>
    void insertAt(int row, const Change& change) {
        beginInsertRows({}, row, row);
        change();
        endInsertRows();
    }
    template <class Change>
    void removeAt(int row, const Change& change) {
        beginRemoveRows({}, row, row);
        change();
        endRemoveRows();
    }
    template <class Change>
    void replaceAll(const Change& change) {
        beginResetModel();
        change();
        endResetModel();
    }

private:
    const ComboBoxWindow& m_window;
};

namespace {

/// Stands for the field where the index of a line is asked for.
constexpr int fieldIndex = -1;

/// Refuses what the user types beyond a number of bytes. The toolkit's own limit counts units of UTF-16, and cuts what
/// the program sets as well.
class ByteLimit : public QValidator {
public:
    ByteLimit(QObject* parent, int limit) : QValidator(parent), m_limit(limit) {}
    State validate(QString& input, int&) const override {
        return hostBytes(input) <= m_limit ? Acceptable : Invalid;
    }

private:
    int m_limit;
};

class ItemDelegate : public QStyledItemDelegate {
public:
    ItemDelegate(QObject* parent, ComboBoxWindow& window) : QStyledItemDelegate(parent), m_window(window) {}
    QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override {
        const QSize size = QStyledItemDelegate::sizeHint(option, index);
        return {size.width(), m_window.itemHeight()};
    }
    void paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const override {
        if (!m_window.isOwnerDrawn()) {
            QStyledItemDelegate::paint(painter, option, index);
            return;
        }
        const UINT state = (option.state & QStyle::State_Selected) != 0 ? ODS_SELECTED : 0U;
        storing([&] { painter->drawImage(option.rect, m_window.paintItem(index.row(), option.rect.size(), state)); });
    }

private:
    ComboBoxWindow& m_window;
};

class ComboFace : public QComboBox {
public:
    ComboFace(QWidget* parent, ComboBoxWindow& window) : QComboBox(parent), m_window(window) {}
    void showPopup() override {
        if (!m_open) {
            m_open = true;
            storing([this] { m_window.listShown(true); });
        }
        QComboBox::showPopup();
    }
    void hidePopup() override {
        QComboBox::hidePopup();
        if (m_open) {
            m_open = false;
            storing([this] { m_window.listShown(false); });
        }
    }

protected:
    /// Some styles open boxes that are not typed into as menus, which show all lines however many were asked for. A box
    /// that says it can be typed into opens as a list.
    void initStyleOption(QStyleOptionComboBox* option) const override {
        QComboBox::initStyleOption(option);
        option->editable = option->editable || !m_painting;
    }
    void paintEvent(QPaintEvent* event) override {
        const QScopedValueRollback painting(m_painting, true);
        if (!m_window.isOwnerDrawn() || m_window.isEditable()) {
            QComboBox::paintEvent(event);
            return;
        }
        QStylePainter painter(this);
        QStyleOptionComboBox option;
        initStyleOption(&option);
        painter.drawComplexControl(QStyle::CC_ComboBox, option);
        const QRect field = style()->subControlRect(QStyle::CC_ComboBox, &option, QStyle::SC_ComboBoxEditField, this);
        if (currentIndex() >= 0) {
            const UINT state = ODS_COMBOBOXEDIT | (hasFocus() ? ODS_FOCUS : 0U) | (isEnabled() ? 0U : ODS_DISABLED);
            storing([&] { painter.drawImage(field, m_window.paintItem(currentIndex(), field.size(), state)); });
        }
    }
    void wheelEvent(QWheelEvent* event) override {
        // A page that is scrolled over a box must not change what is chosen in it.
        if (hasFocus()) {
            QComboBox::wheelEvent(event);
        } else {
            event->ignore();
        }
    }

private:
    ComboBoxWindow& m_window;
    bool m_open = false;
    bool m_painting = false;
};

std::unique_ptr<Window> makeComboBox(const CREATESTRUCT& cs) {
    return std::make_unique<ComboBoxWindow>(cs);
}

const WindowClassEntry comboBoxEntry("ComboBox", &makeComboBox);

} // namespace

ComboBoxWindow::ComboBoxWindow(const CREATESTRUCT& cs)
    : ListControl(cs, {ODT_COMBOBOX, CBS_OWNERDRAWFIXED | CBS_OWNERDRAWVARIABLE, CBS_HASSTRINGS}),
      m_model(std::make_unique<ComboModel>(*this)),
      m_openHeight(cs.cy) {}

ComboBoxWindow::~ComboBoxWindow() {
    if (box()) {
        // Not disconnected: the toolkit hears of its end by a signal, to forget what assistive tools know of it.
        box()->blockSignals(true);
        box()->setModel(m_noLines); // the widget outlives the lines it showed
    }
}

QWidget* ComboBoxWindow::makeWidget(QWidget* parent) {
    auto* face = new ComboFace(parent, *this);
    face->setModel(m_model.get());
    m_noLines = new QStringListModel(face);
    // The list is made by what the box is just now. For one that is not typed into, some styles give it arrows that
    // take the place of lines, and no scroll bar.
    face->setEditable(true);
    face->setItemDelegate(new ItemDelegate(face, *this));
    face->setEditable(isEditable());
    // By default the toolkit adds to the lines what is typed and ended with Enter.
    face->setInsertPolicy(QComboBox::NoInsert);
    face->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon); // measures no line
    connectStoring(face, &QComboBox::activated, face, [this](int index) { chosen(index); });
    if (isEditable()) {
        makeField(face);
    }
    return face;
}

void ComboBoxWindow::makeField(QWidget* widget) {
    m_field = makeLineField(widget, {[] {}, [this](FieldCommand command) { carryOut(fieldControl(), command); },
                                     [this](const DroppedText& dropped) { takeDropped(fieldControl(), dropped); }});
    auto* face = static_cast<QComboBox*>(widget);
    face->setLineEdit(static_cast<QLineEdit*>(m_field->widget()));
    // The toolkit would complete what is typed with the first line that begins so.
    face->setCompleter(nullptr);
    connectStoring(face->lineEdit(), &QLineEdit::textEdited, face, [this] {
        const HWND self = handle();
        notify(CBN_EDITUPDATE);
        if (from(self)) {
            notify(CBN_EDITCHANGE);
        }
    });
}

FieldControl ComboBoxWindow::fieldControl() {
    return {*this, *m_field, FieldControl::Kind::ComboBox};
}

QComboBox* ComboBoxWindow::box() const {
    return static_cast<QComboBox*>(widget());
}

QLineEdit* ComboBoxWindow::field() const {
    return box()->lineEdit();
}

void ComboBoxWindow::widgetMade() {
    const QString text = Control::text();
    Control::widgetMade();
    if (isEditable()) {
        const QSignalBlocker quiet(field());
        field()->setText(text);
    }
}

void ComboBoxWindow::fontChanged() {
    Control::fontChanged();
    // The lines of an owner-drawn box are as high as the owner answered, whatever the font.
    setItemHeight(isOwnerDrawn() ? m_itemHeight : widget()->fontMetrics().height() + 2);
}

void ComboBoxWindow::setItemHeight(int height) {
    if (std::exchange(m_itemHeight, height) != height) {
        // The list keeps the places of its lines from the last time that it was open.
        guarded([this] { box()->view()->doItemsLayout(); });
    }
    applyHeights();
}

void ComboBoxWindow::measure() {
    setItemHeight(askHeight(m_itemHeight));
}

int ComboBoxWindow::fieldHeight() const {
    return std::max(widget()->fontMetrics().height(), m_itemHeight);
}

void ComboBoxWindow::applyHeights() {
    const int closed = fieldHeight() + 8;
    guarded([&] {
        // The height that hosts give is that of the open list; closed, a box is as high as its line.
        widget()->setFixedHeight(closed);
        box()->setMaxVisibleItems(std::max((m_openHeight - closed) / m_itemHeight, 1));
    });
}

void ComboBoxWindow::setWindowRect(const QRect& rect) {
    // A move alone comes with the closed height and leaves the list's as it was.
    if (widget() && rect.height() > widget()->height()) {
        m_openHeight = rect.height();
    }
    Window::setWindowRect(rect);
    if (widget()) {
        applyHeights();
    }
}

QString ComboBoxWindow::text() const {
    return box() ? box()->currentText() : Control::text();
}

void ComboBoxWindow::setText(const QString& text) {
    // The text of a box that is not typed into is its chosen line, and changes with the choice only.
    if (box() && isEditable()) {
        guarded([&] { field()->setText(text); });
    }
}

UINT ComboBoxWindow::dialogCode(const MSG* msg) const {
    UINT code = DLGC_WANTARROWS | DLGC_WANTCHARS;
    // Enter and Esc close an open list first.
    const bool open = box()->view()->isVisible();
    return open && msg && (msg->wParam == VK_RETURN || msg->wParam == VK_ESCAPE) ? code | DLGC_WANTALLKEYS : code;
}

UINT ComboBoxWindow::colorMessage() const {
    return isEditable() ? WM_CTLCOLOREDIT : WM_CTLCOLORLISTBOX;
}

void ComboBoxWindow::focusMoved(bool got) {
    notify(got ? CBN_SETFOCUS : CBN_KILLFOCUS);
}

void ComboBoxWindow::chosen(int) {
    const HWND self = handle();
    m_chosenWhileOpen = true;
    notify(CBN_SELENDOK);
    if (from(self)) {
        notify(CBN_SELCHANGE);
    }
}

void ComboBoxWindow::listShown(bool shown) {
    const HWND self = handle();
    if (shown) {
        m_chosenWhileOpen = false;
        notify(CBN_DROPDOWN);
        return;
    }
    // A list that closes without a choice tells so before it tells that it closes.
    if (!m_chosenWhileOpen) {
        notify(CBN_SELENDCANCEL);
    }
    if (from(self)) {
        notify(CBN_CLOSEUP);
    }
}

QImage ComboBoxWindow::paintItem(int index, QSize size, UINT state) {
    OwnerPainting drawing(*this, size, QPalette::Base);
    DRAWITEMSTRUCT item{};
    item.CtlType = ODT_COMBOBOX;
    item.itemID = static_cast<UINT>(index);
    item.itemData = static_cast<ULONG_PTR>(m_items.at(index).data);
    item.itemState = state;
    item.rcItem = {0, 0, size.width(), size.height()};
    drawing.draw(item);
    return drawing.image();
}

// --- lines ---

LRESULT ComboBoxWindow::add(LONG_PTR index, LPARAM text, bool sorted) {
    if (index < -1 || index > m_items.count()) {
        return CB_ERR;
    }
    ListItems::Item item = newItem(text);
    int place = 0;
    guarded([&] {
        // The toolkit chooses the first line of an empty box by itself; here only the user and the program choose.
        const int current = box()->currentIndex();
        const QString typed = box()->currentText();
        if (sorted) {
            m_model->replaceAll([&] { place = m_items.insertSorted(std::move(item)); });
        } else {
            place = index < 0 ? m_items.count() : static_cast<int>(index);
            m_model->insertAt(place, [&] { m_items.insert(place, std::move(item)); });
        }
        box()->setCurrentIndex(current >= place ? current + 1 : current);
        if (isEditable()) {
            const QSignalBlocker quiet(field());
            field()->setText(typed);
        }
    });
    return place;
}

LRESULT ComboBoxWindow::addDrives(WPARAM attributes) {
    if (attributes != (DDL_DRIVES | DDL_EXCLUSIVE)) {
        return CB_ERR;
    }
    LRESULT last = CB_ERR;
    for (char letter = 'a'; letter <= 'z'; ++letter) {
        if ((GetLogicalDrives() >> (letter - 'a') & 1) != 0) {
            const std::string line = std::string("[-") + letter + "-]";
            last = add(-1, reinterpret_cast<LPARAM>(line.c_str()), (style() & CBS_SORT) != 0 && hasStrings());
        }
    }
    return last;
}

LRESULT ComboBoxWindow::removeItem(LONG_PTR index) {
    if (!m_items.isValid(index)) {
        return CB_ERR;
    }
    const int row = static_cast<int>(index);
    tellDeleted(row);
    guarded([&] {
        // The toolkit would choose a neighbour of the line that goes; here nothing is chosen then.
        const int current = box()->currentIndex();
        m_model->removeAt(row, [&] { m_items.remove(row); });
        box()->setCurrentIndex(current == row ? -1 : current > row ? current - 1 : current);
    });
    return m_items.count();
}

void ComboBoxWindow::reset() {
    tellAllDeleted();
    guarded([&] {
        m_model->replaceAll([&] { m_items.clear(); });
        box()->setCurrentIndex(-1);
        if (isEditable()) {
            field()->clear();
        }
    });
}

LRESULT ComboBoxWindow::setCurrent(LONG_PTR index) {
    const bool exists = m_items.isValid(index);
    guarded([&] {
        box()->setCurrentIndex(exists ? static_cast<int>(index) : -1);
        if (!exists && isEditable()) {
            field()->clear();
        }
    });
    return exists ? index : CB_ERR;
}

LRESULT ComboBoxWindow::itemProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    const auto row = static_cast<int>(wParam);
    switch (message) {
    case CB_ADDSTRING:
        return add(-1, lParam, (style() & CBS_SORT) != 0 && hasStrings());
    case CB_INSERTSTRING:
        return add(row, lParam, false);
    case CB_DIR:
        return addDrives(wParam);
    case CB_DELETESTRING:
        return removeItem(row);
    case CB_RESETCONTENT:
        reset();
        return CB_OKAY;
    case CB_GETCOUNT:
        return m_items.count();
    case CB_GETLBTEXT:
        return copyText(wParam, lParam);
    case CB_GETLBTEXTLEN:
        return textLength(wParam);
    case CB_GETITEMDATA:
        return itemData(wParam);
    case CB_SETITEMDATA:
        return setItemData(wParam, lParam);
    case CB_FINDSTRING:
        return find(wParam, lParam, ListItems::Match::Prefix);
    case CB_FINDSTRINGEXACT:
        return find(wParam, lParam, ListItems::Match::Whole);
    case CB_SELECTSTRING: {
        const LRESULT found = find(wParam, lParam, ListItems::Match::Prefix);
        return found >= 0 ? setCurrent(found) : CB_ERR;
    }
    case CB_GETCURSEL:
        return box()->currentIndex();
    case CB_SETCURSEL:
        return setCurrent(row);
    default:
        return listProc(message, wParam, lParam, known);
    }
}

LRESULT ComboBoxWindow::listProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    switch (message) {
    case CB_SHOWDROPDOWN:
        guarded([&] { wParam != 0 ? box()->showPopup() : box()->hidePopup(); });
        return TRUE;
    case CB_GETDROPPEDSTATE:
        return box()->view()->isVisible() ? TRUE : FALSE;
    case CB_GETDROPPEDCONTROLRECT: {
        QRect rect = screenRect();
        rect.setHeight(std::max(rect.height(), m_openHeight));
        *reinterpret_cast<RECT*>(lParam) = fromQt(rect);
        return TRUE;
    }
    case CB_GETITEMHEIGHT:
        return static_cast<int>(wParam) == fieldIndex ? fieldHeight() : m_itemHeight;
    case CB_SETITEMHEIGHT:
        setItemHeight(std::clamp(static_cast<int>(lParam), 1, 1000));
        return CB_OKAY;
    case CB_SETDROPPEDWIDTH:
        box()->view()->setMinimumWidth(static_cast<int>(wParam));
        return static_cast<LRESULT>(wParam);
    default:
        return fieldProc(message, wParam, lParam, known);
    }
}

LRESULT ComboBoxWindow::fieldProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    const bool fieldMessage = message == CB_LIMITTEXT || message == CB_SETEDITSEL || message == CB_GETEDITSEL;
    known = fieldMessage;
    if (!fieldMessage || !isEditable()) {
        return CB_ERR;
    }
    const QString text = field()->text();
    if (message == CB_LIMITTEXT) {
        const QValidator* old = field()->validator();
        const int limit = text::clampToInt32(static_cast<LONG_PTR>(wParam));
        field()->setValidator(limit > 0 ? new ByteLimit(field(), limit) : nullptr);
        delete old;
        return TRUE;
    }
    if (message == CB_SETEDITSEL) {
        const int first = static_cast<SHORT>(LOWORD(static_cast<std::uintptr_t>(lParam)));
        const int last = static_cast<SHORT>(HIWORD(static_cast<std::uintptr_t>(lParam)));
        const int from = toolkitUnits(text, std::max(first, 0));
        const int to = last < 0 ? static_cast<int>(text.size()) : toolkitUnits(text, last);
        field()->setSelection(from, to - from);
        return TRUE;
    }
    const bool selected = field()->hasSelectedText();
    const int first = hostBytes(text, selected ? field()->selectionStart() : field()->cursorPosition());
    const int last = hostBytes(text, selected ? field()->selectionEnd() : field()->cursorPosition());
    if (wParam != 0) {
        *reinterpret_cast<DWORD*>(wParam) = static_cast<DWORD>(first);
    }
    if (lParam != 0) {
        *reinterpret_cast<DWORD*>(lParam) = static_cast<DWORD>(last);
    }
    return MAKELONG(first, last);
}

void ComboBoxWindow::paste() {
    const QMimeData* data = pastedData();
    const QString text = data ? firstLine(data->text()) : QString();
    if (!text.isEmpty()) {
        guarded([&] { m_field->insert(text, Undo::Keep); });
    }
}

/// The field's share of the messages.
std::optional<LRESULT> ComboBoxWindow::editProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (const auto result = clipboardProc(fieldControl(), message)) {
        return result;
    }
    const QPoint at(GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam));
    switch (message) {
    case WM_SYSCHAR:
        return wParam == VK_BACK ? std::optional<LRESULT>(passEvent(*this, message)) : std::nullopt;
    case WM_PASTE:
        paste();
        return 0;
    case WM_MBUTTONUP:
        if (field()->geometry().contains(at)) {
            pasteSelectionAt(fieldControl(), field()->mapFromParent(at));
            return 0;
        }
        return std::nullopt;
    case WM_CONTEXTMENU:
        showFieldMenu(fieldControl(), wParam, lParam);
        return 0;
    default:
        return std::nullopt;
    }
}

LRESULT ComboBoxWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (message >= CB_GETEDITSEL && message <= CB_SETDROPPEDWIDTH) {
        bool known = true;
        const LRESULT result = itemProc(message, wParam, lParam, known);
        return known ? result : CB_ERR;
    }
    if (message == WM_CREATE && isOwnerDrawn()) {
        measure(); // only now the control's own object can answer
        return 0;
    }
    if (message == WM_DESTROY) {
        // The owner frees its data while the control can still be asked about its lines.
        tellAllDeleted();
        return 0;
    }
    if (m_field) {
        if (const auto result = editProc(message, wParam, lParam)) {
            return *result;
        }
    }
    return Control::defaultProc(message, wParam, lParam);
}

} // namespace tvx::afx
