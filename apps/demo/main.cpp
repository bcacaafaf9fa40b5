// karstgraph-demo: the host application's report screen, charting the bundled sample data through
// the KarstGraph component.
#include <QApplication>
#include <QCommandLineParser>
#include <QEvent>
#include <QTimer>
#include <cstdio>

#include "apps/demo/ComponentLibrary.h"
#include "apps/demo/DemoWindow.h"
#include "apps/demo/StartupClock.h"

namespace {

// Notes when the window first paints: the moment the user sees it.
class FirstPaint : public QObject {
public:
    double milliseconds = -1;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override
    {
        if (event->type() == QEvent::Paint && milliseconds < 0) milliseconds = kg::demo::millisecondsSinceStart();
        return QObject::eventFilter(watched, event);
    }
};

}  // namespace

int main(int argc, char** argv)
{
    QApplication app(argc, argv);
    QApplication::setApplicationName("Tavix Reports");

    QCommandLineParser parser;
    parser.setApplicationDescription("The Tavix report screen, charting the bundled sample data with KarstGraph.");
    parser.addHelpOption();
    const QCommandLineOption sample("sample",
                                    "Write the sample data into DIR (default: " + kg::demo::defaultSampleFolder() + ").",
                                    "DIR", kg::demo::defaultSampleFolder());
    const QCommandLineOption settings("settings", "Keep the chart style in FILE instead of the user's settings.", "FILE");
    const QCommandLineOption library("library",
                                     "Load the component from PATH (default: $KARSTGRAPH_LIBRARY, else "
                                     "../lib/libkarstgraph.so next to this program).",
                                     "PATH", QString::fromStdString(kg::demo::ComponentLibrary::defaultPath()));
    const QCommandLineOption startupTime("startup-time",
                                         "Print the time from start to the first window painted, then quit.");
    parser.addOptions({sample, settings, library, startupTime});
    parser.process(app);

    kg::demo::DemoWindow window({parser.value(sample), parser.value(settings), parser.value(library)});
    QObject::connect(&window, &kg::demo::DemoWindow::closed, &app, &QApplication::closeAllWindows,
                     Qt::QueuedConnection);
    FirstPaint firstPaint;
    window.installEventFilter(&firstPaint);
    window.loadSample();
    window.show();
    // The component is loaded once the window is up: the screen shows while the loader works.
    QTimer::singleShot(0, &window, [&] {
        window.connectComponent();
        if (!parser.isSet(startupTime)) return;
        const double ready = kg::demo::millisecondsSinceStart();
        // Let the first paint happen if it has not yet.
        QTimer::singleShot(50, &window, [&firstPaint, ready] {
            std::printf("first window painted after %.0f ms; component ready after %.0f ms\n",
                        firstPaint.milliseconds, ready);
            QApplication::quit();
        });
    });
    return QApplication::exec();
}
