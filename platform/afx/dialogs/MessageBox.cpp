#include "platform/afx/core/App.h"

#include "platform/afx/core/AskedFor.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/OwnText.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/dialogs/DialogWatch.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/Exception.h"
#include "platform/win/FrameworkIds.h"
#include "platform/win/RegistryNotice.h"

#include <QApplication>
#include <QClipboard>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QMessageBox>
#include <QPointer>
#include <QPushButton>
#include <QRegularExpression>
#include <QScreen>

#include <algorithm>
#include <array>
#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

using namespace tvx::afx;

namespace {

struct BoxButton {
    int answer;
    UINT label;
};

/// The buttons of each kind of box, in the order in which the kinds are numbered (MB_OK, MB_OKCANCEL, ...).
const std::vector<BoxButton>& buttonsOf(UINT type) {
    static const std::array<std::vector<BoxButton>, 6> kinds{{
        {{IDOK, TVX_IDS_OK}},
        {{IDOK, TVX_IDS_OK}, {IDCANCEL, TVX_IDS_CANCEL}},
        {{IDABORT, TVX_IDS_ABORT}, {IDRETRY, TVX_IDS_RETRY}, {IDIGNORE, TVX_IDS_IGNORE}},
        {{IDYES, TVX_IDS_YES}, {IDNO, TVX_IDS_NO}, {IDCANCEL, TVX_IDS_CANCEL}},
        {{IDYES, TVX_IDS_YES}, {IDNO, TVX_IDS_NO}},
        {{IDRETRY, TVX_IDS_RETRY}, {IDCANCEL, TVX_IDS_CANCEL}},
    }};
    const UINT kind = type & MB_TYPEMASK;
    return kinds[kind < kinds.size() ? kind : 0];
}

const BoxButton& defaultOf(UINT type) {
    const auto& buttons = buttonsOf(type);
    const UINT index = (type & MB_DEFMASK) >> 8;
    return buttons[index < buttons.size() ? index : 0];
}

/// The answer of Esc and of the close button: Cancel, or the only button. None where a choice is asked for.
int escapeAnswer(UINT type) {
    const auto& buttons = buttonsOf(type);
    for (const BoxButton& button : buttons) {
        if (button.answer == IDCANCEL) {
            return IDCANCEL;
        }
    }
    return buttons.size() == 1 ? buttons.front().answer : 0;
}

QMessageBox::Icon iconOf(UINT type) {
    switch (type & MB_ICONMASK) {
    case MB_ICONERROR:
        return QMessageBox::Critical;
    case MB_ICONQUESTION:
        return QMessageBox::Question;
    case MB_ICONEXCLAMATION:
        return QMessageBox::Warning;
    case MB_ICONINFORMATION:
        return QMessageBox::Information;
    default:
        return QMessageBox::NoIcon;
    }
}

/// A text that can be broken within words that are wider than a line, as names of deep files are: behind separators.
QString breakable(QString text, const QFontMetrics& metrics, int width) {
    static const QRegularExpression word(QStringLiteral("\\S+"));
    for (QRegularExpressionMatchIterator words = word.globalMatch(text); words.hasNext();) {
        const QString wide = words.next().captured();
        if (metrics.horizontalAdvance(wide) > width) {
            text.replace(wide, QString(wide).replace(QLatin1Char('/'), QStringLiteral("/\u200B")));
        }
    }
    return text;
}

/// A box whose buttons end our own loop. The toolkit's own exec would let no exception out.
class Box : public QMessageBox {
public:
    /// @param owner  whom the box asks for help, null for the main window
    Box(HWND owner, QWidget* over, UINT type)
        : QMessageBox(over),
          m_type(type),
          m_owner(owner),
          m_help(BoxHelp::take()),
          m_hasHelp(!HelpAnswer::isUnderWay()) {}

    int ask(const char* text, const char* caption) {
        setWindowTitle(toQt(caption));
        setTextFormat(Qt::PlainText);
        setTextInteractionFlags(Qt::TextSelectableByMouse);
        m_text = toQt(text);
        setText(m_text);
        setIcon(iconOf(m_type));
        for (const BoxButton& button : buttonsOf(m_type)) {
            addButton(button);
        }
        if ((m_type & MB_HELP) != 0) {
            addHelpButton();
        }
        layOut();
        setWindowModality(Qt::ApplicationModal);
        const QPointer<QWidget> before = QApplication::activeWindow();
        guarded([this] {
            show();
            raise();
            activateWindow();
        });
        const int answer = m_loop.run();
        guarded([&] {
            hide();
            if (before && before->isVisible()) {
                before->activateWindow(); // not every window manager does it
            }
        });
        return answer > 0 ? answer : defaultOf(m_type).answer;
    }

