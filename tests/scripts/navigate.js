// The clerk types the company file, leaves the box and steps with the
// navigation buttons.
ui.setText("txtCompPath", "fixture.db");
ui.focusOut("txtCompPath");
ui.click("LastButt");
print("last:", ui.text("txtAccountKey"), ui.text("txtAccountName"));
ui.click("FirstButt");
print("first:", ui.text("txtAccountKey"), ui.text("txtAccountName"));
ui.click("NextButt");
print("next:", ui.text("txtAccountKey"));
print("print enabled:", ui.enabled("PrintButt"));
card.SetAccountKey = "'10,02'";
print("typed key:", card.SetAccountKey);
try {
    card.SetAccountKey = null;
} catch (e) {
    print("caught:", e.message);
}
