#include "ui_driver.h"

#include "common/failure.h"
#include "host/message_box.h"
#include "host/page_window.h"
#include "ledger/ledger_model.h"

#include <QAbstractButton>
#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QFocusEvent>
#include <QHeaderView>
#include <QJSEngine>
#include <QLabel>
#include <QLineEdit>
#include <QMouseEvent>
#include <QTableView>

namespace ardcard::app {

void sendClick(QWidget* widget, QPoint pos, bool doubleClick) {
    const QPointF local(pos);
    const QPointF global(widget->mapToGlobal(pos));
    auto send = [&](QEvent::Type type, Qt::MouseButtons buttons) {
        QMouseEvent event(type, local, global, Qt::LeftButton, buttons, Qt::NoModifier);
        QApplication::sendEvent(widget, &event);
    };
    send(QEvent::MouseButtonPress, Qt::LeftButton);
    send(QEvent::MouseButtonRelease, Qt::NoButton);
    if (doubleClick) {
        send(QEvent::MouseButtonDblClick, Qt::LeftButton);
        send(QEvent::MouseButtonRelease, Qt::NoButton);
    }
}

UiDriver::UiDriver(QWidget* root, const LedgerModel* ledger, host::MessageRecorder* messages,
                   host::PageWindowRecorder* windows, QObject* parent)
    : QObject(parent), root_(root), ledger_(ledger), messages_(messages), windows_(windows) {}

void UiDriver::fail(const QString& text) {
    // Called from a script: the error goes back into it; called from C++
    // (no engine), it is a Failure.
    if (QJSEngine* engine = qjsEngine(this))
        engine->throwError(QJSValue::TypeError, text);
    else
        throw Failure(text);
}

QWidget* UiDriver::find(const QString& name) {
    QWidget* widget = root_ ? root_->findChild<QWidget*>(name) : nullptr;
    if (!widget && root_ && root_->objectName() == name)
        widget = root_;
    if (!widget)
        fail(QStringLiteral("no control named %1").arg(name));
    return widget;
}

template <class T> T* UiDriver::findAs(const QString& name, const char* kind) {
    QWidget* widget = find(name);
    if (!widget)
        return nullptr;
    T* typed = qobject_cast<T*>(widget);
    if (!typed)
        fail(QStringLiteral("%1 is not a %2").arg(name, QString::fromLatin1(kind)));
    return typed;
}

void UiDriver::click(const QString& name) {
    QWidget* widget = find(name);
    if (!widget)
        return;
    try {
        if (auto* button = qobject_cast<QAbstractButton*>(widget))
            button->click(); // does nothing while the button is disabled
        else if (widget->isEnabled())
            sendClick(widget, widget->rect().center(), false);
    } catch (const Failure& f) {
        fail(f.description());
    }
}

void UiDriver::dblclick(const QString& name) {
    QWidget* widget = find(name);
    if (!widget || !widget->isEnabled())
        return;
    try {
        sendClick(widget, widget->rect().center(), true);
    } catch (const Failure& f) {
        fail(f.description());
    }
}

void UiDriver::setText(const QString& name, const QString& text) {
    if (auto* edit = findAs<QLineEdit>(name, "text box")) {
        try {
            edit->setText(text); // textChanged: the change handlers run
        } catch (const Failure& f) {
            fail(f.description());
        }
    }
}

QString UiDriver::text(const QString& name) {
    QWidget* widget = find(name);
    if (auto* edit = qobject_cast<QLineEdit*>(widget))
        return edit->text();
    if (auto* label = qobject_cast<QLabel*>(widget))
        return label->text();
    if (auto* button = qobject_cast<QAbstractButton*>(widget))
        return button->text();
    if (auto* combo = qobject_cast<QComboBox*>(widget))
        return combo->currentText();
    if (widget)
        fail(QStringLiteral("%1 has no text").arg(name));
    return {};
}

void UiDriver::setValue(const QString& name, int value) {
    if (auto* box = findAs<QCheckBox>(name, "check box"))
        box->setChecked(value != 0);
}

int UiDriver::value(const QString& name) {
    auto* box = findAs<QCheckBox>(name, "check box");
    return box && box->isChecked() ? 1 : 0;
}

void UiDriver::setIndex(const QString& name, int index) {
    if (auto* combo = findAs<QComboBox>(name, "combo box"))
        combo->setCurrentIndex(index);
}

int UiDriver::index(const QString& name) {
    auto* combo = findAs<QComboBox>(name, "combo box");
    return combo ? combo->currentIndex() : -1;
}

bool UiDriver::enabled(const QString& name) {
    QWidget* widget = find(name);
    return widget && widget->isEnabled();
}

void UiDriver::focusOut(const QString& name) {
    if (QWidget* widget = find(name)) {
        QFocusEvent event(QEvent::FocusOut, Qt::OtherFocusReason);
        QApplication::sendEvent(widget, &event);
    }
}

const LedgerModel* UiDriver::ledger() {
    if (!ledger_)
        fail(QStringLiteral("there is no grid"));
    return ledger_;
}

int UiDriver::rowCount() {
    const LedgerModel* model = ledger();
    return model ? model->gridRowCount() : 0;
}

int UiDriver::colCount() {
    return ledger() ? LedgerModel::kColumns : 0;
}

QString UiDriver::cell(int row, int column) {
    const LedgerModel* model = ledger();
    if (!model)
        return {};
    if (row < 0 || row >= model->gridRowCount() || column < 0 || column >= LedgerModel::kColumns) {
        fail(QStringLiteral("no cell %1, %2 in the grid").arg(row).arg(column));
        return {};
    }
    return model->cellText(row, column);
}

void UiDriver::clickGrid(int row, int column) {
    auto* view = findAs<QTableView>(QStringLiteral("DocLines"), "grid");
    if (!view || !view->model())
        return;
    QAbstractItemModel* model = view->model();
    if (row < 0 || row > model->rowCount() || column < 0 || column >= model->columnCount()) {
        fail(QStringLiteral("no cell %1, %2 in the grid").arg(row).arg(column));
        return;
    }
    try {
        if (row == 0) {
            QHeaderView* header = view->horizontalHeader();
            view->scrollTo(model->index(0, column));
            const int x = header->sectionViewportPosition(column) + header->sectionSize(column) / 2;
            sendClick(header->viewport(), QPoint(x, header->height() / 2), false);
        } else {
            const QModelIndex index = model->index(row - 1, column);
            view->scrollTo(index);
            sendClick(view->viewport(), view->visualRect(index).center(), false);
        }
    } catch (const Failure& f) {
        fail(f.description());
    }
}

QVariantList UiDriver::messages() const {
    QVariantList out;
    if (!messages_)
        return out;
    for (const host::Message& m : messages_->messages())
        out.append(QVariantMap{{QStringLiteral("icon"), host::iconName(m.icon)},
                               {QStringLiteral("title"), m.title},
                               {QStringLiteral("text"), m.text}});
    return out;
}

void UiDriver::clearMessages() {
    if (messages_)
        messages_->clear();
}

QVariantList UiDriver::windows() const {
    QVariantList out;
    if (!windows_)
        return out;
    for (const QStringList& paths : windows_->windows())
        out.append(QVariant(paths));
    return out;
}

} // namespace ardcard::app
