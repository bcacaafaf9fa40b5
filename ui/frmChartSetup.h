#pragma once
// The chart style dialog "Select Chart Styles": chart type, 3-D view with rotation, elevation and
// depth, and whether value labels are on by default. It opens with the style stored in the host's
// settings store (section "2dCharts"); OK stores the choice there and applies it to goChart,
// Cancel leaves both alone.
//
// The chart window's "Chart Settings" command:
//   kg::ui::showChartSetup();        // modal; returns after OK or Cancel
//   kg::modMain::chart().DrawChart(kg::modMain::gvArray);
//
// Choices that are ours to make:
//   - A stored "View3D" that the box cannot show (anything but 0 and 1, also a number too large for
//     a whole number) leaves the box as designed, ticked. Text without a number reads as 0.
//   - A stored rotation, elevation or depth beyond -45..45 is shown clamped to the limits (a number
//     beyond the Double range to the limit of its sign), and only OK stores the clamped value.
//   - An emptied field is stored as "" (it has no number text) and gives the chart 0.
//   - A failure of the host's objects while loading or on OK closes the dialog and leaves
//     showChartSetup() as that error; what was stored before the failure stays stored.
#include <QDialog>
#include <exception>
#include <string>

class QButtonGroup;
class QCheckBox;
class QGroupBox;
class QLabel;
class QPushButton;
class QRadioButton;

namespace kg::ui {

class NumericField;

class frmChartSetup : public QDialog {
    Q_OBJECT
public:
    // Lays out the controls as designed, then loads the stored style (Form_Load); a failing
    // host object raises kg::Error from here.
    explicit frmChartSetup(QWidget* parent = nullptr);

    QGroupBox* Frame1 = nullptr;            // "View 3D"
    QCheckBox* chk3D = nullptr;
    NumericField* num3D[3] = {};            // rotation, elevation, depth: -45..45
    QLabel* Label1 = nullptr;               // "Rotation"
    QLabel* Label2 = nullptr;               // "Elevation"
    QLabel* Label3 = nullptr;               // "Depth"
    QGroupBox* Frame2 = nullptr;            // "Chart Type"
    QRadioButton* optChartType[4] = {};     // Plot, Bar, Area, Pie
    QRadioButton* optLabel[2] = {};         // labels on, labels off by default
    QLabel* Label4 = nullptr;               // the note about the advanced help
    QPushButton* Command1 = nullptr;        // OK
    QPushButton* Command2 = nullptr;        // Cancel

    // 1 ticked, 0 cleared.
    int16_t chk3DValue() const;
    // Sets the box as the stored number says; see the header comment for other numbers.
    void setChk3DValue(int16_t value);

    void Form_Load();
    void chk3D_Click();
    void Command1_Click();
    void Command2_Click();

    // The error that ended a command while the dialog ran (it cannot cross Qt's event loop);
    // rethrown by showChartSetup() once the dialog has closed.
    void rethrowPendingError();

protected:
    void done(int result) override;

private:
    void buildControls();
    void runCommand(void (frmChartSetup::*command)());
    void Form_QueryUnload();

    QButtonGroup* chartTypeGroup_ = nullptr;
    QButtonGroup* labelGroup_ = nullptr;
    std::exception_ptr pendingError_;
    bool unloaded_ = false;
};

// Shows the dialog modally through the prompter. Errors of the host's objects leave as kg::Error.
void showChartSetup();

}  // namespace kg::ui
