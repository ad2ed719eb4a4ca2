#pragma once

#include <QDialog>
#include <QList>

class QComboBox;
class QGroupBox;
class QLabel;
class QLineEdit;
class QPushButton;

namespace ardcard {

// The connection settings dialog: shows the five connection values in use,
// lets the clerk edit them, test a connection to every database listed
// (separated by ";") and save them. Modal; the card opens it from its
// connection picture and takes the database value over as its company
// directories when it closes.
//
// The values in use (moduleState().conn) change only on OK, which also saves
// them; the check tests what is on the screen and saves nothing.
class frmAConn : public QDialog {
    Q_OBJECT
public:
    explicit frmAConn(QWidget* parent = nullptr);

    // Fills the controls from the values in use; runs each time the dialog
    // opens, so a reopened dialog never shows edits that were cancelled.
    void Form_Load();
    // Action 1 saves the five controls to the settings store, 2 loads them;
    // saving throws Failure when the store cannot be written.
    void SetGetRegConnParams(int Action);

    void cmdOK_Click();
    void CmdCheck_Click();
    void cmdCancel_Click();

    QGroupBox* fraStep3 = nullptr;
    QList<QLabel*> lblStep3; // the five captions, top to bottom
    QLineEdit* txtConnServer = nullptr;
    QLineEdit* txtConnUID = nullptr;
    QLineEdit* txtConnPWD = nullptr;
    QLineEdit* txtConnDatabase = nullptr;
    QComboBox* CmbConnType = nullptr;
    QPushButton* cmdOK = nullptr;
    QPushButton* CmdCheck = nullptr;
    QPushButton* cmdCancel = nullptr;
    QLabel* LblMsg = nullptr;

protected:
    void showEvent(QShowEvent* event) override;
};

} // namespace ardcard
