#pragma once

#include <QString>

namespace ardcard::reports {

// What the outputs take from the card's screen, copied by the card when a
// command runs so that no writer reaches back into a widget.
struct ReportScreen {
    QString accountKey;           // txtAccountKey
    QString accountName;          // txtAccountName
    QString address;              // txtAddress
    QString telephone;            // txtTelephone
    QString details;              // txtDetails
    QString balance;              // txtBalance
    QString shipBalance;          // txtShipBalance
    QString oblig;                // txtOblig
    bool showHeadDetails = false; // chkShowHeadDetails: balances and contact rows in the heading
    bool negdiName = false;       // chkNegdiName: the CSV rows carry the counter-account name
    int graphKind = 1;            // CmbGraphType list position: 0 week, 1 month, 2 quarter
};

} // namespace ardcard::reports
