#pragma once
// The help text window "Chart Mouse and Keyboard Functions": what the chart control does with the
// mouse and the keys, in a read-only rich text box (Text1) that fills the window. Modeless and
// without owner; one instance, which the host's application services place under "ChartHelp".
//
// The chart window's "Mouse and Keys Help" command:
//   kg::ui::showChartHelp();         // first call creates and loads it, later calls raise it
//
// Closing deletes the window (after its placement was saved); the next showChartHelp() creates
// a new one. With no application services left to tell (the chart window was closed first and
// released them), the window closes without saving its placement.
#include <QWidget>

class QTextBrowser;

namespace kg::ui {

class frmChartHelp : public QWidget {
    Q_OBJECT
public:
    frmChartHelp();

    QTextBrowser* Text1 = nullptr;

    // Reports the load and restores the stored placement; errors of the host's objects leave as kg::Error.
    void Form_Load();
    // True once the window is closing: it is about to be deleted and must not be shown again.
    bool isUnloaded() const { return unloaded_; }

protected:
    void resizeEvent(QResizeEvent* event) override;
    void closeEvent(QCloseEvent* event) override;

private:
    void Form_Resize();
    void Form_QueryUnload();
    bool unloaded_ = false;
};

// Shows the help window, creating and loading it when there is none; errors of the host's objects
// while loading leave as kg::Error (no window is left behind).
void showChartHelp();
// The help window on show, or null when there is none (never shown, or closed).
frmChartHelp* chartHelpWindow();

}  // namespace kg::ui
