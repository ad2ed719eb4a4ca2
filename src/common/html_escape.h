#pragma once

#include <QString>
#include <QStringView>

namespace ardcard {

// Text placed into a page: & < > " ' become entities so that text from the
// database, the screen or a path shows as text and cannot end an attribute.
// HtmlEntity gives the entity of one character, or null for a character that
// stays as it is; the page writers and HtmlEscape both go through it.
constexpr const char* HtmlEntity(char16_t c) {
    switch (c) {
    case u'&':
        return "&amp;";
    case u'<':
        return "&lt;";
    case u'>':
        return "&gt;";
    case u'"':
        return "&quot;";
    case u'\'':
        return "&#39;";
    default:
        return nullptr;
    }
}
QString HtmlEscape(QStringView text);

} // namespace ardcard
