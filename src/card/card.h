#pragma once

#include <QString>
#include <QVariant>
#include <QWidget>
#include <memory>
#include <optional>

namespace ardcard {

namespace host {
class HostingPage;
}
class LedgerModel;
class TextFileWriter;
class frmAConn;
class Recordset;
struct CardScreen;

// The account card: ardcard's main component.
//
// A container (a page in the host application, the embedding example, any Qt
// program) creates a Card and places it. On creation the card loads the
// stored connection values; on first placing (InitProperties) it takes the
// company directories and connection values the hosting page gives, lays
// itself out and, given an account key, shows that account and fetches its
// journal lines. From then on the clerk
//   - steps through accounts or searches them (account lookup: ReadACT7),
//   - fetches the account's journal lines from every company directory into
//     the ledger grid with a running balance (ShowTransButt_Click ->
//     ReadAllTransactions -> ReadTransactions7, src/ledger/),
//   - writes a printable statement, a CSV export or a period graph
//     (src/reports/), each shown in a new page window (src/host/),
//   - or opens the account's information page (src/info/).
//
// Values shared by every card on the thread (company directories, connection
// values, company details, ledger totals, stop flag) live in moduleState()
// (src/common/module_state.h): two cards on one thread share them and the
// last writer wins.
//
// Every public member keeps the name a container script uses
// (`card.ShowAccount(...)`, `card.SetAccountKey = "1001"`).
class Card : public QWidget {
    Q_OBJECT
    Q_PROPERTY(int PubACTLocation MEMBER PubACTLocation)
    Q_PROPERTY(QString PubSearchBy MEMBER PubSearchBy)
    Q_PROPERTY(QVariant PubSearchValue MEMBER PubSearchValue)
    Q_PROPERTY(QVariant SetAccountKey READ accountKey WRITE setAccountKey)
    Q_PROPERTY(QVariant SetCompDir READ compDir WRITE setCompDir)
    Q_PROPERTY(QVariant ACTLocation READ actLocation WRITE setActLocation)

public:
    // Creation: loads the stored connection values (failures passed over).
    explicit Card(QWidget* parent = nullptr);
    ~Card() override;

    // Public fields: the account on show (its ID, 0 for none) and the
    // current search.
    int PubACTLocation = 0;
    QString PubSearchBy;
    QVariant PubSearchValue;

    // First placing by a hosting page: its address (company directories
    // after "#") and named values. Every step goes on after a failure.
    void InitProperties(const host::HostingPage& page);

    // Properties; writing SetCompDir or ACTLocation throws Failure to the
    // caller when the value does not fit.
    QVariant accountKey() const;
    void setAccountKey(const QVariant& value);
    QVariant compDir() const;
    void setCompDir(const QVariant& value);
    QVariant actLocation() const;
    void setActLocation(const QVariant& value);

    // Public members, callable from C++ and container scripts.
    Q_INVOKABLE void SetGetRegParams(int Action, const QString& RegApp, const QString& RegSection);
    Q_INVOKABLE void InitDocLines();
    Q_INVOKABLE void CreateHTML(const QString& pFileName);
    Q_INVOKABLE void CreateCSV(const QString& pFileName);
    Q_INVOKABLE void CreateCSV_HTML(const QString& pFileName, const QString& CSVFile);
    // Returns the cleaned account key (the caller's variable in the original
    // by-reference form).
    Q_INVOKABLE QString ReadAllTransactions(const QString& CompPath, const QString& pAccountKey);
    Q_INVOKABLE bool SetParams(const QString& CompanyDirs);
    Q_INVOKABLE int ShowAccount(const QString& pServer, const QString& pUID, const QString& pPWD,
                                int pConnType, const QString& pDatabase,
                                const QString& pAccountKey);
    Q_INVOKABLE void CreateHTMLGraph(const QString& pFileName, int pGraphType);
    Q_INVOKABLE void EnableButtons(bool pEnable);
    // True when the lookup ran to its end; the search value comes back
    // trimmed in PubSearchValue when that is what was passed.
    Q_INVOKABLE QVariant ReadACT7(const QString& CompPath, const QString& pSearchBy,
                                  const QVariant& pSearchValue, const QString& pStartFrom);
    Q_INVOKABLE int ReadTransactions7(const QString& CompPath, const QString& pAccountKey,
                                      int pCompID, bool pOnlyOpenTrans, int pGraphDate,
                                      bool pIncNegdiName);
    Q_INVOKABLE bool GetCompDetails7(const QString& pCompPath);
    Q_INVOKABLE void InitCard();
    // One heading row of the statement into an open page file.
    void WriteHeader(TextFileWriter& file, const QString& pTitle, const QString& pContent);

    // The ledger grid's rows (DocLines numbering: row 0 header, blank row last).
    const LedgerModel& ledger() const;

private:
    // Event handlers of the card's own controls.
    void cmdSave_Click();
    void Image1_Click();
    void imgAccKey_DblClick();
    void txtCompPath_Change();
    void txtCompPath_LostFocus();
    void FirstButt_Click();
    void LastButt_Click();
    void NextButt_Click();
    void PrevButt_Click();
    void Label1_DblClick();
    void Label2_DblClick();
    void Label8_DblClick();
    void Label7_DblClick();
    void LblDetails_DblClick();
    void ShowTransButt_Click();
    void CmdStop_Click();
    void DocLines_Click(int gridRow, int column);
    void PrintButt_Click();
    void ExcelButt_Click();
    void CmdGraph_Click();

    bool readAct7(const QString& compPath, const QString& searchBy, QVariant& searchValue,
                  const QString& startFrom);
    void searchBy(const QString& kind, const QVariant& value);
    void navigate(const QString& startFrom);
    void showAccountRow(const Recordset& row);
    void clearAccountBoxes();
    // Every step runs; the first failure's description comes back.
    std::optional<QString> saveOrLoadOptions(int action, const QString& app,
                                             const QString& section);
    // The company-directory text from a container, split, and the first
    // company's details read.
    void takeCompanyDirs(const QString& text, bool passOverFailures);
    void readFirstCompanyDetails();
    void connectControls();
    bool eventFilter(QObject* watched, QEvent* event) override;

    std::unique_ptr<CardScreen> ui_;
    LedgerModel* ledger_ = nullptr;  // owned by the card (QObject child)
    frmAConn* connDialog_ = nullptr; // made on first use, then reused
};

} // namespace ardcard
