// HtmlEscape: no markup character survives, and the text comes back whole.
#include "common/html_escape.h"

#include <cstdlib>

using namespace ardcard;

namespace {
QString unescape(QString s) {
    s.replace(QStringLiteral("&lt;"), QStringLiteral("<"));
    s.replace(QStringLiteral("&gt;"), QStringLiteral(">"));
    s.replace(QStringLiteral("&quot;"), QStringLiteral("\""));
    s.replace(QStringLiteral("&#39;"), QStringLiteral("'"));
    s.replace(QStringLiteral("&amp;"), QStringLiteral("&"));
    return s;
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const QString text =
        QString::fromUtf8(reinterpret_cast<const char*>(data), static_cast<qsizetype>(size));
    const QString escaped = HtmlEscape(text);
    if (escaped.contains(u'<') || escaped.contains(u'>') || escaped.contains(u'"') ||
        escaped.contains(u'\''))
        std::abort();
    for (qsizetype i = escaped.indexOf(u'&'); i >= 0; i = escaped.indexOf(u'&', i + 1)) {
        const QStringView tail = QStringView(escaped).mid(i);
        if (!tail.startsWith(u"&amp;") && !tail.startsWith(u"&lt;") && !tail.startsWith(u"&gt;") &&
            !tail.startsWith(u"&quot;") && !tail.startsWith(u"&#39;"))
            std::abort();
    }
    if (unescape(escaped) != text)
        std::abort();
    return 0;
}
