#pragma once

#include <QString>

namespace ardcard::info {

// The item card into `path`: details, extra fields, price lists, special
// prices, alternative keys, alternative items and first-level product trees
// of the item `itemKey`, with the link that opens the item's menu in the
// sibling viewer. An item that is not found leaves an empty file.
// Throws Failure; the file is closed either way.
void WriteItemPage(const QString& path, const QString& itemKey, const QString& connStr,
                   int connType);

} // namespace ardcard::info
