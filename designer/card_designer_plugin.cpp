#include "card_designer_plugin.h"

#include <ardcard/card.h>

#include <QIcon>

namespace ardcard::designer {

CardDesignerPlugin::CardDesignerPlugin(QObject* parent) : QObject(parent) {}

QString CardDesignerPlugin::name() const {
    return QStringLiteral("ardcard::Card");
}

QString CardDesignerPlugin::group() const {
    return QStringLiteral("ardcard");
}

QString CardDesignerPlugin::toolTip() const {
    return QStringLiteral("כרטסת חשבון");
}

QString CardDesignerPlugin::whatsThis() const {
    return QStringLiteral("The account card: one account of an Ardeco company, its journal "
                          "lines, statement, spreadsheet export and graph.");
}

QString CardDesignerPlugin::includeFile() const {
    return QStringLiteral("ardcard/card.h");
}

QIcon CardDesignerPlugin::icon() const {
    return QIcon::fromTheme(QStringLiteral("ardcard"));
}

bool CardDesignerPlugin::isContainer() const {
    return false;
}

// The card made on a form in Designer is an ordinary card: it loads the
// stored connection values and shows no account until a container places it.
QWidget* CardDesignerPlugin::createWidget(QWidget* parent) {
    return new Card(parent);
}

bool CardDesignerPlugin::isInitialized() const {
    return initialized_;
}

void CardDesignerPlugin::initialize(QDesignerFormEditorInterface*) {
    initialized_ = true;
}

QString CardDesignerPlugin::domXml() const {
    return QStringLiteral("<ui language=\"c++\">\n"
                          " <widget class=\"ardcard::Card\" name=\"card\"/>\n"
                          " <customwidgets>\n"
                          "  <customwidget>\n"
                          "   <class>ardcard::Card</class>\n"
                          "   <header location=\"global\">ardcard/card.h</header>\n"
                          "  </customwidget>\n"
                          " </customwidgets>\n"
                          "</ui>\n");
}

} // namespace ardcard::designer
