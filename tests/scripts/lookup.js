// The account the page named, as the card shows it after first placing.
print("key:", ui.text("txtAccountKey"));
print("name:", ui.text("txtAccountName"));
print("phone:", ui.text("txtTelephone"));
print("city:", ui.text("txtCity"));
print("location:", card.PubACTLocation);
print("rows:", ui.rowCount(), "columns:", ui.colCount());
print("header:", ui.cell(0, 0));
const c = conn.values();
print("conn:", c.ConnType, c.ConnDataBase);
print("messages:", ui.messages().length);
