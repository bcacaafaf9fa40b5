#pragma once
// Every message box and modal dialog of the component goes through the prompter in use: the real one
// shows Qt dialogs; tests and the command-line tool install a scripted one that answers them and
// records what was asked.
#include <deque>
#include <functional>
#include <memory>
#include <string>
#include <vector>

class QDialog;
class QWidget;

namespace kg::ui {

// The component's application title: the title of its message boxes.
constexpr const char* kAppTitle = "KarstGraph";

class Prompter {
public:
    virtual ~Prompter() = default;
    // Fixed text, OK only, no icon, the component's title.
    virtual void showMessage(const std::string& text) = 0;
    // Runs the dialog modally; returns when it has closed.
    virtual void execModal(QDialog& dialog) = 0;
    // Asks for a file to write; empty when the user cancelled. `filter` as QFileDialog takes it.
    virtual std::string askSaveFile(const std::string& caption, const std::string& filter) = 0;
};

class QtPrompter : public Prompter {
public:
    void showMessage(const std::string& text) override;
    void execModal(QDialog& dialog) override;
    std::string askSaveFile(const std::string& caption, const std::string& filter) override;
};

// Answers from a queue: each modal dialog is handed to the next answer, which works its controls
// (clicks an option, presses OK or Cancel). A dialog with no answer left is cancelled.
class ScriptedPrompter : public Prompter {
public:
    using Answer = std::function<void(QDialog&)>;
    void showMessage(const std::string& text) override { messages.push_back(text); }
    void execModal(QDialog& dialog) override;
    std::string askSaveFile(const std::string& caption, const std::string& filter) override;

    std::vector<std::string> messages;
    std::deque<std::string> saveFiles;  // answers of the save questions; none left: cancelled
    std::deque<Answer> answers;
    std::vector<std::string> dialogsShown;  // object names of the dialogs, in order
};

Prompter& prompter();
void setPrompter(std::unique_ptr<Prompter> p);

}  // namespace kg::ui
