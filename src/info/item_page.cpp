#include "info/item_page.h"

#include "common/text_file_writer.h"
#include "common/text_helpers.h"
#include "connection/database.h"
#include "info/info_page_frame.h"

#include <memory>

namespace ardcard::info {

namespace {

const QString kCell = QStringLiteral("    <td>");

// The script that hands the item's ID to the sibling viewer's item menu. The
// ID is the database's own number, written as it stands.
QStringList scriptBlock(const QVariant& id) {
    return {
        QStringLiteral("<script language='VBScript'>"),
        QStringLiteral("<!--"),
        QStringLiteral("    Function OpenCard()"),
        QStringLiteral("     Dim MyVelmor"),
        QStringLiteral("     Set MyVelmor = CreateObject(\"VLAView.MainCard\")"),
        QStringLiteral("     MyVelmor.OpenItemButts ") + ardcard::PlainText(id),
        QStringLiteral("    End Function"),
        QStringLiteral("// -->"),
        QStringLiteral("</script>"),
    };
}

// A price followed by a space and its currency, both as they stand.
QString priceWithCurrency(const Recordset& rs, const QString& price, const QString& currency) {
    return DetailValue(CellText(rs.field(price)) + u' ' + CellText(rs.field(currency)));
}

std::vector<DetailsGroup> detailsGroups(const Recordset& rs) {
    auto plain = [&rs](const char16_t* field) {
        return DetailValue(CellText(rs.field(QString::fromUtf16(field))));
    };
    return {
        {{QStringLiteral("מפתח פריט"), QStringLiteral("שם פריט"), QStringLiteral("מיון"),
          QStringLiteral("חתך")},
         {BoldValue(rs.field(QStringLiteral("ItemKey"))),
          BoldValue(rs.field(QStringLiteral("ItemName"))), plain(u"SortGroup"), plain(u"Filter")}},
        {{QStringLiteral("יח מידה"), QStringLiteral("שם לועזי"), QStringLiteral("משקל"),
          QStringLiteral("נפח"), QStringLiteral("קובץ מקושר")},
         {plain(u"SalesUnit"), plain(u"ForignName"), plain(u"Weight"), plain(u"Volume"),
          LinkedFileValue(rs.field(QStringLiteral("ExFile")))}},
        {{QStringLiteral("איתור"), QStringLiteral("ברקוד"), QStringLiteral("מחסן"),
          QStringLiteral("יתרה במלאי"), QStringLiteral("מחיר מכירה"), QStringLiteral("מחיר קנייה")},
         {plain(u"Localization"), plain(u"BarCode"), plain(u"DefaultWarehouse"), plain(u"Quantity"),
          priceWithCurrency(rs, QStringLiteral("Price"), QStringLiteral("Currency")),
          priceWithCurrency(rs, QStringLiteral("PurchPrice"), QStringLiteral("PurchCurrency"))}},
    };
}

ExtraFieldQueries extraQueries(const QString& k) {
    ExtraFieldQueries q;
    q.notesSql = QStringLiteral("SELECT ExtraNoteNames.NoteName, ExtraNotes.Note, "
                                "ExtraNoteNames.NoteID"
                                " FROM ExtraNoteNames, ExtraNotes"
                                " WHERE ExtraNoteNames.NoteID = ExtraNotes.NoteID"
                                " AND ExtraNotes.ItemFlag = 1 AND ExtraNoteNames.ItemFlag = 1"
                                " AND ExtraNotes.KeF = ") +
                 k + QStringLiteral(" ORDER BY ExtraNoteNames.NoteName");
    q.sumsSql = QStringLiteral("SELECT ExtraSumNames.SuFName, ExtraSums.SuF, ExtraSums.SuFID"
                               " FROM ExtraSumNames, ExtraSums"
                               " WHERE ExtraSums.SuFID = ExtraSumNames.SuFID"
                               " AND ExtraSums.ItemFlag = 1 AND ExtraSumNames.ItemFlag = 1"
                               " AND ExtraSums.KeF = ") +
                k + QStringLiteral(" ORDER BY ExtraSumNames.SuFName");
    q.datesSql = QStringLiteral("SELECT ExtraDateNames.DatFName, ExtraDates.DatF, "
                                "ExtraDateNames.DatFID"
                                " FROM ExtraDateNames, ExtraDates"
                                " WHERE ExtraDateNames.DatFID = ExtraDates.DatFID"
                                " AND ExtraDates.ItemFlag = 1 AND ExtraDateNames.ItemFlag = 1"
                                " AND ExtraDates.KeF = ") +
                 k +
                 QStringLiteral(" AND Not ExtraDates.DatF Is Null"
                                " ORDER BY ExtraDateNames.DatFName");
    q.noteIdField = QStringLiteral("NoteID");
    q.sumIdField = QStringLiteral("SuFID");
    q.dateIdField = QStringLiteral("DatFID");
    return q;
}

ListSection priceListsSection(const QString& k) {
    return {
        QString::fromUtf16(kLayoutRowFirstCell),
        QStringLiteral("SELECT PL.PriceListNumber, PriceListNames.PriceListName As PriceName"
                       ", PL.Price As LastPrice, PL.CurrencyCode As LastCurrency"
                       " FROM PriceListsLastDateWithSub PL, PriceListNames"
                       " WHERE PriceListNames.PriceListID = PL.PriceListNumber"
                       " AND Not (PL.Price Is Null)"
                       " AND PL.ItemKey = ") +
            k +
            QStringLiteral(" GROUP BY PL.PriceListNumber, PriceListNames.PriceListName, PL.Price, "
                           "PL.CurrencyCode"
                           " ORDER BY PL.PriceListNumber"),
        QStringLiteral("  <tr><td colspan=3 class=GCap align=right>מחירונים</td></tr>"),
        HeadingLines({QStringLiteral("מחירון"), QStringLiteral("מחיר"), QStringLiteral("מטבע")}),
        [](TextFileWriter& out, const Recordset& rs) {
            // The list's number shows as a tool tip over its name.
            out.writeLine(QStringLiteral("    <td title='") +
                          CellText(rs.field(QStringLiteral("PriceListNumber"))) +
                          QStringLiteral("'>") + CellText(rs.field(QStringLiteral("PriceName"))) +
                          QStringLiteral("</td>"));
            out.writeLine(Cell(kCell, MoneyText(rs.field(QStringLiteral("LastPrice")))));
            out.writeLine(Cell(kCell, CellText(rs.field(QStringLiteral("LastCurrency")))));
        },
        QStringLiteral("</td>"),
    };
}

ListSection specialPricesSection(const QString& k) {
    return {
        QString::fromUtf16(kLayoutSecondCell),
        QStringLiteral("SELECT SpecialPrices.AccountKey, Accounts.FullName, SpecialPrices.ValidDate"
                       ", SpecialPricesMoves.Price, SpecialPricesMoves.CurrencyCode"
                       " FROM SpecialPricesMoves, SpecialPrices, Accounts"
                       " WHERE SpecialPricesMoves.SPID = SpecialPrices.ID"
                       " And SpecialPricesMoves.MinQuantity=0"
                       " AND Accounts.AccountKey = SpecialPrices.AccountKey"
                       " AND Not (SpecialPricesMoves.Price Is Null)"
                       " AND SpecialPrices.ItemKey = ") +
            k + QStringLiteral(" ORDER BY SpecialPrices.AccountKey"),
        QStringLiteral("  <tr><td colspan=4 class=GCap align=right>מחירים מיוחדים</td></tr>"),
        HeadingLines({QStringLiteral("מפתח חשבון"), QStringLiteral("שם חשבון"),
                      QStringLiteral("מחיר"), QStringLiteral("מטבע")}),
        [](TextFileWriter& out, const Recordset& rs) {
            WritePlainCells(out, rs, {QStringLiteral("AccountKey"), QStringLiteral("FullName")});
            out.writeLine(Cell(kCell, MoneyText(rs.field(QStringLiteral("Price")))));
            out.writeLine(Cell(kCell, CellText(rs.field(QStringLiteral("CurrencyCode")))));
        },
        QStringLiteral("</td></tr>"),
    };
}

ListSection alterKeysSection(const QString& k) {
    return {
        QString::fromUtf16(kLayoutRowFirstCell),
        QStringLiteral("SELECT AlterKeys.AccountKey, Accounts.FullName, AlterKeys.AlterKey"
                       ", AlterKeys.Def"
                       " FROM AlterKeys, Accounts"
                       " WHERE Accounts.AccountKey = AlterKeys.AccountKey"
                       " AND Not (AlterKeys.AlterKey Is Null)"
                       " AND AlterKeys.ItemKey = ") +
            k + QStringLiteral(" ORDER BY AlterKeys.AccountKey"),
        QStringLiteral("  <tr><td colspan=4 class=GCap align=right>מפתחות חליפיים</td></tr>"),
        HeadingLines({QStringLiteral("מפתח חשבון"), QStringLiteral("שם חשבון"),
                      QStringLiteral("מפתח חליפי"), QStringLiteral("ברירת מחדל?")}),
        [](TextFileWriter& out, const Recordset& rs) {
            WritePlainCells(out, rs, {QStringLiteral("AccountKey"), QStringLiteral("FullName")});
            out.writeLine(Cell(QStringLiteral("    <td dir=ltr>"),
                               CellText(rs.field(QStringLiteral("AlterKey")))));
            out.writeLine(DefaultFlagCell(rs.field(QStringLiteral("Def"))));
        },
        QStringLiteral("</td>"),
    };
}

ListSection alternativeItemsSection(const QString& k) {
    return {
        QString::fromUtf16(kLayoutSecondCell),
        QStringLiteral("SELECT AlternativeItems.AlterItem, Items.ItemName"
                       ", AlternativeItems.Priority"
                       " FROM AlternativeItems, Items"
                       " WHERE Items.ItemKey = AlternativeItems.AlterItem"
                       " AND AlternativeItems.ItemKey = ") +
            k +
            QStringLiteral(" ORDER BY AlternativeItems.AlterItem, AlternativeItems.Priority Desc"),
        QStringLiteral("  <tr><td colspan=3 class=GCap align=right>פריטים חליפיים</td></tr>"),
        HeadingLines(
            {QStringLiteral("מפתח פריט"), QStringLiteral("שם פריט"), QStringLiteral("עדיפות")}),
        [](TextFileWriter& out, const Recordset& rs) {
            WritePlainCells(out, rs,
                            {QStringLiteral("AlterItem"), QStringLiteral("ItemName"),
                             QStringLiteral("Priority")});
        },
        QStringLiteral("</td></tr>"),
    };
}

// Rows come in component-key order; a tree type repeated from the row above
// is shown as "." so that each change of type stands out.
ListSection treesSection(const QString& k, const std::shared_ptr<int>& lastTreeType) {
    return {
        QString::fromUtf16(kLayoutRowFirstCell),
        QStringLiteral("SELECT TreeTypes.TreeTypeName, Trees.Quantity, Items.ItemKey"
                       ", Items.ItemName, Trees.SonQuant, Trees.TreeType"
                       " FROM TreeTypes, Trees, Items"
                       " WHERE Trees.LeveF = 1"
                       " AND TreeTypes.TreeType = Trees.TreeType"
                       " AND Trees.ParentKey = ") +
            k + QStringLiteral(" AND Items.ItemKey = Trees.ItemKey ORDER BY Trees.ItemKey"),
        QStringLiteral("  <tr><td colspan=5 class=GCap align=right>עצי מוצר</td></tr>"),
        HeadingLines({QStringLiteral("סוג עץ"), QStringLiteral("כמות האב"),
                      QStringLiteral("מפתח הבן"), QStringLiteral("שם הבן"),
                      QStringLiteral("כמות הבן")}),
        [lastTreeType](TextFileWriter& out, const Recordset& rs) {
            const QString prefix = QStringLiteral("     <td>");
            const int treeType = rs.field(QStringLiteral("TreeType")).toInt();
            if (treeType != *lastTreeType)
                out.writeLine(Cell(prefix, CellText(rs.field(QStringLiteral("TreeTypeName")))));
            else
                out.writeLine(u"     <td>.</td>");
            out.writeLine(Cell(prefix, QuantityText(rs.field(QStringLiteral("Quantity")))));
            WritePlainCells(out, rs, {QStringLiteral("ItemKey"), QStringLiteral("ItemName")},
                            prefix);
            out.writeLine(Cell(prefix, QuantityText(rs.field(QStringLiteral("SonQuant")))));
            *lastTreeType = treeType;
        },
        QStringLiteral("</td>"),
    };
}

} // namespace

void WriteItemPage(const QString& path, const QString& itemKey, const QString& connStr,
                   int connType) {
    const QString k = KeyLiteral(itemKey, connType);
    WritePageFile(path, [&](TextFileWriter& out) {
        Recordset rs;
        rs.Open(
            QStringLiteral("Select Items.ID, Items.ItemKey, Items.ItemName, Items.SortGroup"
                           ", Items.Filter, Items.ForignName, Items.SalesUnit"
                           ", Items.Weight, Items.Volume, Items.DefaultWarehouse"
                           ", Items.Localization, Items.BarCode, Items.Quantity"
                           ", Items.Price, Items.Currency, Items.ExFile, PurchPrice, PurchCurrency"
                           " From Items"
                           " Where Items.ItemKey =") +
                k,
            connStr);
        if (rs.Bof() && rs.Eof()) {
            rs.Close();
            return;
        }

        WritePageHead(out, QStringLiteral("<TITLE>נתוני פריט</TITLE>"),
                      scriptBlock(rs.field(QStringLiteral("ID"))));
        WriteFrameOpening(out);
        out.writeLine(u"<tr valign='top'>");
        out.writeLine(u" <td class=Title1 align='right'>כרטיס פריט - ארדקו חלונות</td>");
        out.writeLine(
            u" <td align='left'><a class=VLBut onclick='vbscript:OpenCard()'>לתפריט פריט</a></td>");
        out.writeLine(u"</tr>");

        out.writeLine(kLayoutRowFirstCell);
        WriteDetailsSection(out, detailsGroups(rs));
        rs.Close();
        WriteExtraFieldsSection(out, rs, connStr, extraQueries(k));

        WriteListSection(out, rs, connStr, priceListsSection(k));
        WriteListSection(out, rs, connStr, specialPricesSection(k));
        WriteListSection(out, rs, connStr, alterKeysSection(k));
        WriteListSection(out, rs, connStr, alternativeItemsSection(k));
        WriteListSection(out, rs, connStr, treesSection(k, std::make_shared<int>(0)));
        out.writeLine(kLayoutSecondCell);
        out.writeLine(u"</td></tr>");

        WriteFrameClosing(out);
    });
}

} // namespace ardcard::info
