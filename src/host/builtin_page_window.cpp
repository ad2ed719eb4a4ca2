#include "host/builtin_page_window.h"

#include "common/failure.h"

namespace ardcard::host {

PageWindow* BuiltInPageWindowFactory::create() {
    throw Failure(QStringLiteral("חלון הדפים המובנה עדיין אינו זמין"));
}

} // namespace ardcard::host
