#include "info/account_page.h"

#include "common/text_file_writer.h"
#include "common/text_helpers.h"
#include "connection/database.h"
#include "info/info_page_frame.h"

namespace ardcard::info {

namespace {

const QString kCell = QStringLiteral("    <td>");

// A code followed by " - " and its name when the name is there.
QString codeWithName(const QVariant& code, const QVariant& name) {
    QString text = CellText(code);
    if (!name.isNull() && !name.toString().isEmpty())
        text += QStringLiteral(" - ") + CellText(name);
    return text;
}

std::vector<DetailsGroup> detailsGroups(const Recordset& rs) {
    auto plain = [&rs](const char16_t* field) {
        return DetailValue(CellText(rs.field(QString::fromUtf16(field))));
    };
    return {
        {{QStringLiteral("מפתח חשבון"), QStringLiteral("שם חשבון"), QStringLiteral("מיון"),
          QStringLiteral("חתך")},
         {BoldValue(rs.field(QStringLiteral("AccountKey"))),
          BoldValue(rs.field(QStringLiteral("FullName"))),
          DetailValue(codeWithName(rs.field(QStringLiteral("SortGroup")),
                                   rs.field(QStringLiteral("SortName")))),
          plain(u"Filter")}},
        {{QStringLiteral("כתובת"), QStringLiteral("עיר"), QStringLiteral("מיקוד"),
          QStringLiteral("ארץ")},
         {plain(u"Address"), plain(u"City"), plain(u"Zip"), plain(u"Country")}},
        {{QStringLiteral("טלפון"), QStringLiteral("פקס"), QStringLiteral("דוא'ל"),
          QStringLiteral("סוכן")},
         {plain(u"Phone"), plain(u"Fax"), plain(u"Email"),
          DetailValue(codeWithName(rs.field(QStringLiteral("Agent")),
                                   rs.field(QStringLiteral("AgentName"))))}},
        {{QStringLiteral("עיסוק"), QStringLiteral("הערות"), QStringLiteral("הערות מיוחדות"),
          QStringLiteral("קובץ מקושר")},
         {plain(u"WorF"), plain(u"Details"), plain(u"CustomerNote"),
          LinkedFileValue(rs.field(QStringLiteral("ExFile")))}},
    };
}

ExtraFieldQueries extraQueries(const QString& k) {
    ExtraFieldQueries q;
    q.notesSql = QStringLiteral("SELECT ExtraNoteNames.NoteName, ExtraNotes.Note"
                                " FROM ExtraNoteNames, ExtraNotes"
                                " WHERE ExtraNoteNames.NoteID = ExtraNotes.NoteID"
                                " AND ExtraNotes.ItemFlag = 0 AND ExtraNoteNames.ItemFlag = 0"
                                " AND ExtraNotes.KeF = ") +
                 k + QStringLiteral(" ORDER BY ExtraNoteNames.NoteName");
    q.sumsSql = QStringLiteral("SELECT ExtraSumNames.SuFName, ExtraSums.SuF"
                               " FROM ExtraSumNames, ExtraSums"
                               " WHERE ExtraSums.SuFID = ExtraSumNames.SuFID"
                               " AND ExtraSums.ItemFlag = 0 AND ExtraSumNames.ItemFlag = 0"
                               " AND ExtraSums.KeF = ") +
                k + QStringLiteral(" ORDER BY ExtraSumNames.SuFName");
    q.datesSql = QStringLiteral("SELECT ExtraDateNames.DatFName, ExtraDates.DatF"
                                " FROM ExtraDateNames, ExtraDates"
                                " WHERE ExtraDateNames.DatFID = ExtraDates.DatFID"
                                " AND ExtraDates.ItemFlag = 0 AND ExtraDateNames.ItemFlag = 0"
                                " AND ExtraDates.KeF = ") +
                 k +
                 QStringLiteral(" AND Not ExtraDates.DatF Is Null"
                                " ORDER BY ExtraDateNames.DatFName");
    return q;
}

ListSection contactsSection(const QString& k) {
    return {
        QStringLiteral("<tr valign='top'><td colspan=2>"),
        QStringLiteral("SELECT CRMContact.CName, CRMContact.CTitle, CRMContact.CMail"
                       ", CRMContact.CPhone, CRMContact.C2Phone, CRMContact.CCelular"
                       ", CRMContact.CFax, CRMContact.Branch, CRMContact.Address"
                       ", CRMContact.Remark, CRMContact.SecRemark"
                       " FROM CRMContact"
                       " WHERE CRMContact.AccountKey = ") +
            k + QStringLiteral(" And CRMContact.CStatus = 1 ORDER BY CRMContact.ID"),
        QStringLiteral("  <tr><td colspan=4 class=GCap align=right>אנשי קשר</td></tr>"),
        HeadingLines({QStringLiteral("שם איש קשר"), QStringLiteral("תפקיד"),
                      QStringLiteral("דוא'ל"), QStringLiteral("טלפון"), QStringLiteral("טלפון 2"),
                      QStringLiteral("נייד"), QStringLiteral("פקס"), QStringLiteral("סניף"),
                      QStringLiteral("כתובת"), QStringLiteral("הערות"), QStringLiteral("הערות 2")}),
        [](TextFileWriter& out, const Recordset& rs) {
            WritePlainCells(
                out, rs,
                {QStringLiteral("CName"), QStringLiteral("CTitle"), QStringLiteral("CMail"),
                 QStringLiteral("CPhone"), QStringLiteral("C2Phone"), QStringLiteral("CCelular"),
                 QStringLiteral("CFax"), QStringLiteral("Branch"), QStringLiteral("Address"),
                 QStringLiteral("Remark"), QStringLiteral("SecRemark")});
        },
        QStringLiteral("</td></tr>"),
    };
}

ListSection alterKeysSection(const QString& k) {
    return {
        QString::fromUtf16(kLayoutRowFirstCell),
        QStringLiteral("SELECT AlterKeys.ItemKey, Items.ItemName, AlterKeys.AlterKey"
                       ", AlterKeys.Def"
                       " FROM AlterKeys, Items"
                       " WHERE Items.ItemKey = AlterKeys.ItemKey"
                       " AND Not (AlterKeys.AlterKey Is Null)"
                       " AND AlterKeys.AccountKey = ") +
            k + QStringLiteral(" ORDER BY AlterKeys.ItemKey"),
        QStringLiteral("  <tr><td colspan=4 class=GCap align=right>מפתחות חליפיים</td></tr>"),
        HeadingLines({QStringLiteral("מפתח פריט"), QStringLiteral("שם פריט"),
                      QStringLiteral("מפתח חליפי"), QStringLiteral("ברירת מחדל?")}),
        [](TextFileWriter& out, const Recordset& rs) {
            WritePlainCells(out, rs, {QStringLiteral("ItemKey"), QStringLiteral("ItemName")});
            out.writeLine(Cell(QStringLiteral("    <td dir=ltr>"),
                               CellText(rs.field(QStringLiteral("AlterKey")))));
            out.writeLine(DefaultFlagCell(rs.field(QStringLiteral("Def"))));
        },
        QStringLiteral("</td>"),
    };
}

ListSection specialPricesSection(const QString& k) {
    return {
        QString::fromUtf16(kLayoutSecondCell),
        QStringLiteral("SELECT SpecialPrices.ItemKey, Items.ItemName, SpecialPrices.ValidDate"
                       ", SpecialPricesMoves.Price, SpecialPricesMoves.CurrencyCode"
                       " FROM SpecialPricesMoves, SpecialPrices, Items"
                       " WHERE SpecialPricesMoves.SPID = SpecialPrices.ID"
                       " And SpecialPricesMoves.MinQuantity=0"
                       " AND Items.ItemKey = SpecialPrices.ItemKey"
                       " AND Not (SpecialPricesMoves.Price Is Null)"
                       " AND SpecialPrices.AccountKey = ") +
            k + QStringLiteral(" ORDER BY SpecialPrices.ItemKey"),
        QStringLiteral("  <tr><td colspan=4 class=GCap align=right>מחירים מיוחדים</td></tr>"),
        HeadingLines({QStringLiteral("מפתח פריט"), QStringLiteral("שם פריט"),
                      QStringLiteral("מחיר"), QStringLiteral("מטבע")}),
        [](TextFileWriter& out, const Recordset& rs) {
            WritePlainCells(out, rs, {QStringLiteral("ItemKey"), QStringLiteral("ItemName")});
            out.writeLine(Cell(kCell, MoneyText(rs.field(QStringLiteral("Price")))));
            out.writeLine(Cell(kCell, CellText(rs.field(QStringLiteral("CurrencyCode")))));
        },
        QStringLiteral("</td></tr>"),
    };
}

} // namespace

void WriteAccountPage(const QString& path, const QString& accountKey, const QString& connStr,
                      int connType) {
    QString k = KeyLiteral(accountKey, connType);
    WritePageFile(path, [&](TextFileWriter& out) {
        WritePageHead(out, QStringLiteral("<TITLE>נתוני חשבון</TITLE>"));
        WriteFrameOpening(out);
        out.writeLine(u"<tr valign='top'><td class=Title1 align='right' colspan=2>כרטיס חשבון - "
                      u"ארדקו חלונות</td></tr>");

        Recordset rs;
        rs.Open(QStringLiteral("SELECT Accounts.ID, Accounts.AccountKey, Accounts.FullName"
                               ", Accounts.Filter, Accounts.SortGroup, Accounts.Agent"
                               ", Accounts.Address, Accounts.City, Accounts.Zip, Accounts.Country"
                               ", Accounts.Phone, Accounts.Fax, Accounts.WorF, Accounts.ExFile"
                               ", Accounts.Details, Accounts.CustomerNote, Accounts.Email"
                               ", (Select AccSortNames.SortCodeName From AccSortNames"
                               " Where AccSortNames.AccSortCode = Accounts.SortGroup) As SortName"
                               ", (Select AWN.Name From AgentWarehouseNames AWN"
                               " Where AWN.Sort = 1 And AWN.NameID = Accounts.Agent) As AgentName"
                               " From Accounts"
                               " Where Accounts.AccountKey =") +
                    k,
                connStr);
        if (rs.Bof() && rs.Eof()) {
            rs.Close();
            return;
        }
        // The later queries use the key as the database keeps it, so a key typed
        // in another letter case still finds the account's contacts and prices.
        k = KeyLiteral(ardcard::PlainText(rs.field(QStringLiteral("AccountKey"))), connType);

        out.writeLine(kLayoutRowFirstCell);
        WriteDetailsSection(out, detailsGroups(rs));
        rs.Close();
        WriteExtraFieldsSection(out, rs, connStr, extraQueries(k));

        WriteListSection(out, rs, connStr, contactsSection(k));
        WriteListSection(out, rs, connStr, alterKeysSection(k));
        WriteListSection(out, rs, connStr, specialPricesSection(k));

        WriteFrameClosing(out);
    });
}

} // namespace ardcard::info
