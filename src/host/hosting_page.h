#pragma once

#include <QMap>
#include <QString>

namespace ardcard::host {

// What the page that places a card gives it: its address and the values of
// named elements ("AServer", "AUID", ...). A missing name reads as empty.
class HostingPage {
public:
    virtual ~HostingPage() = default;
    virtual QString address() const = 0;
    virtual QString value(const QString& name) const = 0;
};

class FixedHostingPage final : public HostingPage {
public:
    FixedHostingPage() = default;
    FixedHostingPage(QString address, QMap<QString, QString> values)
        : address_(std::move(address)), values_(std::move(values)) {}
    QString address() const override { return address_; }
    QString value(const QString& name) const override { return values_.value(name); }
    void setAddress(const QString& address) { address_ = address; }
    void setValue(const QString& name, const QString& value) { values_.insert(name, value); }

private:
    QString address_;
    QMap<QString, QString> values_;
};

} // namespace ardcard::host
