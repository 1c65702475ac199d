#include "platform/afx/controls/detail/FolderCompletion.h"

#include "platform/afx/core/Message.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/win/detail/KernelObject.h"

#include <QEvent>
#include <QLineEdit>
#include <QScopedValueRollback>
#include <QScreen>
#include <QSocketNotifier>

#include <algorithm>

namespace tvx::afx {

namespace {

constexpr std::string_view separators = "\\/";
/// More lines help nobody: one more letter does.
constexpr std::size_t mostLines = 200;
constexpr int mostVisibleLines = 10;

/// Whether a name says itself where it begins.
bool isWhole(std::string_view name) {
    return name.substr(hasDrive(name) ? 2 : 0).find_first_of(separators) == 0;
}

/// Length of what two names have in common at their beginnings, case aside.
qsizetype commonLength(const QString& left, const QString& right) {
    const auto isSame = [](QChar a, QChar b) { return a.toCaseFolded() == b.toCaseFolded(); };
    return std::mismatch(left.begin(), left.end(), right.begin(), right.end(), isSame).first - left.begin();
}

} // namespace

FolderCompletion::FolderCompletion(QLineEdit& field) : m_field(field), m_list(new QListView) {
    m_list->setWindowFlags(Qt::ToolTip | Qt::FramelessWindowHint);
    m_list->setAttribute(Qt::WA_ShowWithoutActivating);
    m_list->setFocusPolicy(Qt::NoFocus);
    m_list->setModel(&m_lines);
    m_list->setUniformItemSizes(true);
    m_list->setEditTriggers(QAbstractItemView::NoEditTriggers);
    m_list->setTextElideMode(Qt::ElideMiddle);
    m_list->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    m_list->setMouseTracking(true);
    connectStoring(&m_field, &QLineEdit::textEdited, this, [this] { look(); });
    connectStoring(m_list.data(), &QListView::entered, this,
                   [this](const QModelIndex& line) { m_list->setCurrentIndex(line); });
    connectStoring(m_list.data(), &QListView::clicked, this,
                   [this](const QModelIndex& line) { take(line.data().toString()); });
    m_field.installEventFilter(this);
    m_field.window()->installEventFilter(this);
}

FolderCompletion::~FolderCompletion() {
    delete m_list; // unless the window around it has done so
}

bool FolderCompletion::isOpen() const {
    return m_list && m_list->isVisible();
}

bool FolderCompletion::eventFilter(QObject* watched, QEvent* event) {
    switch (event->type()) {
    case QEvent::FocusIn:
        // The list belongs to the window that the field is in now; it moves and goes with that.
        m_field.window()->installEventFilter(this);
        break;
    case QEvent::FocusOut:
    case QEvent::Hide:
    case QEvent::Move:
    case QEvent::Resize:
    case QEvent::WindowDeactivate:
    case QEvent::Close:
        if (isOpen()) {
            close();
        }
        break;
    default:
        break;
    }
    return QObject::eventFilter(watched, event);
}

// --- names ---

std::optional<FolderCompletion::Typed> FolderCompletion::typed() const {
    const std::string text = fromQt(m_field.text());
    const std::size_t end = text.find_last_of(separators) + 1;
    const bool atEnd = m_field.cursorPosition() == m_field.text().size();
    if (!atEnd || end == 0 || !isWhole(text)) {
        return std::nullopt;
    }
    return Typed{text.substr(0, end), text.substr(end)};
}

void FolderCompletion::look() {
    const auto now = m_taking ? std::nullopt : typed();
    if (!now) {
        close();
        return;
    }
    const HiddenFolders hidden = now->start.starts_with('.') ? HiddenFolders::Include : HiddenFolders::LeaveOut;
    if (now->folder != m_folder || hidden != m_hidden) {
        m_hidden = hidden;
        ask(*now);
    }
    if (m_question.isAnswered()) {
        show(*now);
    } else {
        close();
    }
}

void FolderCompletion::ask(const Typed& typed) {
    m_folder = typed.folder;
    m_question = Question<FolderNames>([folder = m_folder, hidden = m_hidden] { return readFolders(folder, hidden); });
    m_notifier.reset();
    if (const auto signal = m_question.isAnswered() ? nullptr : win::objectOf(m_question.handle())) {
        m_notifier = std::make_unique<QSocketNotifier>(signal->descriptor(), QSocketNotifier::Read);
        connectStoring(m_notifier.get(), &QSocketNotifier::activated, this, [this] { answered(); });
    }
}

void FolderCompletion::answered() {
    m_notifier->setEnabled(false);
    const auto now = typed();
    if (now && now->folder == m_folder && m_field.hasFocus()) {
        show(*now);
    }
}

// --- the list ---

void FolderCompletion::show(const Typed& typed) {
    QStringList lines;
    for (const std::string& name : m_question.answer().names) {
        if (text::startsWithNoCase(name, typed.start) && name.find_first_of(separators) == std::string::npos) {
            lines.append(toQt(name.c_str()));
        }
        if (std::cmp_equal(lines.size(), mostLines)) {
            break;
        }
    }
    // A name that is typed to its end needs no help.
    if (lines.isEmpty() || (lines.size() == 1 && lines.front() == toQt(typed.start.c_str()))) {
        close();
        return;
    }
    m_lines.setStringList(lines);
    m_list->setCurrentIndex({});
    place();
    m_list->show();
}

void FolderCompletion::place() {
    const QFontMetrics metrics(m_list->font());
    const int line = std::max(m_list->sizeHintForRow(0), metrics.height());
    const int lines = std::min(m_lines.rowCount(), mostVisibleLines);
    QRect area(m_field.mapToGlobal(QPoint(0, m_field.height())),
               QSize(m_field.width(), lines * line + 2 * m_list->frameWidth()));
    const QRect screen = m_field.screen()->availableGeometry();
    if (area.bottom() > screen.bottom()) {
        area.moveBottom(m_field.mapToGlobal(QPoint(0, 0)).y() - 1);
    }
    m_list->setFont(m_field.font());
    // Over the dialog that is modal, and only over that.
    if (m_list->parentWidget() != m_field.window()) {
        m_list->setParent(m_field.window(), m_list->windowFlags());
    }
    m_list->setGeometry(area);
}

void FolderCompletion::close() {
    m_list->hide();
}

void FolderCompletion::move(int rows) {
    const int count = m_lines.rowCount();
    const int current = m_list->currentIndex().row();
    const int first = rows > 0 ? -1 : count;
    const int target = std::clamp((current < 0 ? first : current) + rows, 0, count - 1);
    m_list->setCurrentIndex(m_lines.index(target));
}

void FolderCompletion::take(const QString& name) {
    const QString text = m_field.text();
    const qsizetype start = std::max(text.lastIndexOf(u'\\'), text.lastIndexOf(u'/')) + 1;
    m_field.setSelection(static_cast<int>(start), static_cast<int>(text.size() - start));
    const QScopedValueRollback taking(m_taking, true);
    m_field.insert(name);
}

QString FolderCompletion::common() const {
    const QStringList lines = m_lines.stringList();
    qsizetype length = lines.front().size();
    for (const QString& line : lines) {
        length = std::min(length, commonLength(lines.front(), line));
    }
    const auto now = typed();
    return now && length > toQt(now->start.c_str()).size() ? lines.front().left(length) : QString();
}

// --- keys ---

bool FolderCompletion::wantsKey(WPARAM key) const {
    if (!isOpen()) {
        return false;
    }
    const bool hasLine = m_list->currentIndex().isValid();
    switch (key) {
    case VK_UP:
    case VK_DOWN:
    case VK_PRIOR:
    case VK_NEXT:
    case VK_ESCAPE:
        return true;
    case VK_RETURN:
        return hasLine;
    case VK_TAB:
        return !isKeyDown(VK_SHIFT) && (hasLine || !common().isEmpty());
    default:
        return false;
    }
}

bool FolderCompletion::takeKey(WPARAM key) {
    if (!wantsKey(key)) {
        return false;
    }
    switch (key) {
    case VK_UP:
    case VK_DOWN:
        move(key == VK_UP ? -1 : 1);
        break;
    case VK_PRIOR:
    case VK_NEXT:
        move(key == VK_PRIOR ? -mostVisibleLines : mostVisibleLines);
        break;
    case VK_ESCAPE:
        close();
        break;
    default:
        if (const QModelIndex line = m_list->currentIndex(); line.isValid()) {
            take(line.data().toString());
        } else {
            take(common());
            look();
        }
    }
    return true;
}

} // namespace tvx::afx
