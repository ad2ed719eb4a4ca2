#include "host/message_box.h"

#include <QMessageBox>
#include <cstdio>

namespace ardcard::host {

QString iconName(MessageIcon icon) {
    return icon == MessageIcon::Critical ? QStringLiteral("critical")
                                         : QStringLiteral("information");
}

void GuiMessageBox::show(const QString& title, const QString& text, MessageIcon icon) {
    QMessageBox box(icon == MessageIcon::Critical ? QMessageBox::Critical
                                                  : QMessageBox::Information,
                    title, text, QMessageBox::Ok);
    box.setLayoutDirection(Qt::RightToLeft);
    box.exec();
}

void MessageRecorder::show(const QString& title, const QString& text, MessageIcon icon) {
    messages_.append({icon, title, text});
    if (echo_) {
        const QByteArray line = (QStringLiteral("message: ") + iconName(icon) +
                                 QStringLiteral(": ") + title + QStringLiteral(": ") + text)
                                    .toUtf8();
        std::fprintf(stderr, "%s\n", line.constData());
        std::fflush(stderr);
    }
}

} // namespace ardcard::host
