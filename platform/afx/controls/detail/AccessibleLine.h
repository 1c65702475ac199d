#pragma once

/// @file
/// What stands for one line of a list or a tree among assistive tools.

#include <QAccessible>
#include <QPointer>
#include <QWidget>

namespace tvx::afx {

/// A line that its control paints: it has neither a widget nor children of its own, and can be pressed.
class AccessibleLine : public QAccessibleInterface, public QAccessibleActionInterface {
public:
    QObject* object() const override {
        return nullptr;
    }
    QWindow* window() const override {
        return m_control ? m_control->window()->windowHandle() : nullptr;
    }
    QAccessibleInterface* parent() const override {
        return QAccessible::queryAccessibleInterface(m_control.data());
    }
    QAccessibleInterface* child(int) const override {
        return nullptr;
    }
    QAccessibleInterface* childAt(int, int) const override {
        return nullptr;
    }
    int childCount() const override {
        return 0;
    }
    int indexOfChild(const QAccessibleInterface*) const override {
        return -1;
    }
    void setText(QAccessible::Text, const QString&) override {}
    void* interface_cast(QAccessible::InterfaceType type) override {
        return type == QAccessible::ActionInterface ? static_cast<QAccessibleActionInterface*>(this) : nullptr;
    }
    QStringList keyBindingsForAction(const QString&) const override {
        return {};
    }

protected:
    explicit AccessibleLine(QWidget& control) : m_control(&control) {}
    /// The part of a line that is seen, on the screen.
    static QRect seenOf(const QWidget& area, const QRect& line) {
        const QRect seen = line.intersected(area.rect());
        return {area.mapToGlobal(seen.topLeft()), seen.size()};
    }
    /// The control; null when it has ended.
    QWidget* control() const {
        return m_control;
    }

private:
    QPointer<QWidget> m_control;
};

} // namespace tvx::afx
