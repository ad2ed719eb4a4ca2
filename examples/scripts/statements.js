// Writes a printable statement for each account of a list, one file per
// account in the current directory: statement-<key>.htm. For the demo
// company:
//
//   ardcard --headless --demo --script examples/scripts/statements.js
//
// With a company of your own, name it on the command line the way a hosting
// page would (--set AServer=... --set AConnType=... --set ADatabase=...) and
// change the list below.

const accounts = ["10001", "10002", "10006", "99999"];

// The connection values the card was placed with.
const c = conn.values();

for (const key of accounts) {
    // Shows the account and fetches its journal lines from every company
    // directory, exactly as the clerk's search and fetch button would.
    card.ShowAccount(c.ConnServer, c.ConnUID, c.ConnPWD, c.ConnType, c.ConnDataBase, key);
    if (ui.text("txtAccountKey") === "") {
        print(key + ": no such account");
        continue;
    }
    const file = "statement-" + key + ".htm";
    card.CreateHTML(file);
    // The grid's first row is its header and its last row is always blank.
    print(key + " " + ui.text("txtAccountName") + ": " + (ui.rowCount() - 2) + " lines -> " + file);
}

// Whatever the card would have shown in a message box.
for (const m of ui.messages())
    print("message: " + m.title + ": " + m.text);
