#include "ui/frmChoose.h"

#include <QCloseEvent>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

#include "requests/Measures.h"
#include "requests/modMain.h"
#include "ui/WindowObject.h"

namespace kg::ui {

namespace {
void logEvent(const char* event, const QString& name)
{
    call(modMain::goAppServices, "LogFormEvent", {Variant(event), Variant(name.toStdString())});
}
}  // namespace

QString frmChoose::captionOf(ChoiceDialog kind, int index)
{
    const requests::Measure& m = requests::kMeasures[size_t(index)];
    return QString::fromUtf8(kind == ChoiceDialog::QuoteType ? m.quoteTypeCaption : m.categoryCaption);
}

frmChoose::frmChoose(ChoiceDialog kind, QWidget* parent) : QDialog(parent)
{
    setObjectName(kind == ChoiceDialog::QuoteType ? "frmChoose1" : "frmChoose2");
    setWindowTitle("Select Chart Data");
    auto* layout = new QVBoxLayout(this);
    for (int i = 0; i < int(requests::kMeasures.size()); ++i) {
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
