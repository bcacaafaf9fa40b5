#pragma once
// The demo host's report screen: "Tavix Reports — KarstGraph demo". The source form (ReportForm)
// filled from the bundled sample, a button per chart request, and a status bar that says what the
// last request did: "Drew <request>" or "Error N: description".
#include <QMainWindow>
#include <QString>

#include "apps/demo/GraphClient.h"
#include "apps/demo/ReportRequests.h"

class QPushButton;

namespace kg::demo {

class ReportForm;

struct DemoOptions {
    QString sampleFolder;  // where the sample is written
    QString settingsFile;  // empty: the user's own chart settings
    QString libraryPath;   // the component's shared library
};

// $XDG_CACHE_HOME (or ~/.cache) followed by /karstgraph/sample.
QString defaultSampleFolder();

class DemoWindow : public QMainWindow {
    Q_OBJECT
public:
    explicit DemoWindow(DemoOptions options, QWidget* parent = nullptr);
    ~DemoWindow() override;

    // Writes the sample and fills the form from it. False (and the status bar tells why) when the
    // sample cannot be written or read.
    bool loadSample();
    // Loads the component and hands it the form; false (and the status bar tells why) when it fails.
    bool connectComponent();

    ReportForm* form() const { return form_; }
    QPushButton* requestButton(const ReportRequest& request) const;
    // Runs one request as its button does.
    void runRequest(const ReportRequest& request);

signals:
    void closed();

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    QWidget* makeRequestPanel();
    void makeMenus();
    void showStatus(const QString& text);

    DemoOptions options_;
    ReportForm* form_;
    GraphClient client_;
    KGObject* sourceForm_ = nullptr;
    QString sampleDatabase_;
};

}  // namespace kg::demo
