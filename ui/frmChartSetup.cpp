#include "ui/frmChartSetup.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>
#include <cmath>
#include <utility>

#include "chart/ChartStyle.h"
#include "requests/modMain.h"
#include "core/Convert.h"
#include "core/Error.h"
#include "ui/NumericField.h"
#include "ui/Prompter.h"
#include "ui/WindowObject.h"

namespace kg::ui {

namespace {

using chartstyle::Key;
constexpr Key kFieldKeys[3] = {Key::Rotation, Key::Elevation, Key::Depth};
constexpr const char* kFieldCaptions[3] = {"Rotation", "Elevation", "Depth"};
constexpr int kFieldMinimum = -45;
constexpr int kFieldMaximum = 45;
constexpr double kFieldDesignValue = 10;

// optChartType by index: chartstyle::kStyleNames.
constexpr int kDesignChartType = 1;  // Bar
constexpr int kDesignLabel = 1;      // labels off

void logEvent(const char* event)
{
    call(modMain::goAppServices, "LogFormEvent", {Variant(event), Variant("frmChartSetup")});
}

std::string readSetting(Key key) { return chartstyle::read(modMain::goAppServices, modMain::goSettings, key); }

void writeSetting(Key key, const std::string& value)
{
    chartstyle::write(modMain::goAppServices, modMain::goSettings, key, value);
}

// The leading number of a stored text; a number beyond the Double range counts as infinite with
// its sign, so that the field shows the limit on that side.
double storedNumber(const std::string& text)
{
    try {
        return readNumber(text);
    } catch (const Error& e) {
        if (e.number() != errc::Overflow) throw;
        const size_t first = text.find_first_not_of(" \t\r\n");
        const bool negative = first != std::string::npos && text[first] == '-';
        return negative ? -HUGE_VAL : HUGE_VAL;
    }
}

template <class W>
W* place(W* widget, const char* name, int x, int y, int w, int h)
{
    widget->setObjectName(name);
    widget->setGeometry(x, y, w, h);
    return widget;
}

}  // namespace

frmChartSetup::frmChartSetup(QWidget* parent) : QDialog(parent)
{
    setObjectName("frmChartSetup");
    setWindowTitle("Select Chart Styles");
    buildControls();
    Form_Load();
}

// Placed as on a designed form, in pixels of the fixed 5640 x 3405 twip client area.
void frmChartSetup::buildControls()
{
    setFixedSize(5640 / kTwipsPerPixel, 3405 / kTwipsPerPixel);

    Frame1 = place(new QGroupBox("View 3D", this), "Frame1", 8, 4, 176, 160);
    chk3D = place(new QCheckBox("Show 3D Chart", Frame1), "chk3D", 12, 22, 152, 22);
    chk3D->setChecked(true);
    QLabel** labels[3] = {&Label1, &Label2, &Label3};
    const char* labelNames[3] = {"Label1", "Label2", "Label3"};
    const char* fieldNames[3] = {"num3D_0", "num3D_1", "num3D_2"};
    for (int i = 0; i < 3; ++i) {
        const int y = 52 + 34 * i;
        num3D[i] = place(new NumericField(kFieldMinimum, kFieldMaximum, Frame1), fieldNames[i], 12, y, 56, 24);
        num3D[i]->setValue(Variant(kFieldDesignValue));
        *labels[i] = place(new QLabel(kFieldCaptions[i], Frame1), labelNames[i], 76, y, 92, 24);
        (*labels[i])->setBuddy(num3D[i]);
    }
    // toggled, not clicked: the program setting the box to another value acts as a click too.
    connect(chk3D, &QCheckBox::toggled, this, [this] { chk3D_Click(); });

    Frame2 = place(new QGroupBox("Chart Type", this), "Frame2", 192, 4, 176, 84);
    chartTypeGroup_ = new QButtonGroup(this);
    const char* typeNames[4] = {"optChartType_0", "optChartType_1", "optChartType_2", "optChartType_3"};
    for (int i = 0; i < 4; ++i) {
        // Plot and Bar on the left, Area and Pie on the right.
        const int x = i < 2 ? 12 : 92;
        const int y = i % 2 == 0 ? 24 : 52;
        const char* caption = chartstyle::kStyleNames[size_t(i)].name;
        optChartType[i] = place(new QRadioButton(caption, Frame2), typeNames[i], x, y, 76, 22);
        chartTypeGroup_->addButton(optChartType[i], i);
    }
    optChartType[kDesignChartType]->setChecked(true);

    labelGroup_ = new QButtonGroup(this);
    optLabel[0] = place(new QRadioButton("Default - Labels ON", this), "optLabel_0", 196, 96, 172, 22);
    optLabel[1] = place(new QRadioButton("Default - Labels OFF", this), "optLabel_1", 196, 122, 172, 22);
    labelGroup_->addButton(optLabel[0], 0);
    labelGroup_->addButton(optLabel[1], 1);
    optLabel[kDesignLabel]->setChecked(true);

    Label4 = place(new QLabel("Note:  Use the Advanced Help file for all chart features", this), "Label4", 8, 172,
                   208, 48);
    Label4->setWordWrap(true);

    Command1 = place(new QPushButton("OK", this), "Command1", 222, 190, 70, 28);
    Command1->setDefault(true);  // Enter confirms
    Command2 = place(new QPushButton("Cancel", this), "Command2", 298, 190, 70, 28);
    connect(Command1, &QPushButton::clicked, this, [this] { runCommand(&frmChartSetup::Command1_Click); });
    connect(Command2, &QPushButton::clicked, this, [this] { runCommand(&frmChartSetup::Command2_Click); });
}

int16_t frmChartSetup::chk3DValue() const { return chk3D->isChecked() ? 1 : 0; }

void frmChartSetup::setChk3DValue(int16_t value)
{
    // The box shows 0 and 1 only; any other number leaves it as it stands.
    if (value == 1) chk3D->setChecked(true);
    if (value == 0) chk3D->setChecked(false);
}

void frmChartSetup::Form_Load()
{
    logEvent("FormLoad");

    const std::string view3D = readSetting(Key::View3D);
    try {
        setChk3DValue(roundToInteger(readNumber(view3D)));
    } catch (const Error& e) {
        // Too large for the box's number: like any other number it cannot show, left as designed.
        if (e.number() != errc::Overflow) throw;
    }

    for (int i = 0; i < 3; ++i) num3D[i]->setValue(Variant(storedNumber(readSetting(kFieldKeys[i]))));

    const std::string style = readSetting(Key::Style);
    for (int i = 0; i < 4; ++i)
        if (style == chartstyle::kStyleNames[size_t(i)].name) optChartType[i]->setChecked(true);

    const std::string labels = readSetting(Key::LabelsOnDefault);
    if (labels == "1") optLabel[0]->setChecked(true);
    if (labels == "0") optLabel[1]->setChecked(true);
}

void frmChartSetup::chk3D_Click()
{
    // Switched off fields take no input; their labels stay as they are.
    const bool on = chk3DValue() != 0;
    for (NumericField* field : num3D) field->setEnabled(on);
}

void frmChartSetup::Command1_Click()
{
    const int16_t box = chk3DValue();
    const int type = chartTypeGroup_->checkedId() < 0 ? kDesignChartType : chartTypeGroup_->checkedId();
    const bool labelsOn = optLabel[0]->isChecked();

    writeSetting(Key::View3D, numberText(double(box)));
    for (int i = 0; i < 3; ++i) {
        // An emptied field has no number text: it is stored empty, which reads back as 0.
        const Variant value = num3D[i]->Value();
        writeSetting(kFieldKeys[i], value.isNull() ? std::string() : numberText(value));
    }
    writeSetting(Key::Style, chartstyle::kStyleNames[size_t(type)].name);
    writeSetting(Key::LabelsOnDefault, labelsOn ? "1" : "0");

    c2dChart& chart = modMain::chart();
    chart.setView3D(box == 1);
    int32_t angles[3] = {0, 0, 0};
    if (box == 1)
        for (int i = 0; i < 3; ++i) {
            const Variant value = num3D[i]->Value();
            angles[i] = value.isNull() ? 0 : roundToLong(toDouble(value));
        }
    chart.setRotation(angles[0]);
    chart.setElevation(angles[1]);
    chart.setDepth(angles[2]);
    chart.setChartType(chartstyle::kStyleNames[size_t(type)].type);
    chart.setPointLabels(labelsOn);
    accept();
}

void frmChartSetup::Command2_Click() { reject(); }

void frmChartSetup::Form_QueryUnload()
{
    if (unloaded_) return;
    unloaded_ = true;
    logEvent("FormQueryUnload");
}

void frmChartSetup::runCommand(void (frmChartSetup::*command)())
{
    try {
        (this->*command)();
    } catch (...) {
        // A failure ends the command and the dialog; the caller of showChartSetup() gets it.
        if (!pendingError_) pendingError_ = std::current_exception();
        if (!unloaded_) reject();
    }
}

void frmChartSetup::done(int result)
{
    // Every way of closing (OK, Cancel, Escape, the title bar) passes here once.
    try {
        Form_QueryUnload();
    } catch (...) {
        if (!pendingError_) pendingError_ = std::current_exception();
    }
    QDialog::done(result);
}

void frmChartSetup::rethrowPendingError()
{
    if (pendingError_) std::rethrow_exception(std::exchange(pendingError_, nullptr));
}

void showChartSetup()
{
    frmChartSetup dialog;
    prompter().execModal(dialog);
    dialog.rethrowPendingError();
}

}  // namespace kg::ui
