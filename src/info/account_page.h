#pragma once

#include <QString>

namespace ardcard::info {

// The account card into `path`: details, extra fields, active contacts,
// alternative keys and special prices of the account `accountKey`. An account
// that is not found leaves a page with its head and title row only.
// Throws Failure; the file is closed either way.
void WriteAccountPage(const QString& path, const QString& accountKey, const QString& connStr,
                      int connType);

} // namespace ardcard::info
