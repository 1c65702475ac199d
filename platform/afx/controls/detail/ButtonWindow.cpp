#include "platform/afx/controls/detail/ButtonWindow.h"

#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Group.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/gdi/detail/GdiObjects.h"

#include <QAccessible>
#include <QCheckBox>
#include <QPainter>
#include <QPushButton>
#include <QRadioButton>
#include <QStyle>

namespace tvx::afx {

namespace {

/// A button of the toolkit whose mark is the window's affair.
template <class Base>
class ButtonFace : public Base {
public:
    ButtonFace(QWidget* parent, ButtonWindow& window) : Base(parent), m_window(window) {}

protected:
    void nextCheckState() override {}
    void paintEvent(QPaintEvent* event) override {
        if (m_window.type() == BS_OWNERDRAW) {
            QPainter painter(this);
            storing([&] { m_window.paintByOwner(painter); });
            return;
        }
        Base::paintEvent(event);
    }

private:
    ButtonWindow& m_window;
};

class GroupFace : public QWidget {
public:
    GroupFace(QWidget* parent, const ButtonWindow& window) : QWidget(parent), m_window(window) {
        setAttribute(Qt::WA_TransparentForMouseEvents);
    }

protected:
    void paintEvent(QPaintEvent*) override {
        QPainter painter(this);
        m_window.paintGroupBox(painter);
    }

private:
    const ButtonWindow& m_window;
};

std::unique_ptr<Window> makeButton(const CREATESTRUCT& cs) {
    return std::make_unique<ButtonWindow>(cs);
}

const WindowClassEntry buttonEntry("Button", &makeButton);

/// Breaks a text into lines of at most this width, at blanks.
QString wrapped(const QString& text, const QFontMetrics& metrics, int width) {
    QString lines;
    QString line;
    for (const QString& word : text.split(QLatin1Char(' '))) {
        const QString longer = line.isEmpty() ? word : line + QLatin1Char(' ') + word;
        if (!line.isEmpty() && metrics.size(Qt::TextShowMnemonic, longer).width() > width) {
            lines += line + QLatin1Char('\n');
            line = word;
        } else {
            line = longer;
        }
    }
    return lines + line;
}

} // namespace

// --- making ---

QWidget* ButtonWindow::makeWidget(QWidget* parent) {
    QAbstractButton* made = nullptr;
    const bool pushLike = (style() & BS_PUSHLIKE) != 0;
    switch (type()) {
    case BS_GROUPBOX:
        return new GroupFace(parent, *this);
    case BS_CHECKBOX:
    case BS_AUTOCHECKBOX:
    case BS_3STATE:
    case BS_AUTO3STATE:
        made = pushLike ? static_cast<QAbstractButton*>(new ButtonFace<QPushButton>(parent, *this))
                        : new ButtonFace<QCheckBox>(parent, *this);
        break;
    case BS_RADIOBUTTON:
    case BS_AUTORADIOBUTTON:
        made = pushLike ? static_cast<QAbstractButton*>(new ButtonFace<QPushButton>(parent, *this))
                        : new ButtonFace<QRadioButton>(parent, *this);
        // The toolkit takes all siblings for one group; groups of dialogs end at the next WS_GROUP.
        made->setAutoExclusive(false);
        break;
    default:
        made = new ButtonFace<QPushButton>(parent, *this);
        break;
    }
    if (pushLike) {
        made->setCheckable(true);
    }
    connectStoring(made, &QAbstractButton::clicked, made, [this] { click(); });
    return made;
}

int ButtonWindow::accessibleRole() const {
    if (type() == BS_GROUPBOX) {
        return QAccessible::Grouping;
    }
    // The toolkit takes a button that does not release its siblings itself for a check box.
    return qobject_cast<QRadioButton*>(widget()) ? QAccessible::RadioButton : QAccessible::NoRole;
}

QAbstractButton* ButtonWindow::button() const {
    return dynamic_cast<QAbstractButton*>(widget());
}

void ButtonWindow::widgetMade() {
    Control::widgetMade();
    applyType();
    applyText();
}

void ButtonWindow::applyType() {
    if (auto* push = dynamic_cast<QPushButton*>(widget())) {
        // Which button Enter presses is decided by the keys of dialogs, not by the toolkit.
        push->setAutoDefault(false);
        push->setFlat((style() & BS_FLAT) != 0);
        showAsDefault(type() == BS_DEFPUSHBUTTON);
    } else if (button() && (style() & BS_LEFTTEXT) != 0) {
        button()->setLayoutDirection(Qt::RightToLeft);
    }
}

void ButtonWindow::applyText() {
    if (!button()) {
        widget()->setAccessibleName(text());
        widget()->update();
        return;
    }
    const bool picture = (style() & (BS_ICON | BS_BITMAP)) != 0;
    QString shown = picture ? QString() : text();
    if ((style() & BS_MULTILINE) != 0) {
        // Beside the text there is the mark, or the edge of the button.
        const bool marked = dynamic_cast<QPushButton*>(widget()) == nullptr;
        shown = wrapped(shown, widget()->fontMetrics(), widget()->width() - (marked ? 20 : 8));
    }
    guarded([&] {
        button()->setText(shown);
        button()->setShortcut({}); // mnemonics are the dialog's; the toolkit's act late
    });
    button()->setAccessibleName(picture ? text() : QString());
}

void ButtonWindow::setText(const QString& text) {
    Control::setText(text);
    if (widget()) {
        applyText();
    }
}

void ButtonWindow::fontChanged() {
    Control::fontChanged();
    applyText();
}

void ButtonWindow::styleChanged(DWORD oldStyle, DWORD oldExStyle) {
    Control::styleChanged(oldStyle, oldExStyle);
    if (((oldStyle ^ style()) & 0xFFFFU) != 0) {
        applyType();
        applyText();
        widget()->update();
    }
}

void ButtonWindow::showAsDefault(bool isDefault) {
    m_shownAsDefault = isDefault;
    if (auto* push = dynamic_cast<QPushButton*>(widget())) {
        push->setDefault(isDefault);
    }
}

// --- marks ---

void ButtonWindow::setCheck(int check) {
    const bool threeStates = type() == BS_3STATE || type() == BS_AUTO3STATE;
    m_check = check == BST_INDETERMINATE && threeStates ? BST_INDETERMINATE : check != 0 ? BST_CHECKED : BST_UNCHECKED;
    if (isRadio()) {
        // Tab reaches a group of radio buttons at the one that is marked.
        setStyle(m_check != 0 ? (style() | WS_TABSTOP) : (style() & ~DWORD{WS_TABSTOP}), exStyle());
    }
    applyCheck();
}

void ButtonWindow::applyCheck() {
    guarded([this] {
        if (auto* box = dynamic_cast<QCheckBox*>(widget())) {
            const Qt::CheckState states[] = {Qt::Unchecked, Qt::Checked, Qt::PartiallyChecked};
            box->setCheckState(states[m_check]);
        } else if (button() && button()->isCheckable()) {
            button()->setChecked(m_check != 0);
        }
    });
}

void ButtonWindow::checkInGroup() {
    for (Window* sibling : dialogGroup(*this)) {
        auto* other = dynamic_cast<ButtonWindow*>(sibling);
        if (other && other != this && other->type() == BS_AUTORADIOBUTTON) {
            other->setCheck(BST_UNCHECKED);
        }
    }
    setCheck(BST_CHECKED);
}

void ButtonWindow::click() {
    switch (type()) {
    case BS_AUTOCHECKBOX:
        setCheck(m_check == 0 ? BST_CHECKED : BST_UNCHECKED);
        break;
    case BS_AUTO3STATE:
        setCheck((m_check + 1) % 3);
        break;
    case BS_AUTORADIOBUTTON:
        checkInGroup();
        break;
    default:
        break;
    }
    notify(BN_CLICKED);
}

LRESULT ButtonWindow::state() const {
    LRESULT state = m_check;
    if (button() && button()->isDown()) {
        state |= BST_PUSHED;
    }
    return widget()->hasFocus() ? state | BST_FOCUS : state;
}

LRESULT ButtonWindow::setPicture(UINT kind, HANDLE picture) {
    const HANDLE old = std::exchange(m_picture, picture);
    const QImage image =
        kind == IMAGE_ICON ? iconImage(static_cast<HICON>(picture)) : bitmapImage(static_cast<HBITMAP>(picture));
    if (button()) {
        button()->setIcon(image.isNull() ? QIcon() : QIcon(QPixmap::fromImage(image)));
        button()->setIconSize(image.isNull() ? QSize(16, 16) : image.size());
    }
    return reinterpret_cast<LRESULT>(old);
}

// --- dialogs and colours ---

UINT ButtonWindow::dialogCode(const MSG*) const {
    if (type() == BS_GROUPBOX) {
        return DLGC_STATIC;
    }
    if (isPushButton()) {
        return DLGC_BUTTON |
               (type() == BS_DEFPUSHBUTTON || m_shownAsDefault ? DLGC_DEFPUSHBUTTON : DLGC_UNDEFPUSHBUTTON);
    }
    return isRadio() ? DLGC_BUTTON | DLGC_RADIOBUTTON : DLGC_BUTTON;
}

UINT ButtonWindow::colorMessage() const {
    return isPushButton() ? WM_CTLCOLORBTN : WM_CTLCOLORSTATIC;
}

void ButtonWindow::applyColors(QPalette& palette, const QColor& text, const QColor& background) const {
    if (!isPushButton()) { // push buttons keep the style's look
        Control::applyColors(palette, text, background);
    }
}

void ButtonWindow::focusMoved(bool got) {
    if ((style() & BS_NOTIFY) != 0) {
        notify(got ? BN_SETFOCUS : BN_KILLFOCUS);
    }
}

LRESULT ButtonWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case BM_GETCHECK:
        return m_check;
    case BM_SETCHECK:
        setCheck(static_cast<int>(wParam));
        return 0;
    case BM_GETSTATE:
        return state();
    case BM_SETSTATE:
        if (button()) {
            button()->setDown(wParam != 0);
        }
        return 0;
    case BM_SETSTYLE:
        setStyle((style() & 0xFFFF0000U) | (static_cast<DWORD>(wParam) & 0xFFFFU), exStyle());
        return 0;
    case BM_CLICK:
        click();
        return 0;
    case BM_SETIMAGE:
        return setPicture(static_cast<UINT>(wParam), reinterpret_cast<HANDLE>(lParam));
    case BM_GETIMAGE:
        return reinterpret_cast<LRESULT>(m_picture);
    case WM_LBUTTONDBLCLK:
        // For the other kinds the second press is one more click, which the toolkit makes of it.
        passEvent(*this, message);
        if (isRadio() || type() == BS_OWNERDRAW || (style() & BS_NOTIFY) != 0) {
            notify(BN_DOUBLECLICKED);
        }
        return 0;
    default:
        return Control::defaultProc(message, wParam, lParam);
    }
}

