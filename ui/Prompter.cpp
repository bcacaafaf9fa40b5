#include "ui/Prompter.h"

#include <QDialog>
#include <QFileDialog>
#include <QMessageBox>

namespace kg::ui {

void QtPrompter::showMessage(const std::string& text)
{
    QMessageBox box(QMessageBox::NoIcon, kAppTitle, QString::fromStdString(text), QMessageBox::Ok);
    box.exec();
}

void QtPrompter::execModal(QDialog& dialog) { dialog.exec(); }

std::string QtPrompter::askSaveFile(const std::string& caption, const std::string& filter)
{
    return QFileDialog::getSaveFileName(nullptr, QString::fromStdString(caption), QString(),
                                        QString::fromStdString(filter))
        .toStdString();
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

namespace {
std::unique_ptr<Prompter>& current()
{
    static std::unique_ptr<Prompter> p = std::make_unique<QtPrompter>();
    return p;
}
}  // namespace

Prompter& prompter() { return *current(); }
void setPrompter(std::unique_ptr<Prompter> p) { current() = std::move(p); }

}  // namespace kg::ui
