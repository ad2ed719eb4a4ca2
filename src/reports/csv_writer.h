#pragma once

#include <QString>

namespace ardcard {
class LedgerModel;
struct ModuleState;
} // namespace ardcard

namespace ardcard::reports {

// The ledger as comma-separated text for a spreadsheet: a Hebrew header
// line, then one line per data row with grid columns 0 to 12, the counter
// account, its name (only with `withCounterName`) and the company directory
// (only when several are configured). Fields are never quoted; quotes and
// commas are removed from them instead. The header names exactly the fields
// the rows carry. Characters windows-1255 cannot hold become "?".
void WriteCsv(const QString& path, const LedgerModel& ledger, const ModuleState& state,
              bool withCounterName);

// The small page that links to the CSV file, with an explanation of what
// following the link does. `csvPath` is written as the link target as it
// stands (escaped for the page, not turned into a URL).
void WriteCsvPage(const QString& path, const QString& csvPath);

} // namespace ardcard::reports
