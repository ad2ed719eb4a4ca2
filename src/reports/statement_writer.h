#pragma once

#include "reports/report_screen.h"

#include <QString>

namespace ardcard {
class LedgerModel;
class TextFileWriter;
struct ModuleState;
} // namespace ardcard

namespace ardcard::reports {

// The printable account statement: a heading block with the company and the
// account, the ledger rows as a right-to-left table (grid columns 12 down to
// 0), a separator naming the company directory wherever the company changes
// between rows (only when several directories are configured), and one total
// per currency whose total is not exactly 0.
//
// Writes the whole page to `path` (an existing file is replaced) and closes
// it; any failure throws Failure with the file already closed. The company's
// short name is taken from `state` as it stands: the caller refreshes it.
void WriteStatement(const QString& path, const LedgerModel& ledger, const ModuleState& state,
                    const ReportScreen& screen);

// One two-cell heading row, the value before the label, or nothing when the
// value is empty (a value of spaces is written).
void WriteStatementHeading(TextFileWriter& file, const QString& title, const QString& content);

} // namespace ardcard::reports
