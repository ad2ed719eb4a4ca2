#pragma once

#include <QString>

namespace ardcard::info {

// The list of document types (code and name, codes above 0) into `path`.
// With no such type the page ends after its title. Throws Failure; the file
// is closed either way.
void WriteDocTypesPage(const QString& path, const QString& connStr);

// A document-type code as numeric output shows it: a space where a minus
// sign would stand (or the minus sign), the digits, a trailing space.
QString DocTypeCodeText(qint64 code);

} // namespace ardcard::info
