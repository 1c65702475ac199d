#include "platform/afx/controls/detail/TipWindow.h"

#include "platform/afx/controls/ToolTip.h"
#include "platform/afx/core/detail/Connect.h"

#include <QEvent>
#include <QStyle>
#include <QTextDocument>
#include <QToolTip>

#include <algorithm>

namespace tvx::afx {

namespace {

std::vector<const TipWindow*>& controls() {
    static std::vector<const TipWindow*> all;
    return all;
}

std::unique_ptr<Window> makeTips(const CREATESTRUCT& cs) {
    return std::make_unique<TipWindow>(cs);
}

const WindowClassEntry tipEntry("tooltips_class32", &makeTips);

/// From one tool to the next the tip follows at once, as the toolkit's own do.
constexpr int followDelay = 20;
/// Longer lines than this are broken.
constexpr qsizetype longLine = 100;

bool isPress(UINT message) {
    switch (message) {
    case WM_LBUTTONDOWN:
    case WM_LBUTTONDBLCLK:
    case WM_MBUTTONDOWN:
    case WM_MBUTTONDBLCLK:
    case WM_RBUTTONDOWN:
    case WM_RBUTTONDBLCLK:
        return true;
    default:
        return false;
    }
}

} // namespace

QString tipText(const QString& text) {
    const bool needsMarkUp = Qt::mightBeRichText(text) || text.size() > longLine;
    return needsMarkUp ? Qt::convertFromPlainText(text, Qt::WhiteSpaceNormal) : text;
}

TipWindow::TipWindow(const CREATESTRUCT& cs) : Window(cs) {
    m_rest.setSingleShot(true);
    connectStoring(&m_rest, &QTimer::timeout, this, [this] { show(); });
    controls().push_back(this);
}

TipWindow::~TipWindow() {
    std::erase(controls(), this);
}

QWidget* TipWindow::makeWidget(QWidget* parent) {
    auto* carrier = new QWidget(parent);
    carrier->setAttribute(Qt::WA_TransparentForMouseEvents);
    return carrier;
}

LRESULT TipWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_DESTROY) {
        activate(false);
    }
    return Window::defaultProc(message, wParam, lParam);
}

// --- tools ---

void TipWindow::add(const Key& key, const QRect& place, const QString& text) {
    m_tools.insert_or_assign(key, Tool{place, text});
    peerOf(key.first)->installEventFilter(this);
}

void TipWindow::setPlace(const Key& key, const QRect& place) {
    const auto tool = m_tools.find(key);
    if (tool == m_tools.end() || tool->second.place == place) {
        return;
    }
    tool->second.place = place;
    if (m_under == key && !place.contains(m_point)) {
        leave();
    } else if (m_under == key && isShown()) {
        show();
    }
}

void TipWindow::setText(const Key& key, const QString& text) {
    const auto tool = m_tools.find(key);
    if (tool == m_tools.end()) {
        return;
    }
    tool->second.text = text;
    if (m_under == key && isShown()) {
        show();
    }
}

TipWindow::Tools::const_iterator TipWindow::toolAt(HWND window, QPoint point) const {
    return std::ranges::find_if(m_tools, [&](const Tools::value_type& tool) {
        return tool.first.first == window && tool.second.place.contains(point);
    });
}

bool TipWindow::tellsAt(const Window& window, QPoint point) {
    return std::ranges::any_of(controls(), [&](const TipWindow* control) {
        const auto tool = control->toolAt(window.handle(), point);
        return control->m_isActive && tool != control->m_tools.end() && !tool->second.text.isEmpty();
    });
}

// --- the pointer ---

void TipWindow::activate(bool active) {
    if (std::exchange(m_isActive, active) && !active) {
        leave();
    }
}

void TipWindow::relay(const MSG& message) {
    if (!m_isActive) {
        return;
    }
    if (isPress(message.message)) {
        m_rest.stop();
        hide();
    } else if (message.message == WM_MOUSEMOVE && (message.wParam & (MK_LBUTTON | MK_MBUTTON | MK_RBUTTON)) == 0) {
        moveTo(message.hwnd, QPoint(GET_X_LPARAM(message.lParam), GET_Y_LPARAM(message.lParam)));
    }
}

