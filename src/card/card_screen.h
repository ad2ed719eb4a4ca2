#pragma once

// The card's screen controls, each under its object name.

class QCheckBox;
class QComboBox;
class QFrame;
class QLabel;
class QLineEdit;
class QPushButton;
class QTableView;
class QWidget;

namespace ardcard {

struct CardScreen {
    QLabel* Label1 = nullptr;
    QLineEdit* txtAccountKey = nullptr;
    QLabel* imgAccKey = nullptr;
    QLabel* Label2 = nullptr;
    QLineEdit* txtAccountName = nullptr;
    QLabel* Label8 = nullptr;
    QLineEdit* txtTelephone = nullptr;
    QLabel* Label7 = nullptr;
    QLineEdit* txtAddress = nullptr;
    QLabel* LblDetails = nullptr;
    QLineEdit* txtDetails = nullptr;
    QLabel* Label9 = nullptr;
    QLineEdit* txtCity = nullptr;
    QLineEdit* txtZip = nullptr;
    QLabel* Label23 = nullptr;
    QLineEdit* txtDistrict = nullptr;
    QLabel* Label24 = nullptr;
    QLineEdit* txtAgent = nullptr;
    QLabel* Label3 = nullptr;
    QLineEdit* txtBalance = nullptr;
    QLabel* Label10 = nullptr;
    QLineEdit* txtOblig = nullptr;
    QLabel* Label17 = nullptr;
    QLineEdit* txtShipBalance = nullptr;
    QLabel* Label4 = nullptr;
    QLineEdit* txtCompPath = nullptr;
    QLabel* Image1 = nullptr;
    QPushButton* FirstButt = nullptr;
    QPushButton* PrevButt = nullptr;
    QPushButton* NextButt = nullptr;
    QPushButton* LastButt = nullptr;
    QPushButton* ShowTransButt = nullptr;
    QPushButton* CmdStop = nullptr;
    QLabel* Label14 = nullptr;
    QCheckBox* ChkOnlyOpenTrans = nullptr;
    QLabel* Label21 = nullptr;
    QCheckBox* chkNegdiName = nullptr;
    QLabel* Label11 = nullptr;
    QCheckBox* chkShowHeadDetails = nullptr;
    QLabel* Label15 = nullptr;
    QCheckBox* ChkOnlyGraph = nullptr;
    QPushButton* PrintButt = nullptr;
    QPushButton* ExcelButt = nullptr;
    QLabel* Label16 = nullptr;
    QComboBox* CmbGraphType = nullptr;
    QComboBox* CmbGraphDate = nullptr;
    QPushButton* CmdGraph = nullptr;
    QPushButton* cmdSave = nullptr;
    QTableView* DocLines = nullptr;
    QFrame* ProgressFrame = nullptr;
    QFrame* ProgressFill = nullptr;
    QFrame* ProgressFrame2 = nullptr;
    QFrame* ProgressFill2 = nullptr;
    QLabel* Label12 = nullptr;
    QLabel* Label13 = nullptr;
    QLabel* Label22 = nullptr;
    QLabel* Label25 = nullptr;
    // The maker's name, telephone number and web address.
    QLabel* lblMakerName = nullptr;
    QLabel* lblMakerPhone = nullptr;
    QLabel* lblMakerWeb = nullptr;
};

// Creates every control as a child of `card`, with its object name, caption,
// items and tool tip, and lays them out right to left. Wires nothing.
void BuildCardScreen(CardScreen& ui, QWidget* card);

} // namespace ardcard
