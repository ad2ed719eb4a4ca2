#pragma once

#include <QString>

namespace ardcard {

// Text placed into a page: & < > " ' become entities so that text from the
// database, the screen or a path shows as text and cannot end an attribute.
QString HtmlEscape(const QString& text);

} // namespace ardcard
