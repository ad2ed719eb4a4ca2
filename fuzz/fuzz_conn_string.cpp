// The connection-string builder and the mapping of connection strings onto
// drivers: any values, any type, never a crash; only Failure may be thrown.
#include "common/failure.h"
#include "connection/conn_string.h"
#include "connection/driver_target.h"

#include <cstdlib>

using namespace ardcard;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    if (size < 1)
        return 0;
    const int type = static_cast<int8_t>(data[0]);
    const QString rest = QString::fromUtf8(reinterpret_cast<const char*>(data + 1),
                                           static_cast<qsizetype>(size - 1));
    QStringList fields = rest.split(QChar(0x1F)); // unit separator between the values
    while (fields.size() < 4)
        fields.append(QString());

    const QString built = BuildConnString(fields[0], fields[1], fields[2], fields[3], type);
    if ((type < 1 || type > 6) != built.isEmpty())
        std::abort();

    for (const QString& s : {built, rest}) {
        try {
            const DriverTarget t = MapConnString(s, 2);
            if (t.driver != QStringLiteral("QSQLITE") && t.driver != QStringLiteral("QODBC"))
                std::abort();
        } catch (const Failure& f) {
            if (f.description().isEmpty())
                std::abort();
        }
    }
    return 0;
}
