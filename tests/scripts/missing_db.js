// A company file that does not exist: the lookup reports it in a message box.
card.ShowAccount(conn.values().ConnServer, "", "", 4, "missing.db", "1001");
const m = ui.messages();
print("messages:", m.length, m.length ? m[0].icon : "", m.length ? m[0].title : "");
ui.clearMessages();
print("after clear:", ui.messages().length);
