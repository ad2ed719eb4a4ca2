#pragma once

#include <QDate>
#include <QString>
#include <QStringList>
#include <QVariant>

namespace ardcard {

// The value's text without double quotes, single quotes and commas; Null or
// empty gives an empty text. Used for account keys and CSV fields.
QString StripQuotes(const QVariant& value);

// Rebuilds `list` from a company-directory text: entries separated by ";" or
// ",", empty entries dropped, entry 0 kept empty. Returns the number of
// entries; a text with no entry returns 0 and leaves `list` as it was.
int SplitCompanyDirs(const QString& text, QStringList& list);

// Null helpers of the ledger and the pages.
QString NullToText(const QVariant& value, const QString& fallback);
double NullToZero(const QVariant& value);
// "&nbsp;" for Null, otherwise the value's ordinary text (PlainText).
QString NullToNbsp(const QVariant& value);

// The ordinary text of a value: numbers in their plain form (PlainNumber),
// dates as yyyy-mm-dd, everything else as Qt converts it.
QString PlainText(const QVariant& value);

// A number in its shortest plain form: at most 15 significant digits, no
// grouping, no trailing zeros, no decimal point for whole numbers, never an
// exponent ("2", "1234.5", "0.1", "1000000000000000").
QString PlainNumber(double value);

// A date out of a value that may hold a date, a date-time or ISO text
// ("2024-03-01", "2024-03-01 00:00:00", "2024-03-01T10:00:00"). Invalid for
// Null and for anything else.
QDate ToDate(const QVariant& value);

// The user's temporary directory, where every output page is written: TMPDIR
// as it is set, else the platform's default. Qt's own answer resolves the path
// and comes back empty for a directory that does not exist, which would put
// the pages at the root of the file system; taken as set, such a directory
// makes the writing fail, and the command says so.
QString TempDirectory();

} // namespace ardcard