// --- painting ---

void ButtonWindow::paintByOwner(QPainter& painter) {
    Control::paintByOwner(painter, ODT_BUTTON,
                          (button()->isDown() ? ODS_SELECTED : 0U) | (widget()->hasFocus() ? ODS_FOCUS : 0U) |
                              (m_shownAsDefault ? ODS_DEFAULT : 0U));
}

/// The title interrupts the frame's upper edge, as templates are drawn for; the toolkit's styles put it above.
void ButtonWindow::paintGroupBox(QPainter& painter) const {
    constexpr int indent = 9;
    constexpr int gap = 2;
    const QRect area = widget()->rect();
    const QFontMetrics metrics = painter.fontMetrics();
    const QRect frame = area.adjusted(0, metrics.height() / 2, -1, -1);
    const int width = metrics.size(Qt::TextShowMnemonic, text()).width();
    const QRect title(indent, 0, std::min(width, area.width() - 2 * indent), metrics.height());
    painter.save();
    if (!text().isEmpty()) {
        painter.setClipRegion(QRegion(area) - QRegion(title.adjusted(-gap, 0, gap, 0)));
    }
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(widget()->palette().color(QPalette::Window).darker(135));
    painter.drawRoundedRect(QRectF(frame).translated(0.5, 0.5), 2, 2);
    painter.restore();
    widget()->style()->drawItemText(&painter, title, Qt::AlignLeft | Qt::TextShowMnemonic, widget()->palette(),
                                    widget()->isEnabled(), text(), QPalette::WindowText);
}

} // namespace tvx::afx
