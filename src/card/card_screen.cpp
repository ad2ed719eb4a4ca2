#include "card/card_screen.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QFrame>
#include <QGridLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QStyle>
#include <QTableView>
#include <QVBoxLayout>
#include <limits>

namespace ardcard {

namespace {

template <typename W> W* named(W* widget, const QString& objectName) {
    widget->setObjectName(objectName);
    return widget;
}

QLabel* label(QWidget* parent, const QString& objectName, const QString& caption,
              const QString& toolTip = {}) {
    auto* l = named(new QLabel(caption, parent), objectName);
    if (!toolTip.isEmpty())
        l->setToolTip(toolTip);
    return l;
}

// A box holds whatever the database or a container puts into it: a line
// edit's own limit of 32,767 characters would cut a long company-directory
// text in the middle of a path, and the cut text is what the fetch reads.
QLineEdit* textBox(QWidget* parent, const QString& objectName) {
    QLineEdit* box = named(new QLineEdit(parent), objectName);
    box->setMaxLength(std::numeric_limits<int>::max());
    return box;
}

// Money boxes show what the lookup formatted; the clerk does not edit them.
QLineEdit* moneyBox(QWidget* parent, const QString& objectName) {
    QLineEdit* box = textBox(parent, objectName);
    box->setReadOnly(true);
    box->setAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    box->setLayoutDirection(Qt::LeftToRight);
    return box;
}

QPushButton* button(QWidget* parent, const QString& objectName, const QString& caption,
                    const QString& toolTip = {}) {
    auto* b = named(new QPushButton(caption, parent), objectName);
    if (!toolTip.isEmpty())
        b->setToolTip(toolTip);
    b->setAutoDefault(false);
    return b;
}

// A picture that reacts to the mouse: a standard icon on a label.
QLabel* picture(QWidget* parent, const QString& objectName, QStyle::StandardPixmap icon,
                const QString& toolTip = {}) {
    auto* l = named(new QLabel(parent), objectName);
    l->setPixmap(parent->style()->standardIcon(icon).pixmap(22, 22));
    l->setCursor(Qt::PointingHandCursor);
    l->setFixedSize(26, 26);
    l->setAlignment(Qt::AlignCenter);
    if (!toolTip.isEmpty())
        l->setToolTip(toolTip);
    return l;
}

// A bar made of an outline and a fill whose width the journal read sets.
void progressBar(QWidget* parent, const QString& frameName, const QString& fillName, QFrame*& frame,
                 QFrame*& fill) {
    frame = named(new QFrame(parent), frameName);
    frame->setFrameShape(QFrame::Box);
    frame->setFixedSize(160, 14);
    fill = named(new QFrame(frame), fillName);
    fill->setGeometry(1, 1, 0, 12);
    fill->setAutoFillBackground(true);
    QPalette palette = fill->palette();
    palette.setColor(QPalette::Window, palette.color(QPalette::Highlight));
    fill->setPalette(palette);
}

// A check box whose caption is the label beside it.
void option(QGridLayout* grid, int row, QWidget* parent, QCheckBox*& box, QLabel*& caption,
            const QString& boxName, const QString& labelName, const QString& text) {
    box = named(new QCheckBox(parent), boxName);
    caption = label(parent, labelName, text);
    caption->setBuddy(box);
    caption->setCursor(Qt::PointingHandCursor);
    grid->addWidget(box, row, 0);
    grid->addWidget(caption, row, 1);
}

QGroupBox* accountGroup(CardScreen& ui, QWidget* card) {
    auto* group =
        named(new QGroupBox(QStringLiteral("פרטי החשבון"), card), QStringLiteral("fraAccount"));
    auto* grid = new QGridLayout(group);

    ui.Label1 = label(group, QStringLiteral("Label1"), QStringLiteral(":מפתח חשבון"),
                      QStringLiteral("תקתוק כפול לחיפוש לפי מפתח חשבון"));
    ui.txtAccountKey = textBox(group, QStringLiteral("txtAccountKey"));
    ui.imgAccKey = picture(group, QStringLiteral("imgAccKey"), QStyle::SP_FileDialogInfoView);
    ui.Label2 = label(group, QStringLiteral("Label2"), QStringLiteral(":שם חשבון"),
                      QStringLiteral("תקתוק כפול לחיפוש לפי חלק משם החשבון"));
    ui.txtAccountName = textBox(group, QStringLiteral("txtAccountName"));
    ui.Label8 = label(group, QStringLiteral("Label8"), QStringLiteral(":טלפון"),
                      QStringLiteral("תקתוק כפול לחיפוש לפי טלפון"));
    ui.txtTelephone = textBox(group, QStringLiteral("txtTelephone"));
    ui.Label7 = label(group, QStringLiteral("Label7"), QStringLiteral(":כתובת"),
                      QStringLiteral("תקתוק כפול לחיפוש לפי חלק מהכתובת"));
    ui.txtAddress = textBox(group, QStringLiteral("txtAddress"));
    ui.LblDetails = label(group, QStringLiteral("LblDetails"), QStringLiteral("פרטים:"));
    ui.txtDetails = textBox(group, QStringLiteral("txtDetails"));
    ui.Label9 = label(group, QStringLiteral("Label9"), QStringLiteral(":עיר"));
    ui.txtCity = textBox(group, QStringLiteral("txtCity"));
    ui.txtZip = textBox(group, QStringLiteral("txtZip"));
    ui.txtZip->setMaximumWidth(80);
    ui.Label23 = label(group, QStringLiteral("Label23"), QStringLiteral("שכונה:"));
    ui.txtDistrict = textBox(group, QStringLiteral("txtDistrict"));
    ui.Label24 = label(group, QStringLiteral("Label24"), QStringLiteral("סוכן:"));
    ui.txtAgent = textBox(group, QStringLiteral("txtAgent"));

    // Right to left: column 0 is the rightmost, so each caption stands to the
    // right of its box.
    grid->addWidget(ui.Label1, 0, 0);
    grid->addWidget(ui.txtAccountKey, 0, 1);
    grid->addWidget(ui.imgAccKey, 0, 2);
    grid->addWidget(ui.Label2, 0, 3);
    grid->addWidget(ui.txtAccountName, 0, 4, 1, 2);
    grid->addWidget(ui.Label8, 1, 0);
    grid->addWidget(ui.txtTelephone, 1, 1, 1, 2);
    grid->addWidget(ui.Label7, 1, 3);
    grid->addWidget(ui.txtAddress, 1, 4, 1, 2);
    grid->addWidget(ui.Label9, 2, 0);
    grid->addWidget(ui.txtCity, 2, 1, 1, 2);
    grid->addWidget(ui.Label23, 2, 3);
    grid->addWidget(ui.txtDistrict, 2, 4);
    grid->addWidget(ui.txtZip, 2, 5);
    grid->addWidget(ui.LblDetails, 3, 0);
    grid->addWidget(ui.txtDetails, 3, 1, 1, 2);
    grid->addWidget(ui.Label24, 3, 3);
    grid->addWidget(ui.txtAgent, 3, 4, 1, 2);
    grid->setColumnStretch(1, 2);
    grid->setColumnStretch(4, 3);
    return group;
}

QGroupBox* balanceGroup(CardScreen& ui, QWidget* card) {
    auto* group =
        named(new QGroupBox(QStringLiteral("יתרות"), card), QStringLiteral("fraBalances"));
    auto* grid = new QGridLayout(group);
    ui.Label3 = label(group, QStringLiteral("Label3"), QStringLiteral(":יתרה"));
    ui.txtBalance = moneyBox(group, QStringLiteral("txtBalance"));
    ui.Label10 = label(group, QStringLiteral("Label10"), QStringLiteral(":אובליגו"));
    ui.txtOblig = moneyBox(group, QStringLiteral("txtOblig"));
    ui.Label17 = label(group, QStringLiteral("Label17"), QStringLiteral(" יתרת משלוח:"));
    ui.txtShipBalance = moneyBox(group, QStringLiteral("txtShipBalance"));
    grid->addWidget(ui.Label3, 0, 0);
    grid->addWidget(ui.txtBalance, 0, 1);
    grid->addWidget(ui.Label10, 1, 0);
    grid->addWidget(ui.txtOblig, 1, 1);
    grid->addWidget(ui.Label17, 2, 0);
    grid->addWidget(ui.txtShipBalance, 2, 1);
    grid->setRowStretch(3, 1);
    return group;
}

QHBoxLayout* companyRow(CardScreen& ui, QWidget* card) {
    auto* row = new QHBoxLayout;
    ui.Label4 = label(card, QStringLiteral("Label4"), QStringLiteral(":מחיצות ארדקו"));
    ui.txtCompPath = textBox(card, QStringLiteral("txtCompPath"));
    ui.Image1 = picture(card, QStringLiteral("Image1"), QStyle::SP_DriveNetIcon,
                        QStringLiteral("התחברות לארדקו חלונות"));
    ui.cmdSave = button(card, QStringLiteral("cmdSave"), QStringLiteral("שמור הגדרות"));
    row->addWidget(ui.Label4);
    row->addWidget(ui.txtCompPath, 1);
    row->addWidget(ui.Image1);
    row->addWidget(ui.cmdSave);
    return row;
}

QGroupBox* navigationGroup(CardScreen& ui, QWidget* card) {
    auto* group =
        named(new QGroupBox(QStringLiteral("מעבר בין חשבונות"), card), QStringLiteral("fraNav"));
    auto* row = new QHBoxLayout(group);
    ui.FirstButt = button(group, QStringLiteral("FirstButt"), QStringLiteral("החשבון הראשון"),
                          QStringLiteral("לחשבון הראשון"));
    ui.PrevButt = button(group, QStringLiteral("PrevButt"), QStringLiteral("החשבון הקודם"),
                         QStringLiteral("לחשבון הקודם"));
    ui.NextButt = button(group, QStringLiteral("NextButt"), QStringLiteral("החשבון הבא"),
                         QStringLiteral("לחשבון הבא"));
    ui.LastButt = button(group, QStringLiteral("LastButt"), QStringLiteral("החשבון האחרון"),
                         QStringLiteral("לחשבון האחרון"));
    row->addWidget(ui.FirstButt);
    row->addWidget(ui.PrevButt);
    row->addWidget(ui.NextButt);
    row->addWidget(ui.LastButt);
    return group;
}

QGroupBox* fetchGroup(CardScreen& ui, QWidget* card) {
    auto* group = named(new QGroupBox(QStringLiteral("תנועות"), card), QStringLiteral("fraFetch"));
    auto* grid = new QGridLayout(group);
    ui.ShowTransButt =
        button(group, QStringLiteral("ShowTransButt"), QStringLiteral("שליפת תנועות"));
    ui.CmdStop = button(group, QStringLiteral("CmdStop"), QStringLiteral("עצור"));
    progressBar(group, QStringLiteral("ProgressFrame"), QStringLiteral("ProgressFill"),
                ui.ProgressFrame, ui.ProgressFill);
    progressBar(group, QStringLiteral("ProgressFrame2"), QStringLiteral("ProgressFill2"),
                ui.ProgressFrame2, ui.ProgressFill2);
    grid->addWidget(ui.ShowTransButt, 0, 0);
    grid->addWidget(ui.CmdStop, 0, 1);
    grid->addWidget(ui.ProgressFrame, 1, 0, 1, 2, Qt::AlignCenter);
    grid->addWidget(ui.ProgressFrame2, 2, 0, 1, 2, Qt::AlignCenter);
    return group;
}

QGroupBox* optionsGroup(CardScreen& ui, QWidget* card) {
    auto* group =
        named(new QGroupBox(QStringLiteral("אפשרויות"), card), QStringLiteral("fraOptions"));
    auto* grid = new QGridLayout(group);
    option(grid, 0, group, ui.ChkOnlyOpenTrans, ui.Label14, QStringLiteral("ChkOnlyOpenTrans"),
           QStringLiteral("Label14"), QStringLiteral("רק פתוחות?"));
    option(grid, 1, group, ui.chkNegdiName, ui.Label21, QStringLiteral("chkNegdiName"),
           QStringLiteral("Label21"), QStringLiteral("שם חשבון נגדי באקסל?"));
    option(grid, 2, group, ui.chkShowHeadDetails, ui.Label11, QStringLiteral("chkShowHeadDetails"),
           QStringLiteral("Label11"), QStringLiteral("הדפס פרטי חשבון?"));
    option(grid, 3, group, ui.ChkOnlyGraph, ui.Label15, QStringLiteral("ChkOnlyGraph"),
           QStringLiteral("Label15"), QStringLiteral("קריאת תנועות לגרף בלבד?"));
    grid->setColumnStretch(1, 1);
    return group;
}

QGroupBox* outputGroup(CardScreen& ui, QWidget* card) {
    auto* group = named(new QGroupBox(QStringLiteral("הצגה"), card), QStringLiteral("fraOutputs"));
    auto* grid = new QGridLayout(group);
    ui.PrintButt = button(group, QStringLiteral("PrintButt"), QStringLiteral("הצגה להדפסה"));
    ui.ExcelButt = button(group, QStringLiteral("ExcelButt"), QStringLiteral("הצגה לאקסל"));
    ui.Label16 = label(group, QStringLiteral("Label16"), QStringLiteral("סוג הגרף:"));
    ui.CmbGraphType = named(new QComboBox(group), QStringLiteral("CmbGraphType"));
    ui.CmbGraphType->addItems(
        {QStringLiteral("שבועי"), QStringLiteral("חודשי"), QStringLiteral("רבעוני")});
    ui.CmbGraphDate = named(new QComboBox(group), QStringLiteral("CmbGraphDate"));
    ui.CmbGraphDate->addItems(
        {QStringLiteral("לפי תאריך התנועה"), QStringLiteral("לפי תאריך ערך")});
    ui.CmdGraph = button(group, QStringLiteral("CmdGraph"), QStringLiteral("גרף"));
    ui.Label16->setBuddy(ui.CmbGraphType);
    grid->addWidget(ui.PrintButt, 0, 0, 1, 2);
    grid->addWidget(ui.ExcelButt, 0, 2);
    grid->addWidget(ui.Label16, 1, 0);
    grid->addWidget(ui.CmbGraphType, 1, 1);
    grid->addWidget(ui.CmbGraphDate, 1, 2);
    grid->addWidget(ui.CmdGraph, 2, 0, 1, 3);
    return group;
}

QTableView* ledgerGrid(QWidget* card) {
    auto* grid = named(new QTableView(card), QStringLiteral("DocLines"));
    grid->setSelectionBehavior(QAbstractItemView::SelectRows);
    grid->setEditTriggers(QAbstractItemView::NoEditTriggers);
    grid->setAlternatingRowColors(true);
    grid->setWordWrap(false);
    grid->verticalHeader()->setVisible(false);
    grid->verticalHeader()->setDefaultSectionSize(grid->fontMetrics().height() + 6);
    grid->horizontalHeader()->setSectionsClickable(true);
    grid->horizontalHeader()->setSectionResizeMode(QHeaderView::Interactive);
    grid->horizontalHeader()->setDefaultAlignment(Qt::AlignLeading | Qt::AlignVCenter);
    // Columns open as wide as their headers; a short header ("מט") must not
    // leave its codes cut to an ellipsis.
    grid->horizontalHeader()->setMinimumSectionSize(
        grid->fontMetrics().horizontalAdvance(QStringLiteral("00000")));
    grid->setMinimumHeight(160);
    return grid;
}

QHBoxLayout* footerRow(CardScreen& ui, QWidget* card) {
    auto* row = new QHBoxLayout;
    ui.Label12 = label(card, QStringLiteral("Label12"), QStringLiteral("חיש - תנועה"));
    ui.Label13 = label(card, QStringLiteral("Label13"), QStringLiteral("לארדקו"));
    ui.Label22 = label(card, QStringLiteral("Label22"), QStringLiteral("גירסה 5.0518"));
    ui.Label25 = label(card, QStringLiteral("Label25"), QStringLiteral("XL"));
    ui.lblMakerName =
        label(card, QStringLiteral("lblMakerName"), QStringLiteral("צוות כרטיס החשבון"));
    ui.lblMakerPhone =
        label(card, QStringLiteral("lblMakerPhone"), QStringLiteral("טלפון: 03-5550100"));
    ui.lblMakerWeb = label(card, QStringLiteral("lblMakerWeb"), QStringLiteral("ardcard.example"));
    QFont title = ui.Label12->font();
    title.setBold(true);
    ui.Label12->setFont(title);
    ui.Label25->setFont(title);
    for (QLabel* l : {ui.Label12, ui.Label13, ui.Label25, ui.Label22})
        row->addWidget(l);
    row->addStretch(1);
    for (QLabel* l : {ui.lblMakerName, ui.lblMakerPhone, ui.lblMakerWeb})
        row->addWidget(l);
    return row;
}

} // namespace

void BuildCardScreen(CardScreen& ui, QWidget* card) {
    card->setLayoutDirection(Qt::RightToLeft);
    QFont font = card->font();
    font.setFamily(QStringLiteral("Arial"));
    card->setFont(font);

    auto* top = new QHBoxLayout;
    top->addWidget(accountGroup(ui, card), 3);
    top->addWidget(balanceGroup(ui, card), 1);

    auto* commands = new QHBoxLayout;
    commands->addWidget(navigationGroup(ui, card), 2);
    commands->addWidget(fetchGroup(ui, card), 1);

    auto* settings = new QHBoxLayout;
    settings->addWidget(optionsGroup(ui, card), 1);
    settings->addWidget(outputGroup(ui, card), 1);

    auto* main = new QVBoxLayout(card);
    main->addLayout(top);
    main->addLayout(companyRow(ui, card));
    main->addLayout(commands);
    main->addLayout(settings);
    ui.DocLines = ledgerGrid(card);
    main->addWidget(ui.DocLines, 1);
    main->addLayout(footerRow(ui, card));
}

} // namespace ardcard
