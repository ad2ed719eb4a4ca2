#pragma once

#include <QJSValue>
#include <QObject>
#include <QPointer>
#include <QString>
#include <QVariantList>

namespace ardcard {
class LedgerModel;
namespace host {
class MessageRecorder;
class PageWindowRecorder;
} // namespace host
} // namespace ardcard

namespace ardcard::app {

// The user's hands on a widget's controls, for a script: controls are found
// by object name under the root, and every action goes through what a user
// would cause (a button's click, mouse events on labels and pictures, a
// focus-out event), so the widget's own handlers run as they do on screen.
// A name that matches no control, or a control of the wrong kind, fails the
// script with a plain error.
class UiDriver : public QObject {
    Q_OBJECT
public:
    // `ledger` is the grid's model as the rest of the system numbers it; the
    // recorders hold what the user saw (either may be null: nothing seen).
    UiDriver(QWidget* root, const LedgerModel* ledger, host::MessageRecorder* messages,
             host::PageWindowRecorder* windows, QObject* parent = nullptr);

    Q_INVOKABLE void click(const QString& name);
    Q_INVOKABLE void dblclick(const QString& name);
    Q_INVOKABLE void setText(const QString& name, const QString& text);
    Q_INVOKABLE QString text(const QString& name);
    Q_INVOKABLE void setValue(const QString& name, int value);
    Q_INVOKABLE int value(const QString& name);
    Q_INVOKABLE void setIndex(const QString& name, int index);
    Q_INVOKABLE int index(const QString& name);
    Q_INVOKABLE bool enabled(const QString& name);
    Q_INVOKABLE void focusOut(const QString& name);

    // The ledger grid: row 0 is the header row, the blank row is last.
    Q_INVOKABLE int rowCount();
    Q_INVOKABLE int colCount();
    Q_INVOKABLE QString cell(int row, int column);
    Q_INVOKABLE void clickGrid(int row, int column);

    // [{icon, title, text}, ...] in order; icon "critical" or "information".
    Q_INVOKABLE QVariantList messages() const;
    Q_INVOKABLE void clearMessages();
    // One entry per page window, each the paths it navigated to, in order.
    Q_INVOKABLE QVariantList windows() const;

private:
    QWidget* find(const QString& name);
    template <class T> T* findAs(const QString& name, const char* kind);
    void fail(const QString& text);
    const LedgerModel* ledger();

    QPointer<QWidget> root_;
    const LedgerModel* ledger_;
    host::MessageRecorder* messages_;
    host::PageWindowRecorder* windows_;
};

// Delivers a left-button click (press and release) or double click (press,
// release, double click, release) at `pos` in the widget.
void sendClick(QWidget* widget, QPoint pos, bool doubleClick);

} // namespace ardcard::app
