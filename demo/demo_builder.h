#pragma once

#include "demo/company_writer.h"
#include "demo/schema.h"

#include <QString>

namespace ardcard::demo {

// Writes dir/demo.db and dir/demo2.db, two company files full of believable
// Hebrew data: accounts (among them header rows with Dumi 1 and hidden
// accounts), seven years of journal lines in five currencies, contacts, extra
// fields, items with price lists, special prices, alternative keys and items,
// product trees and document types. The contents depend on nothing but this
// code: two builds give the same rows. Throws Failure.
void BuildDemoCompany(const QString& dir);

// The file names BuildDemoCompany writes into its directory.
QString DemoFileName();
QString Demo2FileName();

// An account, not hidden, that has journal lines in both demo companies.
QString DemoAccountKey();

// A company file with the account `accountKey`, four counter accounts and
// exactly `lineCount` journal lines of that account that the journal read
// takes (each with its counter line), dated 2019 to 2025. Built in one
// transaction; a million lines take seconds. Throws Failure.
void BuildLedgerCompany(const QString& path, const QString& accountKey, int lineCount);

} // namespace ardcard::demo
