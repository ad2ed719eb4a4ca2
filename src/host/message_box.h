#pragma once

#include <QList>
#include <QString>

namespace ardcard::host {

enum class MessageIcon { Critical, Information };

struct Message {
    MessageIcon icon;
    QString title;
    QString text;
};

QString iconName(MessageIcon icon); // "critical", "information"

// The platform's message box: title, text, icon. Shown modally by the GUI,
// recorded by headless runs and tests.
class MessageBoxSeam {
public:
    virtual ~MessageBoxSeam() = default;
    virtual void show(const QString& title, const QString& text, MessageIcon icon) = 0;
};

// A modal QMessageBox, laid out right to left.
class GuiMessageBox final : public MessageBoxSeam {
public:
    void show(const QString& title, const QString& text, MessageIcon icon) override;
};

// Keeps every message in order; with echo on, also prints each as one line
// "message: <icon>: <title>: <text>" to stderr.
class MessageRecorder final : public MessageBoxSeam {
public:
    explicit MessageRecorder(bool echo = false) : echo_(echo) {}
    void show(const QString& title, const QString& text, MessageIcon icon) override;
    const QList<Message>& messages() const { return messages_; }
    void clear() { messages_.clear(); }

private:
    QList<Message> messages_;
    bool echo_;
};

} // namespace ardcard::host
