#pragma once

#include <QApplication>
#include <QTimer>
#include <QWidget>

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <utility>

namespace quarn::desktop::test {

/// The control of a window with an object name; the test fails when there is none.
template <typename Widget = QWidget> Widget& part(const QWidget& window, const QString& name) {
    auto* const widget = window.findChild<Widget*>(name);
    if (!widget)
        ADD_FAILURE() << name.toStdString() << " is missing";
    static Widget missing;
    return widget ? *widget : missing;
}

/// Does something in a modal window of this object name once it is shown, out of the event loop
/// that the window waits in. One that is not shown within ten seconds fails the test, and what is
/// open instead is closed.
inline void onceShown(const QString& name, std::function<void(QWidget&)> act) {
    constexpr int step_ms = 10;
    auto* const timer = new QTimer(qApp);
    auto looks = std::make_shared<int>(0);
    QObject::connect(timer, &QTimer::timeout, timer, [=, act = std::move(act)] {
        QWidget* const window = QApplication::activeModalWidget();
        if (window && window->objectName() == name && window->isVisible()) {
            timer->stop();
            timer->deleteLater();
            act(*window);
        } else if (++*looks > 1000) {
            timer->stop();
            timer->deleteLater();
            ADD_FAILURE() << name.toStdString() << " was not shown";
            if (window)
                window->close();
        }
    });
    timer->start(step_ms);
}

} // namespace quarn::desktop::test
