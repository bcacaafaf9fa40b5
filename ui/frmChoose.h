#pragma once
// The data choice dialogs: the user picks one of seven measures of the bookings grid.
// frmChoose1 offers them by quote type, frmChoose2 by category. OK keeps the choice, Cancel gives
// -99, closing by the title bar leaves iChoice as it stands.
#include <QDialog>

#include "requests/Measures.h"
#include "requests/Services.h"

class QRadioButton;
class QPushButton;

namespace kg::ui {

class frmChoose : public QDialog {
    Q_OBJECT
public:
    explicit frmChoose(ChoiceDialog kind, QWidget* parent = nullptr);

    int16_t iChoice = 0;
    QRadioButton* optData[requests::kMeasures.size()] = {};  // one per measure
    QPushButton* Command1 = nullptr;  // OK
    QPushButton* Command2 = nullptr;  // Cancel

    void Form_Load();
    void optData_Click(int Index) { iChoice = int16_t(Index); }
    void Command1_Click();
    void Command2_Click();

    static QString captionOf(ChoiceDialog kind, int index);

protected:
    void done(int result) override;
    void keyPressEvent(QKeyEvent* event) override;
    void closeEvent(QCloseEvent* event) override;

private:
    void Form_QueryUnload();
    bool unloaded_ = false;
};

}  // namespace kg::ui
