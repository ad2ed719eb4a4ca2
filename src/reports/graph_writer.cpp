#include "reports/graph_writer.h"

#include "common/formats.h"
#include "common/period_totals.h"
#include "common/text_file_writer.h"
#include "reports/page_markup.h"

#include <QDate>
#include <cmath>

namespace ardcard::reports {

namespace {

QStringView graphTitle(int kind) {
    switch (kind) {
    case PeriodTotals::Week:
        return u"התפלגות הוצאות/הכנסות בשח לפי שבועות";
    case PeriodTotals::Month:
        return u"התפלגות הוצאות/הכנסות בשח לפי חודשים";
    case PeriodTotals::Quarter:
        return u"התפלגות הוצאות/הכנסות בשח לפי רבעונים";
    default:
        return {};
    }
}

// The largest absolute amount over every year and period: the full width.
double graphScale(const PeriodTotals& totals, int kind) {
    const int periods = PeriodTotals::periodsPerYear(kind);
    double scale = 0.0;
    for (const int year : totals.yearsDescending(kind)) {
        for (int period = periods; period >= 1; --period)
            scale = std::max(scale, std::fabs(totals.value(kind, year, period)));
    }
    return scale;
}

void writeHead(TextFileWriter& file) {
    file.writeLine(u"<HTML>");
    file.writeLine(u"<HEAD>");
    file.writeLine(kTitleLine);
    file.writeLine(kCharsetLine);
    file.writeLine(
        u"<style>.MyClass1{font-family:'Arial (hebrew)';font-size : 10pt; color: blue;}");
    file.writeLine(u"       .Title1 {font-family:'David';font-size : 12pt; color: blue; "
                   u"font-weight : bold;}");
    file.writeLine(u"       TD {font-family:'Arial (hebrew)';font-size : 8pt; color: black;}");
    file.writeLine(
        u"       .MyClass2 {font-family:'Arial (hebrew)';font-size : 10pt; color: black;}");
    file.writeLine(u"</style>");
    file.writeLine(u"</HEAD>");
    file.writeLine(u"<BODY class=MyClass1 BGCOLOR='#FFFFFF' TEXT='#000000' LINK='#0000FF' "
                   u"VLINK='#800080'>");
}

void writeBar(TextFileWriter& file, int year, int period, double value, double scale) {
    // Divide first, then multiply, and drop the fraction: an amount below a
    // hundredth of the scale gets width 0.
    const double share = std::floor(std::fabs(value) / scale * 100.0);
    const long long width = std::isfinite(share) ? static_cast<long long>(share) : 0;
    file.writeLine(u"<tr>");
    file.write(u"<td align='right' width='8%'>");
    file.write(QString::number(period));
    file.write(u"/");
    file.write(QString::number(year));
    file.writeLine(u"</td>");
    file.write(u"<td width='92%'><table border='1' cellspacing='0' cellpadding='0'");
    file.write(u" width='");
    file.write(QString::number(width));
    file.write(u"%'");
    file.write(u" border='0' bgcolor='#");
    file.write(value > 0 ? u"80FFA0" : u"FFC8E0");
    file.write(u"'><tr><td height='30' align='center'>");
    file.write(FormatWhole(value));
    file.writeLine(u"</td><tr></table></td>");
    file.writeLine(u"</tr>");
}

} // namespace

bool GraphHasBars(const PeriodTotals& totals, int kind) {
    return graphScale(totals, kind) > 0.0;
}

bool WriteGraph(const QString& path, const PeriodTotals& totals, int kind, const QString& shortName,
                const QString& accountKey, const QString& accountName) {
    const double scale = graphScale(totals, kind);
    if (!(scale > 0.0))
        return false;

    TextFileWriter file(path, TextFileWriter::Unmappable::CharacterReference);
    writeHead(file);
    file.write(u"<div align='left'>");
    file.write(FormatLongDate(QDate::currentDate()));
    file.writeLine(u"</div>");
    if (!TrimSpaces(shortName).isEmpty()) {
        file.write(u"<div class=Title1 align='center'>");
        WriteEscaped(file, shortName);
        file.writeLine(u"</div>");
    }
    file.write(u"<p class=Title1 align='center'><u>");
    file.write(graphTitle(kind));
    file.writeLine(u"</u></p>");
    if (!accountKey.isEmpty()) {
        file.write(u"<div class=MyClass2 align='center'><b>");
        WriteEscaped(file, accountName);
        file.write(u" - ");
        WriteEscaped(file, accountKey);
        file.writeLine(u"</b></div>");
    }
    file.writeLine(u"<BR>");
    file.writeLine(u"<table width='100%' border='0' cellpadding='3' cellspacing='2'>");

    const int periods = PeriodTotals::periodsPerYear(kind);
    for (const int year : totals.yearsDescending(kind)) {
        for (int period = periods; period >= 1; --period) {
            const double value = totals.value(kind, year, period);
            if (value != 0.0)
                writeBar(file, year, period, value, scale);
        }
    }
    WritePageFooter(file);
    file.close();
    return true;
}

} // namespace ardcard::reports