    void reject() override {
        finish(escapeAnswer(m_type));
    }

protected:
    void closeEvent(QCloseEvent* event) override {
        event->ignore();
        finish(escapeAnswer(m_type));
    }
    void keyPressEvent(QKeyEvent* event) override {
        if (event->key() == Qt::Key_Escape) {
            finish(escapeAnswer(m_type));
            return;
        }
        if (event->key() == Qt::Key_F1 && event->modifiers() == Qt::NoModifier && !isRepeated(*event)) {
            askForHelp();
            return;
        }
        if (event->matches(QKeySequence::Copy)) {
            QApplication::clipboard()->setText(m_text);
            return;
        }
        QMessageBox::keyPressEvent(event);
    }

private:
    void askForHelp() {
        // What help itself has to say would only be said again.
        if (m_hasHelp) {
            explain(m_owner, m_help);
        }
    }

    void layOut() {
        auto* label = findChild<QLabel*>(QStringLiteral("qt_msgbox_label"));
        auto* grid = qobject_cast<QGridLayout*>(layout());
        if (!label || !grid) {
            return;
        }
        makeRoom(*label);
        label->setAlignment(Qt::AlignTop | Qt::AlignLeft);
        if (icon() != NoIcon) {
            // A short text stands in the middle of the icon's height; the toolkit would put it higher or lower.
            const qreal rest = iconPixmap().deviceIndependentSize().height() - label->sizeHint().height();
            label->setContentsMargins(2, static_cast<int>(std::max(rest / 2, 0.0)), 0, 0);
            return;
        }
        label->setIndent(0);
        for (int i = 0; i < grid->count(); ++i) {
            if (QSpacerItem* gap = grid->itemAt(i)->spacerItem()) { // where the icon would be
                gap->changeSize(0, 0, QSizePolicy::Fixed, QSizePolicy::Fixed);
            }
        }
        grid->setHorizontalSpacing(0);
        grid->invalidate();
    }

    /// The toolkit breaks lines at 500 pixels; texts that come with line ends of their own keep theirs. A short text
    /// leaves room for the caption.
    void makeRoom(QLabel& label) {
        constexpr int captionButtons = 110;
        constexpr int besideText = 100; // icon and margins
        const QFontMetrics metrics = label.fontMetrics();
        const int caption = metrics.horizontalAdvance(windowTitle()) + captionButtons;
        // The toolkit makes no box wider than this, and cuts what does not fit.
        const int available = screen()->availableGeometry().width();
        const int most = (available <= 1024 ? available * 4 / 5 : std::min(available - 480, 1000)) - besideText;
        int width = caption > label.sizeHint().width() ? caption : 0;
        if (text().contains(QLatin1Char('\n'))) {
            const int lines = metrics.size(0, text()).width() + 2 * label.margin() + 2;
            width = std::max(width, std::min(lines, most));
        }
        if (width > 0) {
            label.setMinimumWidth(width);
        }
        label.setText(breakable(text(), metrics, most));
    }

    void addButton(const BoxButton& entry) {
        QPushButton* button = QMessageBox::addButton(ownText(entry.label), QMessageBox::ActionRole);
        const int answer = entry.answer;
        QObject::disconnect(button, nullptr, this, nullptr);
        connectStoring(button, &QPushButton::clicked, this, [this, answer] { finish(answer); });
        if (answer == defaultOf(m_type).answer) {
            setDefaultButton(button);
        }
    }

    /// The one button that leaves the box open.
    void addHelpButton() {
        QPushButton* button = QMessageBox::addButton(ownText(TVX_IDS_HELP), QMessageBox::HelpRole);
        QObject::disconnect(button, &QPushButton::clicked, nullptr, nullptr); // the toolkit would close the box
        button->setAutoDefault(false);
        connectStoring(button, &QPushButton::clicked, this, [this] { askForHelp(); });
    }

    void finish(int answer) {
        if (answer != 0) {
            m_loop.end(answer);
        }
    }

