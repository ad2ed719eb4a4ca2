#include "connection/conn_dialog.h"

#include "common/failure.h"
#include "common/module_state.h"
#include "connection/conn_string.h"
#include "connection/database.h"
#include "connection/settings_keys.h"
#include "connection/settings_store.h"
#include "host/seams.h"

#include <QComboBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QShowEvent>
#include <QVBoxLayout>

namespace ardcard {

namespace {

// The connection types 1 to 6, at list positions 0 to 5.
QStringList connTypeItems() {
    return {QStringLiteral("MS-SQL Server Via ODBC"),
            QStringLiteral("MS-SQL Server Via OLE-DB"),
            QStringLiteral("DAO 3.5 Via OLE-DB"),
            QStringLiteral("DAO 4.0 Via OLE-DB"),
            QStringLiteral("ODBC DSN"),
            QStringLiteral("ODBC Driver for Access")};
}

} // namespace

frmAConn::frmAConn(QWidget* parent) : QDialog(parent) {
    setObjectName(QStringLiteral("frmAConn"));
    setWindowTitle(QStringLiteral("הגדרות התחברות לארדקו חלונות"));
    setLayoutDirection(Qt::RightToLeft);
    setModal(true);
    QFont font = this->font();
    font.setFamily(QStringLiteral("Arial"));
    setFont(font);

    fraStep3 = new QGroupBox(QStringLiteral("ערכי התחברות"), this);
    fraStep3->setObjectName(QStringLiteral("fraStep3"));
    auto* grid = new QGridLayout(fraStep3);

    const auto edit = [&](const QString& name) {
        auto* box = new QLineEdit(fraStep3);
        box->setObjectName(name);
        box->setLayoutDirection(Qt::LeftToRight); // server names, paths, passwords
        return box;
    };
    txtConnServer = edit(QStringLiteral("txtConnServer"));
    txtConnUID = edit(QStringLiteral("txtConnUID"));
    txtConnPWD = edit(QStringLiteral("txtConnPWD"));
    txtConnPWD->setEchoMode(QLineEdit::Password);
    txtConnDatabase = edit(QStringLiteral("txtConnDatabase"));
    CmbConnType = new QComboBox(fraStep3);
    CmbConnType->setObjectName(QStringLiteral("CmbConnType"));
    CmbConnType->addItems(connTypeItems());

    const QList<QPair<QString, QWidget*>> rows = {
        {QStringLiteral("שרת נתונים:"), txtConnServer},
        {QStringLiteral("משתמש:"), txtConnUID},
        {QStringLiteral("סיסמה:"), txtConnPWD},
        {QStringLiteral("בסיסי נתונים:"), txtConnDatabase},
        {QStringLiteral("סוג בסיס הנתונים:"), CmbConnType},
    };
    for (int i = 0; i < rows.size(); ++i) {
        // One control array: every caption is "lblStep3", told apart by Index.
        auto* caption = new QLabel(rows[i].first, fraStep3);
        caption->setObjectName(QStringLiteral("lblStep3"));
        caption->setProperty("Index", i);
        caption->setBuddy(rows[i].second);
        lblStep3.append(caption);
        // Right to left: column 0 is the right one, so the caption stands to
        // the right of its box.
        grid->addWidget(caption, i, 0);
        grid->addWidget(rows[i].second, i, 1);
    }
    grid->setColumnStretch(1, 1);

    const auto button = [&](const QString& name, const QString& caption) {
        auto* b = new QPushButton(caption, this);
        b->setObjectName(name);
        b->setAutoDefault(false);
        return b;
    };
    cmdOK = button(QStringLiteral("cmdOK"), QStringLiteral("אישור"));
    CmdCheck = button(QStringLiteral("CmdCheck"), QStringLiteral("בדיקה"));
    cmdCancel = button(QStringLiteral("cmdCancel"), QStringLiteral("ביטול"));
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(cmdOK);
    buttons->addWidget(CmdCheck);
    buttons->addWidget(cmdCancel);

    LblMsg = new QLabel(QStringLiteral("מומלץ לבצע בדיקה לאחר שינוי ערכי ההתחברות!"), this);
    LblMsg->setObjectName(QStringLiteral("LblMsg"));
    LblMsg->setWordWrap(true);

    auto* main = new QVBoxLayout(this);
    main->addWidget(fraStep3);
    main->addLayout(buttons);
    main->addWidget(LblMsg);
    setMinimumWidth(420);

    connect(cmdOK, &QPushButton::clicked, this, &frmAConn::cmdOK_Click);
    connect(CmdCheck, &QPushButton::clicked, this, &frmAConn::CmdCheck_Click);
    connect(cmdCancel, &QPushButton::clicked, this, &frmAConn::cmdCancel_Click);

    Form_Load();
}

void frmAConn::showEvent(QShowEvent* event) {
    if (!event->spontaneous())
        Form_Load();
    QDialog::showEvent(event);
}

void frmAConn::Form_Load() {
    const ConnValues& c = moduleState().conn;
    txtConnServer->setText(c.ConnServer);
    txtConnUID->setText(c.ConnUID);
    txtConnPWD->setText(c.ConnPWD);
    txtConnDatabase->setText(c.ConnDataBase);
    // A type without a list position (0, or above 6 from a page) selects
    // nothing.
    const int position = c.ConnType - 1;
    CmbConnType->setCurrentIndex(position >= 0 && position < CmbConnType->count() ? position : -1);
}

void frmAConn::SetGetRegConnParams(int Action) {
    const auto control = [&](const keys::Key& key, QObject* widget, int kind) {
        SetGetRegControl(Action, kRegApp, kRegSection, keys::name(key), widget, kind,
                         keys::fallback(key));
    };
    control(keys::ConnServer, txtConnServer, RegText);
    control(keys::ConnUID, txtConnUID, RegText);
    control(keys::ConnPWD, txtConnPWD, RegText);
    control(keys::ConnDataBase, txtConnDatabase, RegText);
    control(keys::ConnType, CmbConnType, RegListIndex);
}

void frmAConn::cmdOK_Click() {
    ConnValues& c = moduleState().conn;
    c.ConnServer = txtConnServer->text();
    c.ConnUID = txtConnUID->text();
    c.ConnPWD = txtConnPWD->text();
    c.ConnDataBase = txtConnDatabase->text();
    c.ConnType = CmbConnType->currentIndex() + 1;
    try {
        SetGetRegConnParams(RegSave);
    } catch (const Failure& failure) {
        // The values are in use but not kept: the clerk may fix the store
        // and confirm again.
        host::messageBox().show(QStringLiteral("תקלה"), failure.description(),
                                host::MessageIcon::Critical);
        return;
    }
    accept();
}

void frmAConn::cmdCancel_Click() {
    reject();
}

void frmAConn::CmdCheck_Click() {
    const QString databases = txtConnDatabase->text();
    const QStringList pieces =
        databases.isEmpty() ? QStringList() : databases.split(u';', Qt::KeepEmptyParts);
    const int type = CmbConnType->currentIndex() + 1;
    try {
        for (const QString& database : pieces) {
            const QString connStr = BuildConnString(txtConnServer->text(), txtConnUID->text(),
                                                    txtConnPWD->text(), database, type);
            Recordset rs;
            rs.Open(QStringLiteral("SELECT * FROM Accounts"), connStr, CursorKind::Dynamic);
            rs.Close();
        }
    } catch (const Failure& failure) {
        LblMsg->setText(QStringLiteral("הבדיקה לא הסתיימה בהצלחה"));
        host::messageBox().show(QStringLiteral("תקלה"), failure.description(),
                                host::MessageIcon::Critical);
        return;
    }
    LblMsg->setText(QStringLiteral("הבדיקה הסתיימה בהצלחה"));
}

} // namespace ardcard
