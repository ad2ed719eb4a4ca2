// The company-directory splitter and the quote stripper on any text.
#include "common/text_helpers.h"

#include <cstdlib>

using namespace ardcard;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const QString text =
        QString::fromUtf8(reinterpret_cast<const char*>(data), static_cast<qsizetype>(size));

    QStringList list{QString(), QStringLiteral("before")};
    const int count = SplitCompanyDirs(text, list);
    if (count == 0) {
        if (list.size() != 2 || list.at(1) != QStringLiteral("before"))
            std::abort(); // a text without entries must leave the list alone
    } else {
        if (list.size() != count + 1 || !list.at(0).isEmpty())
            std::abort();
        qsizetype chars = 0;
        for (int i = 1; i <= count; ++i) {
            const QString& entry = list.at(i);
            if (entry.isEmpty() || entry.contains(u';') || entry.contains(u','))
                std::abort();
            chars += entry.size();
        }
        if (chars != text.size() - text.count(u';') - text.count(u','))
            std::abort(); // nothing but separators is dropped
    }

    const QString stripped = StripQuotes(text);
    if (stripped.contains(u'"') || stripped.contains(u'\'') || stripped.contains(u','))
        std::abort();
    if (stripped.size() != text.size() - text.count(u'"') - text.count(u'\'') - text.count(u','))
        std::abort();
    return 0;
}
