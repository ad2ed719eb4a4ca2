// First placing by a hosting page and the card's starting state.

#include "card/card.h"

#include "card/card_screen.h"
#include "common/failure.h"
#include "common/module_state.h"
#include "common/text_helpers.h"
#include "connection/settings_store.h"
#include "host/hosting_page.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <cmath>
#include <functional>

namespace ardcard {

namespace {

// A page value as a 16-bit integer, rounded to the nearest whole number
// (halves to even); nullopt when it does not convert.
std::optional<int> toInt16(const QString& text) {
    bool ok = false;
    const double number = text.trimmed().toDouble(&ok);
    if (!ok || !std::isfinite(number))
        return std::nullopt;
    const double rounded = std::nearbyint(number);
    if (rounded < -32768.0 || rounded > 32767.0)
        return std::nullopt;
    return static_cast<int>(rounded);
}

bool isTrueText(const QString& text) {
    for (const char16_t* yes : {u"1", u"Yes", u"True"}) {
        if (text.compare(QString::fromUtf16(yes), Qt::CaseInsensitive) == 0)
            return true;
    }
    return false;
}

// Runs one step of the placing; a step that fails is skipped.
void step(const std::function<void()>& body) {
    try {
        body();
    } catch (const Failure&) {
        // The page may lack a value or give one that does not fit: go on.
    }
}

} // namespace

void Card::InitProperties(const host::HostingPage& page) {
    ModuleState& state = moduleState();
    CardScreen& ui = *ui_;

    step([&] {
        const QString address = page.address();
        const qsizetype hash = address.indexOf(u'#');
        if (hash < 0)
            return;
        const QString dirs = address.mid(hash + 1);
        if (dirs.isEmpty())
            return;
        ui.txtCompPath->setText(dirs);
        state.CompanyDirText = ui.txtCompPath->text();
    });

    step([&] {
        const QString v = page.value(QStringLiteral("AServer"));
        if (!v.isEmpty())
            state.conn.ConnServer = v;
    });
    step([&] {
        const QString v = page.value(QStringLiteral("AUID"));
        if (!v.isEmpty())
            state.conn.ConnUID = v;
    });
    step([&] {
        const QString v = page.value(QStringLiteral("APWD"));
        if (!v.isEmpty())
            state.conn.ConnPWD = v;
    });
    step([&] {
        const QString v = page.value(QStringLiteral("AConnType"));
        if (v.isEmpty())
            return;
        if (const std::optional<int> type = toInt16(v))
            state.conn.ConnType = *type;
    });
    step([&] {
        const QString v = page.value(QStringLiteral("ADatabase"));
        if (v.isEmpty())
            return;
        ui.txtCompPath->setText(v);
        state.CompanyDirText = ui.txtCompPath->text();
        state.conn.ConnDataBase = state.CompanyDirText;
    });

    QString account;
    step([&] {
        account = page.value(QStringLiteral("AAccount"));
        if (!account.isEmpty())
            ui.txtAccountKey->setText(StripQuotes(account));
    });
    step([&] {
        if (isTrueText(page.value(QStringLiteral("AOnlyOpen"))))
            ui.ChkOnlyOpenTrans->setChecked(true);
    });

    step([&] { InitCard(); });

    step([&] {
        const ConnValues c = state.conn;
        if (!c.ConnServer.isEmpty() && !account.isEmpty())
            ShowAccount(c.ConnServer, c.ConnUID, c.ConnPWD, c.ConnType, c.ConnDataBase, account);
    });
}

void Card::InitCard() {
    ModuleState& state = moduleState();
    state.CompanyDirText = state.conn.ConnDataBase;
    PubSearchBy.clear();
    PubSearchValue = QString();
    state.CompanyDirCount = SplitCompanyDirs(state.CompanyDirText, state.CompanyDirList);
    readFirstCompanyDetails();
    InitDocLines();
    ui_->CmbGraphType->setCurrentIndex(1);
    ui_->CmbGraphDate->setCurrentIndex(0);
    SetGetRegParams(RegLoad, kRegApp, kRegSection);
}

} // namespace ardcard
