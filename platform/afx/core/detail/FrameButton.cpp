#include "platform/afx/core/detail/FrameButton.h"

#include "platform/afx/core/detail/MenuWidgets.h"
#include "platform/afx/core/detail/Window.h"

#include <QAccessible>

#include <utility>

namespace tvx::afx {

FrameButton::FrameButton(const Window& window, const QString& name, UINT command)
    : m_window(window.handle()), m_name(name), m_command(command) {}

FrameButton::~FrameButton() {
    QAccessibleEvent gone(this, QAccessible::ObjectDestroyed);
    QAccessible::updateAccessibility(&gone);
}

void FrameButton::setPlace(const QRect& place) {
    const QRect before = std::exchange(m_place, place);
    if (before != place) {
        QAccessibleEvent changed(this, before.isNull() ? QAccessible::ObjectCreated : QAccessible::LocationChanged);
        QAccessible::updateAccessibility(&changed);
    }
}

const Window* FrameButton::window() const {
    return Window::from(m_window);
}

QRect FrameButton::screenPlace() const {
    const Window* window = this->window();
    const QWidget* widget = window ? window->widget() : nullptr;
    if (!widget || !widget->isVisible()) {
        return {};
    }
    // A caption may not be there at the moment, that of a maximised child frame.
    const QRect place(widget->mapToGlobal(m_place.topLeft()), m_place.size());
    return window->hitTest(place.center()) != HTCLIENT ? place : QRect();
}

void FrameButton::press() const {
    postMenuCommand(m_window, m_command, true);
}

} // namespace tvx::afx