    UINT m_type;
    HWND m_owner;
    DWORD_PTR m_help; ///< Its context, 0 for none: then help is asked for on what it stands over.
    bool m_hasHelp;
    QString m_text; ///< As it was given; what is shown may have been made breakable.
    ModalLoop m_loop;
};

/// Lets exceptions that report themselves do it in a message box.
int reportException(const CString& text, UINT type, UINT fallback) {
    return text.IsEmpty() && fallback != 0 ? AfxMessageBox(fallback, type) : AfxMessageBox(text.GetString(), type);
}

/// Tells about the file of the settings in a message box. Only the user-interface thread can show one, and only while
/// the application lives.
void tellAboutSettings(const std::string& text) {
    if (AfxGetApp() && AfxGetThread()) {
        AfxMessageBox(text.c_str(), MB_OK | MB_ICONEXCLAMATION);
    } else {
        std::fprintf(stderr, "%s\n", text.c_str());
    }
}

struct ReporterEntry {
    ReporterEntry() {
        tvx::setExceptionReporter(&reportException);
        tvx::setRegistryNotice(&tellAboutSettings);
    }
} const reporterEntry;

/// The text as a box shows it: what was collected line by line ends with a line end, which would be an empty line.
std::string shown(LPCSTR text) {
    std::string result(text ? text : "");
    result.erase(result.find_last_not_of("\r\n") + 1);
    return result;
}

/// The window that a box belongs to: the innermost modal dialog, which it must not be behind, one of the toolkit's too.
/// None while it is hidden, as a main frame is at the start, so that the window manager finds the place.
QWidget* visibleOwner(HWND owner) {
    QWidget* modal = QApplication::activeModalWidget();
    if (modal && modal->isVisible()) {
        return modal;
    }
    Window* window = Window::from(owner);
    QWidget* widget = window ? window->topLevel()->widget() : nullptr;
    return widget && widget->isVisible() ? widget : nullptr;
}

} // namespace

int MessageBoxA(HWND owner, LPCSTR text, LPCSTR caption, UINT type) {
    const std::string error = !caption ? fromQt(ownText(TVX_IDS_ERROR)) : std::string();
    caption = caption ? caption : error.c_str();
    if (!ensureGui()) {
        if (AskedFor::isNow()) {
            std::printf("%s\n", shown(text).c_str());
        } else {
            std::fprintf(stderr, "%s: %s\n", caption, shown(text).c_str());
        }
        return defaultOf(type).answer;
    }
    tvx::tellDialogOpens();
    Box box(owner, visibleOwner(owner), type);
    return box.ask(shown(text).c_str(), caption);
}

int AfxMessageBox(LPCSTR text, UINT type, UINT helpId) {
    CWinApp* app = AfxGetApp();
    return app ? app->DoMessageBox(text, type, helpId) : ::MessageBoxA(nullptr, text, nullptr, type);
}

int AfxMessageBox(UINT textId, UINT type, UINT helpId) {
    CString text;
    if (!text.LoadString(textId)) {
        text.Format("?%u", textId);
    }
    return AfxMessageBox(text.GetString(), type, helpId == static_cast<UINT>(-1) ? textId : helpId);
}

int CWnd::MessageBox(LPCSTR text, LPCSTR caption, UINT type) {
    // The name for display, as AfxMessageBox has it.
    const CWinApp* app = AfxGetApp();
    const LPCSTR name = app && app->m_pszAppName ? app->m_pszAppName : AfxGetAppName();
    return ::MessageBoxA(m_hWnd, text, caption ? caption : name, type);
}

BOOL MessageBeep(UINT) {
    if (ensureGui()) {
        QApplication::beep();
    }
    return TRUE;
}

namespace {

void formatStrings(CString& result, UINT formatId, LPCSTR first, LPCSTR second) {
    CString format;
    if (!format.LoadString(formatId)) {
        result.Empty();
        return;
    }
    CString text;
    for (const char* at = format.GetString(); *at != '\0'; ++at) {
        if (*at == '%' && (at[1] == '1' || at[1] == '2')) {
            ++at;
            text += *at == '1' ? first : second;
        } else {
            text += *at;
        }
    }
    result = text;
}

} // namespace

void AfxFormatString1(CString& result, UINT formatId, LPCSTR first) {
    formatStrings(result, formatId, first, "");
}

void AfxFormatString2(CString& result, UINT formatId, LPCSTR first, LPCSTR second) {
    formatStrings(result, formatId, first, second);
}
