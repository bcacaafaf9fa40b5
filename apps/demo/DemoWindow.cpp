#include "apps/demo/DemoWindow.h"

#include <QAction>
#include <QApplication>
#include <QCloseEvent>
#include <QDir>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QMenuBar>
#include <QPushButton>
#include <QStatusBar>
#include <QVBoxLayout>

#include "apps/demo/FormObjects.h"
#include "apps/demo/ReportForm.h"
#include "core/Error.h"
#include "teststand/SampleData.h"

namespace kg::demo {

namespace {

struct ButtonGroup {
    const char* title;
    int first, count;  // places in reportRequests()
};
const ButtonGroup kGroups[] = {{"Hourly", 0, 3}, {"Prop graphs", 3, 3}, {"Yearly", 6, 3}, {"Quote types", 9, 3},
                               {"Jobs", 12, 1}};

}  // namespace

QString defaultSampleFolder()
{
    QString cache = qEnvironmentVariable("XDG_CACHE_HOME");
    // A relative base directory is to be ignored, as the base directory rules say.
    if (cache.isEmpty() || QDir::isRelativePath(cache)) cache = QDir::homePath() + "/.cache";
    return cache + "/karstgraph/sample";
}

DemoWindow::DemoWindow(DemoOptions options, QWidget* parent) : QMainWindow(parent), options_(std::move(options))
{
    setObjectName("frmTavixReports");
    setWindowTitle(QString::fromUtf8("Tavix Reports \u2014 KarstGraph demo"));
    form_ = new ReportForm(this);

    auto* central = new QWidget(this);
    auto* layout = new QHBoxLayout(central);
    layout->addWidget(form_, 1);
    layout->addWidget(makeRequestPanel());
    setCentralWidget(central);
    makeMenus();
    statusBar()->setObjectName("statusBar");
    resize(1100, 640);
}

DemoWindow::~DemoWindow()
{
    if (sourceForm_) client_.api().Release(sourceForm_);
}

QWidget* DemoWindow::makeRequestPanel()
{
    auto* panel = new QWidget(this);
    auto* column = new QVBoxLayout(panel);
    column->setContentsMargins(0, 0, 0, 0);
    const std::vector<ReportRequest>& requests = reportRequests();
    for (const ButtonGroup& g : kGroups) {
        auto* box = new QGroupBox(tr(g.title), panel);
        auto* grid = new QGridLayout(box);
        for (int i = 0; i < g.count; ++i) {
            const ReportRequest& request = requests[size_t(g.first + i)];
            auto* button = new QPushButton(tr(request.caption), box);
            button->setObjectName(QString::fromStdString(buttonName(request)));
            button->setToolTip(QString::fromLatin1(request.name));
            connect(button, &QPushButton::clicked, this, [this, &request] { runRequest(request); });
            grid->addWidget(button, i / 3, i % 3);
        }
        column->addWidget(box);
    }
    column->addStretch(1);
    return panel;
}

void DemoWindow::makeMenus()
{
    QMenu* file = menuBar()->addMenu(tr("&File"));
    QAction* reload = file->addAction(tr("&Reload sample data"), this, [this] {
        if (loadSample()) showStatus(tr("Sample data reloaded from %1").arg(options_.sampleFolder));
    });
    reload->setShortcut(QKeySequence::Refresh);
    file->addSeparator();
    QAction* quit = file->addAction(tr("&Quit"), this, &QWidget::close);
    quit->setShortcut(QKeySequence::Quit);

    QMenu* reports = menuBar()->addMenu(tr("&Reports"));
    for (const ReportRequest& request : reportRequests())
        reports->addAction(tr(request.caption), this, [this, &request] { runRequest(request); });
}

QPushButton* DemoWindow::requestButton(const ReportRequest& request) const
{
    return findChild<QPushButton*>(QString::fromStdString(buttonName(request)));
}

void DemoWindow::showStatus(const QString& text) { statusBar()->showMessage(text); }

bool DemoWindow::loadSample()
{
    QString why;
    try {
        const teststand::SampleData sample = teststand::writeSampleData(options_.sampleFolder.toStdString());
        sampleDatabase_ = QString::fromStdString(sample.database);
        ReportData data;
        if (loadReportData(QString::fromStdString(sample.form), data, why)) {
            form_->fill(data);
            return true;
        }
    } catch (const Error& e) {
        why = QString::fromStdString(e.description());
    }
    showStatus(tr("Cannot load the sample data: %1").arg(why));
    return false;
}

bool DemoWindow::connectComponent()
{
    Outcome out = client_.connect(options_.libraryPath.toStdString());
    if (out.ok) out = client_.setHostOption("jobsDatabase", sampleDatabase_.toStdString());
    if (out.ok && !options_.settingsFile.isEmpty())
        out = client_.setHostOption("settingsFile", options_.settingsFile.toStdString());
    if (out.ok && !sourceForm_) sourceForm_ = makeSourceForm(client_.api(), form_);
    if (out.ok) out = client_.setSourceForm(sourceForm_);
    if (!out.ok) {
        showStatus(QString::fromStdString(out.errorText()));
        return false;
    }
    showStatus(tr("Ready: %1 from %2%3")
                   .arg(KG_PROGID, QString::fromStdString(client_.servingLibrary()),
                        client_.registered() ? tr(" (registered now)") : QString()));
    return true;
}

void DemoWindow::runRequest(const ReportRequest& request)
{
    if (!client_.isConnected() && !connectComponent()) return;
    showStatus(tr("Drawing %1...").arg(tr(request.caption)));
    Outcome out;
    if (request.grid) {
        const ReportTotals totals = form_->totals();
        const QString grid = QString::fromLatin1(request.grid);
        const double total = grid == "grid1" ? totals.quantity : grid == "grid2" ? totals.value : totals.average;
        out = client_.request(request.dispid, form_->dataRows(grid), total);
    } else {
        out = client_.request(request.dispid);
    }
    showStatus(out.ok ? tr("Drew %1").arg(tr(request.caption)) : QString::fromStdString(out.errorText()));
}

void DemoWindow::closeEvent(QCloseEvent* event)
{
    event->accept();
    emit closed();
}

}  // namespace kg::demo
