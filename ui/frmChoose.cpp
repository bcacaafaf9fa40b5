#include "ui/frmChoose.h"

#include <QCloseEvent>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

#include "requests/modMain.h"
#include "ui/WindowObject.h"

namespace kg::ui {

namespace {
const char* const kQuoteTypeCaptions[7] = {
    "Quote Type by Quantity",      "Quote Type by Value", "Quote Type by Average Value",
    "Quote Type by % Jobs",        "Quote Type by % of $", "Quote Type by $Value and Average $Value",
    "Quote Type by % Jobs and % $Value",
};
const char* const kCategoryCaptions[7] = {
    "Category by Quantity", "Category by Value", "Category by Average Value", "Category by % Jobs",
    "Category by % of $",   "Category by $Value and Average $Value", "Category by % Jobs and % $Value",
};

void logEvent(const char* event, const QString& name)
{
    call(modMain::goAppServices, "LogFormEvent", {Variant(event), Variant(name.toStdString())});
}
}  // namespace

QString frmChoose::captionOf(ChoiceDialog kind, int index)
{
    return QString::fromUtf8((kind == ChoiceDialog::QuoteType ? kQuoteTypeCaptions : kCategoryCaptions)[index]);
}

frmChoose::frmChoose(ChoiceDialog kind, QWidget* parent) : QDialog(parent)
{
    setObjectName(kind == ChoiceDialog::QuoteType ? "frmChoose1" : "frmChoose2");
    setWindowTitle("Select Chart Data");
    auto* layout = new QVBoxLayout(this);
    for (int i = 0; i < 7; ++i) {
        optData[i] = new QRadioButton(captionOf(kind, i), this);
        optData[i]->setObjectName(QString("optData_%1").arg(i));
        connect(optData[i], &QRadioButton::clicked, this, [this, i] { optData_Click(i); });
        layout->addWidget(optData[i]);
    }
    optData[0]->setChecked(true);
    auto* buttons = new QHBoxLayout;
    Command1 = new QPushButton("OK", this);
    Command1->setObjectName("Command1");
    Command1->setDefault(true);  // Enter confirms
    Command2 = new QPushButton("Cancel", this);
    Command2->setObjectName("Command2");
    buttons->addStretch();
    buttons->addWidget(Command1);
    buttons->addWidget(Command2);
    layout->addLayout(buttons);
    connect(Command1, &QPushButton::clicked, this, &frmChoose::Command1_Click);
    connect(Command2, &QPushButton::clicked, this, &frmChoose::Command2_Click);
    resize(4524 / kTwipsPerPixel, 3024 / kTwipsPerPixel);
    Form_Load();
}

void frmChoose::Form_Load()
{
    logEvent("FormLoad", objectName());
    iChoice = 0;
}

void frmChoose::Command1_Click() { accept(); }

void frmChoose::Command2_Click()
{
    iChoice = kChoiceCancelled;
    reject();
}

void frmChoose::Form_QueryUnload()
{
    if (unloaded_) return;
    unloaded_ = true;
    logEvent("FormQueryUnload", objectName());
}

void frmChoose::done(int result)
{
    Form_QueryUnload();
    QDialog::done(result);
}

void frmChoose::keyPressEvent(QKeyEvent* event)
{
    // Escape is the Cancel button, not a silent close.
    if (event->key() == Qt::Key_Escape) {
        Command2_Click();
        return;
    }
    QDialog::keyPressEvent(event);
}

void frmChoose::closeEvent(QCloseEvent* event)
{
    // The title-bar button unloads without touching the choice.
    Form_QueryUnload();
    QDialog::closeEvent(event);
}

}  // namespace kg::ui
