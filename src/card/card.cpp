#include "card/card.h"

#include "card/card_screen.h"
#include "common/failure.h"
#include "common/module_state.h"
#include "connection/conn_dialog.h"
#include "connection/settings_store.h"
#include "ledger/ledger_model.h"

#include <QCheckBox>
#include <QComboBox>
#include <QEvent>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QPushButton>
#include <QTableView>
#include <cmath>
#include <limits>

namespace ardcard {

namespace {

// A container's value as a 32-bit integer, rounded to the nearest whole
// number (halves to even) as the container's scripts expect; throws Failure
// for Null, a text that is not a number or a number out of range.
int toInt32(const QVariant& value) {
    if (value.isNull())
        throw Failure(QStringLiteral("שימוש לא חוקי בערך ריק"));
    bool ok = false;
    const double number = value.typeId() == QMetaType::QString
                              ? value.toString().trimmed().toDouble(&ok)
                              : value.toDouble(&ok);
    if (!ok || !std::isfinite(number))
        throw Failure(QStringLiteral("אי התאמה בסוג הנתונים: %1").arg(value.toString()));
    const double rounded = std::nearbyint(number);
    if (rounded < std::numeric_limits<int>::min() || rounded > std::numeric_limits<int>::max())
        throw Failure(QStringLiteral("הערך %1 חורג מהתחום").arg(value.toString()));
    return static_cast<int>(rounded);
}

} // namespace

Card::Card(QWidget* parent) : QWidget(parent), ui_(std::make_unique<CardScreen>()) {
    setObjectName(QStringLiteral("Card"));
    BuildCardScreen(*ui_, this);
    ledger_ = new LedgerModel(this);
    ui_->DocLines->setModel(ledger_);
    ui_->DocLines->resizeColumnsToContents();
    connectControls();
    EnableButtons(false);
    // Reading never fails: a missing or unreadable settings file gives the
    // defaults.
    ReadConnParams();
}

Card::~Card() = default;

const LedgerModel& Card::ledger() const {
    return *ledger_;
}

void Card::EnableButtons(bool pEnable) {
    ui_->CmdGraph->setEnabled(pEnable);
    ui_->ExcelButt->setEnabled(pEnable);
    ui_->PrintButt->setEnabled(pEnable);
}

QVariant Card::accountKey() const {
    return ui_->txtAccountKey->text();
}

void Card::setAccountKey(const QVariant& value) {
    if (value.isNull())
        throw Failure(QStringLiteral("שימוש לא חוקי בערך ריק"));
    ui_->txtAccountKey->setText(value.toString());
}

QVariant Card::compDir() const {
    return moduleState().CompanyDirText;
}

void Card::setCompDir(const QVariant& value) {
    takeCompanyDirs(value.isNull() ? QString() : value.toString(), false);
}

bool Card::SetParams(const QString& CompanyDirs) {
    takeCompanyDirs(CompanyDirs, true);
    return false;
}

QVariant Card::actLocation() const {
    return QVariant::fromValue<int>(PubACTLocation);
}

void Card::setActLocation(const QVariant& value) {
    PubACTLocation = toInt32(value);
}

void Card::connectControls() {
    CardScreen& ui = *ui_;
    connect(ui.cmdSave, &QPushButton::clicked, this, &Card::cmdSave_Click);
    connect(ui.txtCompPath, &QLineEdit::textChanged, this, &Card::txtCompPath_Change);
    connect(ui.FirstButt, &QPushButton::clicked, this, &Card::FirstButt_Click);
    connect(ui.PrevButt, &QPushButton::clicked, this, &Card::PrevButt_Click);
    connect(ui.NextButt, &QPushButton::clicked, this, &Card::NextButt_Click);
    connect(ui.LastButt, &QPushButton::clicked, this, &Card::LastButt_Click);
    connect(ui.ShowTransButt, &QPushButton::clicked, this, &Card::ShowTransButt_Click);
    connect(ui.CmdStop, &QPushButton::clicked, this, &Card::CmdStop_Click);
    connect(ui.PrintButt, &QPushButton::clicked, this, &Card::PrintButt_Click);
    connect(ui.ExcelButt, &QPushButton::clicked, this, &Card::ExcelButt_Click);
    connect(ui.CmdGraph, &QPushButton::clicked, this, &Card::CmdGraph_Click);
    // The grid numbers its header row 0 and its first data row 1.
    connect(ui.DocLines->horizontalHeader(), &QHeaderView::sectionClicked, this,
            [this](int column) { DocLines_Click(0, column); });
    connect(ui.DocLines, &QTableView::clicked, this,
            [this](const QModelIndex& index) { DocLines_Click(index.row() + 1, index.column()); });

    // Labels and pictures have no click signals of their own.
    for (QObject* watched : std::initializer_list<QObject*>{
             ui.Label1, ui.Label2, ui.Label8, ui.Label7, ui.LblDetails, ui.Image1, ui.imgAccKey,
             ui.txtCompPath, ui.Label14, ui.Label21, ui.Label11, ui.Label15})
        watched->installEventFilter(this);
}

bool Card::eventFilter(QObject* watched, QEvent* event) {
    const CardScreen& ui = *ui_;
    switch (event->type()) {
    case QEvent::MouseButtonDblClick: {
        if (static_cast<QMouseEvent*>(event)->button() != Qt::LeftButton)
            break;
        if (watched == ui.Label1)
            Label1_DblClick();
        else if (watched == ui.Label2)
            Label2_DblClick();
        else if (watched == ui.Label8)
            Label8_DblClick();
        else if (watched == ui.Label7)
            Label7_DblClick();
        else if (watched == ui.LblDetails)
            LblDetails_DblClick();
        else if (watched == ui.imgAccKey)
            imgAccKey_DblClick();
        else
            break;
        return true;
    }
    case QEvent::MouseButtonRelease: {
        if (static_cast<QMouseEvent*>(event)->button() != Qt::LeftButton)
            break;
        if (watched == ui.Image1) {
            Image1_Click();
            return true;
        }
        // An option's caption toggles its check box, as a check box's own
        // caption would.
        if (auto* caption = qobject_cast<QLabel*>(watched)) {
            if (auto* box = qobject_cast<QCheckBox*>(caption->buddy())) {
                box->toggle();
                return true;
            }
        }
        break;
    }
    case QEvent::FocusOut:
        if (watched == ui.txtCompPath)
            txtCompPath_LostFocus();
        break;
    default:
        break;
    }
    return QWidget::eventFilter(watched, event);
}

} // namespace ardcard
