#pragma once

#include <QApplication>
#include <QTimer>
#include <QWidget>

#include <functional>
#include <utility>

/// Does something in the next modal dialog, once that has the keyboard.
inline void inDialog(std::function<void()> act) {
    auto* timer = new QTimer(qApp);
    QObject::connect(timer, &QTimer::timeout, timer, [timer, act = std::move(act)] {
        const QWidget* dialog = QApplication::activeModalWidget();
        const QWidget* focus = QApplication::focusWidget();
        if (dialog && focus && focus->window() == dialog) {
            timer->stop();
            timer->deleteLater();
            act();
        }
    });
    timer->start(0);
}
