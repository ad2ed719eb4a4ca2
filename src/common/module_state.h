#pragma once

#include "common/period_totals.h"

#include <QString>
#include <QStringList>
#include <array>

namespace ardcard {

// The five connection values; every database operation builds its
// connection string from them afresh.
struct ConnValues {
    QString ConnServer;
    QString ConnUID;
    QString ConnPWD;
    QString ConnDataBase;
    int ConnType = 0; // 1..6; anything else builds no connection string
};

// The company's definitions row; a later read keeps a value it finds empty.
struct CompanyDetails {
    QString CompanyName;
    QString ShortName;
    QString VatNum;
    QString DeductNum;
    QString HiddenAccountsFilter;
};

inline constexpr int kCurrencyCount = 22; // the host product's currency ids 1..22

// Values shared by every card, connection dialog and information page on one
// user-interface thread: the last writer wins, as two cards on one page expect.
struct ModuleState {
    QString CompanyDirText;
    QStringList CompanyDirList{QString()}; // entry 0 exists and stays empty
    int CompanyDirCount = 0;
    QString MainDrive;
    QString MainDir;

    ConnValues conn;
    CompanyDetails company;
    QString CurrentAccountFilter; // Filter of the account read last

    // Ledger totals of the last fetch, indexed 1..22 by currency id.
    std::array<QString, kCurrencyCount + 1> CurrencyCodes;
    std::array<double, kCurrencyCount + 1> CurrencyTotals{};
    PeriodTotals periods;

    bool StopFlag = false;
};

// The state of the calling thread; created on first use.
ModuleState& moduleState();

// Entry i of CompanyDirList, or an empty text when the list has no such entry.
QString companyDir(const ModuleState& state, int index);

} // namespace ardcard
