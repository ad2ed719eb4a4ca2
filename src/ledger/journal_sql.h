#pragma once

#include <QString>

namespace ardcard {

// The SQL of the journal read of one account. The account key goes between
// single quotes unchanged: the fetch has already stripped quotes and commas
// from it (StripQuotes), which is what keeps it a literal.
//
// The count query only scales the progress bar; the main query has no
// ordering clause, so lines (and the running balance) follow the order the
// database returns them in.
QString JournalCountSql(const QString& accountKey, bool onlyOpen, bool incNegdiName);
QString JournalMainSql(const QString& accountKey, bool onlyOpen, bool incNegdiName);

} // namespace ardcard
