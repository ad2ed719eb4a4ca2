#include "common/html_escape.h"

namespace ardcard {

QString HtmlEscape(QStringView text) {
    QString out;
    out.reserve(text.size() + text.size() / 8);
    for (const QChar c : text) {
        if (const char* entity = HtmlEntity(c.unicode()))
            out += QLatin1String(entity);
        else
            out += c;
    }
    return out;
}

} // namespace ardcard
