// The account's information page, opened by a double click on the key image.

#include "card/card.h"

#include "card/card_screen.h"
#include "common/failure.h"
#include "common/module_state.h"
#include "connection/conn_string.h"
#include "info/ard7info.h"

#include <QLineEdit>

namespace ardcard {

// Like the other image commands, a failure here is passed over: the page
// shows its own failures, and nothing else of the card depends on it.
void Card::imgAccKey_DblClick() {
    try {
        const QString key = ui_->txtAccountKey->text().trimmed();
        if (key.isEmpty())
            return;
        const ConnValues& conn = moduleState().conn;
        const QString connStr = BuildConnString(conn.ConnServer, conn.ConnUID, conn.ConnPWD,
                                                conn.ConnDataBase, conn.ConnType);
        Ard7Info info;
        info.OpenAccountHTML(key, connStr, conn.ConnType);
    } catch (const Failure&) {
    }
}

} // namespace ardcard
