#pragma once

#include <QString>

namespace ardcard {

// The SQL text of the account lookup. Search values go between single
// quotes with every single quote doubled, so a value can never end its
// literal; values without quotes give the query text unchanged.

// The value with leading and trailing blanks (spaces) removed.
QString TrimBlanks(const QString& value);

// `value` as an SQL text literal: 'value', single quotes doubled.
QString SqlText(const QString& value);

// The condition for a search kind ("AccountKey" exact; "AccountName",
// "Telephone", "Address", "Details" partial), kinds compared ignoring case;
// empty for no search or an unknown kind.
QString SearchCondition(const QString& searchBy, const QString& value);

// The query that picks the ID of the account to show: the lowest or highest
// ID among the non-dummy accounts matching the search, after or before
// `location` for "Next" / "Previous". A start kind other than "First",
// "Last", "Next", "Previous" leaves the aggregate out (the database then
// rejects the query).
QString ChoosingQuery(const QString& startFrom, int location, const QString& searchBy,
                      const QString& searchValue);

// The query that reads the account row with this ID.
QString AccountRowQuery(int id);

} // namespace ardcard