void TipWindow::moveTo(HWND window, QPoint point) {
    const auto tool = toolAt(window, point);
    const QWidget* widget = peerOf(window);
    if (tool == m_tools.end() || !widget) {
        leave();
        return;
    }
    m_point = point;
    if (m_under == tool->first && !m_rest.isActive()) {
        return; // it is shown, or a press has sent it away
    }
    if (m_under != tool->first) {
        hide();
        m_under = tool->first;
    }
    const QStyle& style = *widget->style();
    const bool follows = m_awake.isValid() && !m_awake.hasExpired(style.styleHint(QStyle::SH_ToolTip_FallAsleepDelay));
    m_rest.start(follows ? followDelay : style.styleHint(QStyle::SH_ToolTip_WakeUpDelay, nullptr, widget));
}

void TipWindow::leave() {
    m_rest.stop();
    hide();
    m_under = {};
}

bool TipWindow::eventFilter(QObject*, QEvent* event) {
    const QEvent::Type type = event->type();
    if (type == QEvent::Leave || type == QEvent::Hide || type == QEvent::WindowDeactivate) {
        leave();
    }
    return false;
}

// --- the tip ---

bool TipWindow::isShown() const {
    return !m_shown.isEmpty() && QToolTip::isVisible() && QToolTip::text() == m_shown;
}

void TipWindow::show() {
    const auto tool = m_tools.find(m_under);
    const Window* window = from(m_under.first);
    QWidget* widget = window ? window->clientWidget() : nullptr;
    if (tool == m_tools.end() || !widget || !widget->isVisible()) {
        return;
    }
    QString text = tool->second.text;
    if (text.isEmpty()) {
        hide();
        return;
    }
    if (!widget->isActiveWindow() && (style() & TTS_ALWAYSTIP) == 0) {
        return;
    }
    const auto* cutting = dynamic_cast<const CutTexts*>(window);
    const QString whole = cutting ? cutting->cutTextAt(m_point) : QString();
    if (!whole.isEmpty() && whole != text) {
        text += QLatin1Char('\n') + whole;
    }
    m_shown = tipText(text);
    const QPoint origin = window->clientRect().topLeft();
    QToolTip::showText(widget->mapToGlobal(m_point + origin), m_shown, widget, tool->second.place.translated(origin));
}

void TipWindow::hide() {
    if (isShown()) {
        m_awake.start();
        QToolTip::hideText();
    }
    m_shown.clear();
}

} // namespace tvx::afx

// --- the control ---

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CToolTipCtrl, CWnd)

namespace {

TipWindow* tipsOf(const CToolTipCtrl& control) {
    return dynamic_cast<TipWindow*>(control.GetState());
}

CString loaded(UINT id) {
    CString text;
    text.LoadString(id);
    return text;
}

} // namespace

BOOL CToolTipCtrl::Create(CWnd* parent, DWORD style) {
    return CWnd::Create("tooltips_class32", nullptr, WS_CHILD | style, CRect(0, 0, 0, 0), parent, 0);
}

BOOL CToolTipCtrl::AddTool(CWnd* window, LPCSTR text, const RECT* rect, UINT_PTR tool) {
    TipWindow* tips = tipsOf(*this);
    if (!tips || !peerOf(window->GetSafeHwnd())) {
        return FALSE;
    }
    tips->add({window->m_hWnd, tool}, toQt(*rect), toQt(text));
    return TRUE;
}

BOOL CToolTipCtrl::AddTool(CWnd* window, UINT text, const RECT* rect, UINT_PTR tool) {
    return AddTool(window, loaded(text), rect, tool);
}

void CToolTipCtrl::SetToolRect(CWnd* window, UINT_PTR tool, const RECT* rect) {
    if (TipWindow* tips = tipsOf(*this)) {
        tips->setPlace({window->GetSafeHwnd(), tool}, toQt(*rect));
    }
}

void CToolTipCtrl::UpdateTipText(LPCSTR text, CWnd* window, UINT_PTR tool) {
    if (TipWindow* tips = tipsOf(*this)) {
        tips->setText({window->GetSafeHwnd(), tool}, toQt(text));
    }
}

void CToolTipCtrl::UpdateTipText(UINT text, CWnd* window, UINT_PTR tool) {
    UpdateTipText(loaded(text), window, tool);
}

void CToolTipCtrl::Activate(BOOL activate) {
    if (TipWindow* tips = tipsOf(*this)) {
        tips->activate(activate != FALSE);
    }
}

void CToolTipCtrl::RelayEvent(MSG* message) {
    if (TipWindow* tips = tipsOf(*this)) {
        tips->relay(*message);
    }
}
