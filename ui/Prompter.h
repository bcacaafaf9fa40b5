#pragma once
// Every message box and modal dialog of the component goes through the services' prompter: the
// real one shows Qt dialogs; tests and the command-line tool install the scripted one, which
// answers them and records what was asked.
#include <deque>
#include <functional>
#include <string>
#include <vector>

#include "requests/Services.h"

class QDialog;

namespace kg::ui {

// The component's application title: the title of its message boxes.
constexpr const char* kAppTitle = "KarstGraph";

// What the windows ask besides the requests' prompts.
class WindowPrompter : public Prompter {
public:
    // frmChoose1 or frmChoose2, run through execModal.
    int16_t chooseData(ChoiceDialog dialog) override;
    // Runs the dialog modally; returns when it has closed.
    virtual void execModal(QDialog& dialog) = 0;
    // Asks for a file to write; empty when the user cancelled. `filter` as QFileDialog takes it.
    virtual std::string askSaveFile(const std::string& caption, const std::string& filter) = 0;
};

class QtPrompter : public WindowPrompter {
public:
    void showMessage(const std::string& text) override;
    void execModal(QDialog& dialog) override;
    std::string askSaveFile(const std::string& caption, const std::string& filter) override;
};

// Answers from queues and records what was asked. Each modal dialog is handed to the next answer,
// which works its controls (clicks an option, presses OK or Cancel); a dialog with no answer left
// is cancelled. A data choice comes from `choices` as it is, with no dialog made (so it may be one
// no dialog gives); else the real frmChoose goes to the next answer; with neither it fails as
// without a screen.
class ScriptedPrompter : public WindowPrompter {
public:
    using Answer = std::function<void(QDialog&)>;
    void showMessage(const std::string& text) override { messages.push_back(text); }
    int16_t chooseData(ChoiceDialog dialog) override;
    void execModal(QDialog& dialog) override;
    std::string askSaveFile(const std::string& caption, const std::string& filter) override;

    // Answers the data choice dialog as a user would: clicks the option, then OK (-99: Cancel).
    static Answer choose(int16_t choice);

    std::vector<std::string> messages;
    std::deque<int16_t> choices;        // answers of the data choices, in order
    std::deque<std::string> saveFiles;  // answers of the save questions; none left: cancelled
    std::deque<Answer> answers;
    std::vector<std::string> dialogsShown;  // object names of the dialogs, in order
};

// The services' prompter when it can run the windows' dialogs, else the Qt dialogs.
WindowPrompter& prompter();

}  // namespace kg::ui
