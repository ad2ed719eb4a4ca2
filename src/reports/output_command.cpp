#include "reports/output_command.h"

#include "common/failure.h"
#include "host/seams.h"

namespace ardcard::reports {

namespace {
void reportFailure(const QString& description) {
    host::messageBox().show(QStringLiteral("תקלה"), description, host::MessageIcon::Critical);
}
} // namespace

bool RunOutputCommand(const std::function<void()>& write, const QString& pagePath) {
    try {
        write();
        host::showPage(host::pageWindows(), pagePath);
        return true;
    } catch (const Failure& failure) {
        reportFailure(failure.description());
    } catch (const std::exception& failure) {
        reportFailure(QString::fromLocal8Bit(failure.what()));
    }
    return false;
}

void ReportNothingToDraw() {
    host::messageBox().show(QStringLiteral("גרף"), QStringLiteral("אין נתונים להצגה בגרף"),
                            host::MessageIcon::Information);
}

} // namespace ardcard::reports
