#pragma once
// What the demo host's tests share: a scratch folder with a private registration file and settings
// file, the component loaded from this build, and helpers that answer the component's modal
// dialogs and message boxes the way a user would, from inside their event loops.
#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QDir>
#include <QElapsedTimer>
#include <QMessageBox>
#include <QPointer>
#include <QTemporaryDir>
#include <QTimer>
#include <functional>
#include <memory>

#include "apps/demo/ComponentLibrary.h"

namespace demo_test {

inline QString componentLibrary() { return QStringLiteral(KG_BUILD_DIR "/lib/libkarstgraph.so"); }

// A folder for one test program: registration, settings and sample live there, never in the
// user's own files.
inline QTemporaryDir& scratch()
{
    static QTemporaryDir dir = [] {
        const QString base = qEnvironmentVariableIsEmpty("KG_TEST_TMP") ? QDir::tempPath() : qEnvironmentVariable("KG_TEST_TMP");
        QDir().mkpath(base);
        return QTemporaryDir(base + "/demo-XXXXXX");
    }();
    return dir;
}

// Points the component's registration at the scratch folder; call before the component is loaded.
inline void usePrivateRegistration()
{
    qputenv("KARSTGRAPH_REGISTRY", (scratch().path() + "/registry.ini").toLocal8Bit());
    qputenv("KARSTGRAPH_LIBRARY", componentLibrary().toLocal8Bit());
}

inline QWidget* visibleTopLevel(const QString& objectName)
{
    for (QWidget* w : QApplication::topLevelWidgets())
        if (w->isVisible() && w->objectName() == objectName) return w;
    return nullptr;
}

inline QMessageBox* visibleMessageBox()
{
    for (QWidget* w : QApplication::topLevelWidgets())
        if (auto* box = qobject_cast<QMessageBox*>(w); box && box->isVisible()) return box;
    return nullptr;
}

// Watches, from the event loop that a modal dialog runs, for a window that `find` returns, and
// works it with `act` once. A window that never comes leaves done() false; whatever modal window is
// up after the time allowed is closed, so a test fails rather than hangs.
class WhenShown {
public:
    WhenShown(std::function<QWidget*()> find, std::function<void(QWidget*)> act)
        : find_(std::move(find)), act_(std::move(act)), timer_(std::make_unique<QTimer>())
    {
        clock_.start();
        QObject::connect(timer_.get(), &QTimer::timeout, [this] { poll(); });
        timer_->start(10);
    }
    bool done() const { return done_; }

private:
    void poll()
    {
        if (QWidget* w = find_()) {
            timer_->stop();
            done_ = true;
            act_(w);
            return;
        }
        if (clock_.elapsed() > 10000) {
            timer_->stop();
            if (QWidget* modal = QApplication::activeModalWidget()) modal->close();
        }
    }

    std::function<QWidget*()> find_;
    std::function<void(QWidget*)> act_;
    std::unique_ptr<QTimer> timer_;
    QElapsedTimer clock_;
    bool done_ = false;
};

// Clicks the buttons named in `names`, in order, inside `window`.
inline void clickIn(QWidget* window, std::initializer_list<const char*> names)
{
    for (const char* name : names) {
        auto* button = window->findChild<QAbstractButton*>(name);
        ASSERT_NE(button, nullptr) << name << " in " << window->objectName().toStdString();
        button->click();
    }
}

}  // namespace demo_test
