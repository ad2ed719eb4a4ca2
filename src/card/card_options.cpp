// The card's options in the settings store.

#include "card/card.h"

#include "card/card_screen.h"
#include "common/failure.h"
#include "common/module_state.h"
#include "connection/settings_keys.h"
#include "connection/settings_store.h"
#include "host/seams.h"

#include <QCheckBox>
#include <QLineEdit>

namespace ardcard {

std::optional<QString> Card::saveOrLoadOptions(int action, const QString& app,
                                               const QString& section) {
    ModuleState& state = moduleState();
    std::optional<QString> firstFailure;
    const auto step = [&](const auto& body) {
        try {
            body();
        } catch (const Failure& failure) {
            if (!firstFailure)
                firstFailure = failure.description();
        } catch (const std::exception& failure) {
            if (!firstFailure)
                firstFailure = QString::fromUtf8(failure.what());
        }
    };
    const auto control = [&](const keys::Key& key, QObject* widget, int kind) {
        step([&] {
            SetGetRegControl(action, app, section, keys::name(key), widget, kind,
                             keys::fallback(key));
        });
    };

    control(keys::CompanyDir, ui_->txtCompPath, RegText);
    state.CompanyDirText = ui_->txtCompPath->text();
    control(keys::OnlyOpenTrans, ui_->ChkOnlyOpenTrans, RegValue);
    control(keys::ReadNegdiName, ui_->chkNegdiName, RegValue);
    control(keys::ShowHeadDetails, ui_->chkShowHeadDetails, RegValue);

    if (action == RegSave) {
        step([&] { SaveSetting(app, section, keys::name(keys::MainDrive), state.MainDrive); });
        step([&] { SaveSetting(app, section, keys::name(keys::MainDir), state.MainDir); });
    } else if (action == RegLoad) {
        state.MainDrive =
            ReadSetting(app, section, keys::name(keys::MainDrive), keys::fallback(keys::MainDrive));
        state.MainDir =
            ReadSetting(app, section, keys::name(keys::MainDir), keys::fallback(keys::MainDir));
    }
    return firstFailure;
}

void Card::SetGetRegParams(int Action, const QString& RegApp, const QString& RegSection) {
    // Options are a convenience: a store that cannot be read or written
    // leaves the controls as they are.
    saveOrLoadOptions(Action, RegApp, RegSection);
}

void Card::cmdSave_Click() {
    // Every option is still tried; the clerk learns that the save failed.
    if (const std::optional<QString> failure = saveOrLoadOptions(RegSave, kRegApp, kRegSection))
        host::messageBox().show(QStringLiteral("תקלה"), *failure, host::MessageIcon::Critical);
}

} // namespace ardcard
