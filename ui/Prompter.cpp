#include "ui/Prompter.h"

#include <QDialog>
#include <QFileDialog>
#include <QMessageBox>
#include <QPushButton>
#include <QRadioButton>

#include "requests/HeadlessUi.h"
#include "ui/frmChoose.h"

namespace kg::ui {

void QtPrompter::showMessage(const std::string& text)
{
    QMessageBox box(QMessageBox::NoIcon, kAppTitle, QString::fromStdString(text), QMessageBox::Ok);
    box.exec();
}

int16_t WindowPrompter::chooseData(ChoiceDialog dialog)
{
    frmChoose form(dialog);
    execModal(form);
    return form.iChoice;
}

void QtPrompter::execModal(QDialog& dialog) { dialog.exec(); }

std::string QtPrompter::askSaveFile(const std::string& caption, const std::string& filter)
{
    return QFileDialog::getSaveFileName(nullptr, QString::fromStdString(caption), QString(),
                                        QString::fromStdString(filter))
        .toStdString();
}

int16_t ScriptedPrompter::chooseData(ChoiceDialog dialog)
{
    if (choices.empty()) {
        if (answers.empty()) return NoScreenPrompter().chooseData(dialog);
        return WindowPrompter::chooseData(dialog);
    }
    dialogsShown.push_back(dialog == ChoiceDialog::QuoteType ? "frmChoose1" : "frmChoose2");
    const int16_t choice = choices.front();
    choices.pop_front();
    return choice;
}

std::string ScriptedPrompter::askSaveFile(const std::string&, const std::string&)
{
    if (saveFiles.empty()) return {};
    std::string answer = std::move(saveFiles.front());
    saveFiles.pop_front();
    return answer;
}

void ScriptedPrompter::execModal(QDialog& dialog)
{
    dialogsShown.push_back(dialog.objectName().toStdString());
    dialog.setModal(true);
    dialog.show();
    if (answers.empty()) {
        dialog.reject();
        return;
    }
    Answer answer = std::move(answers.front());
    answers.pop_front();
    answer(dialog);
    // An answer that did not close the dialog closes it as the title-bar button would.
    if (dialog.isVisible()) dialog.close();
}

ScriptedPrompter::Answer ScriptedPrompter::choose(int16_t choice)
{
    return [choice](QDialog& dialog) {
        auto* form = qobject_cast<frmChoose*>(&dialog);
        if (!form) return;
        if (choice == kChoiceCancelled) {
            form->Command2->click();
            return;
        }
        if (choice >= 0 && choice < 7) form->optData[choice]->click();
        form->Command1->click();
    };
}

WindowPrompter& prompter()
{
    if (auto* windows = dynamic_cast<WindowPrompter*>(services().prompter.get())) return *windows;
    static QtPrompter qt;
    return qt;
}

}  // namespace kg::ui
