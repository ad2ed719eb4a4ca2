// The clerk searches by part of a name, then by key, fetches the account's
// lines, sorts them by transaction number with a click on that header, and
// prints the statement.
ui.setText("txtCompPath", "fixture.db");
ui.focusOut("txtCompPath");
ui.setText("txtAccountName", "גליל");
ui.dblclick("Label2");
print("found:", ui.text("txtAccountKey"), card.PubSearchBy);
ui.setText("txtAccountKey", "1001");
ui.dblclick("Label1");
ui.click("ShowTransButt");
print("rows:", ui.rowCount(), "print enabled:", ui.enabled("PrintButt"));
ui.clickGrid(0, 3);
const sorted = [];
for (let r = 1; r < ui.rowCount() - 1; ++r)
    sorted.push(ui.cell(r, 3) + "=" + ui.cell(r, 8));
print("by transaction:", sorted.join(" "));
ui.clickGrid(0, 1); // dates do not sort
print("still:", ui.cell(1, 3), ui.cell(2, 3), ui.cell(3, 3));
ui.click("PrintButt");
print("windows:", ui.windows().length, ui.windows()[0].length);
