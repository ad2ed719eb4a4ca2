#pragma once

#include <QString>

namespace ardcard {

// The database a company-directory text stands for when one database is
// wanted: its first entry ("a.db;b.db" gives "a.db"), or an empty text when
// the text names none.
QString FirstCompanyDir(const QString& companyDirText);

// Reads the company's definitions row (ID 1) of the first company named in
// `compPath`, through the connection values of the calling thread, into
// moduleState().company. Only non-empty values are stored, so a company
// without (say) a hidden-accounts filter keeps the one read before. Silent:
// any failure ends the read, keeping what was stored up to it. True when the
// row was read.
//
// Used by the card on start-up and whenever its company directories are set,
// and by the statement and graph pages before they write their headings.
bool ReadCompanyDetails(const QString& compPath);

} // namespace ardcard
