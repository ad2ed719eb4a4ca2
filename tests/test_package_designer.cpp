// The Qt Designer plugin as Designer uses it: loaded by QPluginLoader from
// the built module, asked for its description, and made to create a card.

#include <QLabel>
#include <QLineEdit>
#include <QMetaProperty>
#include <QPluginLoader>
#include <QTest>
#include <QtUiPlugin/QDesignerCustomWidgetInterface>
#include <memory>

class TestPackageDesigner : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void description_data();
    void description();
    void domXml_namesTheClassAndItsHeader();
    void createWidget_makesACard();
    void cleanupTestCase();

private:
    QPluginLoader loader_{QStringLiteral(ARDCARD_DESIGNER_PLUGIN)};
    QDesignerCustomWidgetInterface* plugin_ = nullptr;
};

void TestPackageDesigner::initTestCase() {
    QVERIFY2(loader_.load(), qPrintable(loader_.errorString()));
    QCOMPARE(loader_.metaData().value(QStringLiteral("IID")).toString(),
             QStringLiteral("org.qt-project.Qt.QDesignerCustomWidgetInterface"));
    plugin_ = qobject_cast<QDesignerCustomWidgetInterface*>(loader_.instance());
    QVERIFY(plugin_ != nullptr);
    QVERIFY(!plugin_->isInitialized());
    plugin_->initialize(nullptr);
    QVERIFY(plugin_->isInitialized());
}

void TestPackageDesigner::description_data() {
    QTest::addColumn<QString>("actual");
    QTest::addColumn<QString>("expected");
    QTest::newRow("name") << plugin_->name() << "ardcard::Card";
    QTest::newRow("group") << plugin_->group() << "ardcard";
    QTest::newRow("include file") << plugin_->includeFile() << "ardcard/card.h";
    QTest::newRow("tool tip") << plugin_->toolTip() << "כרטסת חשבון";
    QTest::newRow("container") << QString::number(plugin_->isContainer()) << "0";
}

void TestPackageDesigner::description() {
    QFETCH(QString, actual);
    QFETCH(QString, expected);
    QCOMPARE(actual, expected);
}

void TestPackageDesigner::domXml_namesTheClassAndItsHeader() {
    const QString xml = plugin_->domXml();
    QVERIFY(xml.contains(QStringLiteral("<widget class=\"ardcard::Card\" name=\"card\"/>")));
    QVERIFY(xml.contains(QStringLiteral("<header location=\"global\">ardcard/card.h</header>")));
}

void TestPackageDesigner::createWidget_makesACard() {
    QWidget parent;
    QWidget* card = plugin_->createWidget(&parent);
    QVERIFY(card != nullptr);
    QCOMPARE(card->parentWidget(), &parent);
    QCOMPARE(QString::fromLatin1(card->metaObject()->className()), QStringLiteral("ardcard::Card"));
    // The members a container script reaches are there under their own names.
    for (const char* property :
         {"SetAccountKey", "SetCompDir", "ACTLocation", "PubACTLocation", "PubSearchBy"})
        QVERIFY2(card->metaObject()->indexOfProperty(property) >= 0, property);
    QVERIFY(card->metaObject()->indexOfMethod(
                "ShowAccount(QString,QString,QString,int,QString,QString)") >= 0);
    // Its screen is the card's own: the key box, empty until an account is
    // shown, and the fixed version caption.
    auto* key = card->findChild<QLineEdit*>(QStringLiteral("txtAccountKey"));
    QVERIFY(key != nullptr);
    QCOMPARE(key->text(), QString());
    auto* caption = card->findChild<QLabel*>(QStringLiteral("Label22"));
    QVERIFY(caption != nullptr);
    QCOMPARE(caption->text(), QStringLiteral("גירסה 5.0518"));
}

void TestPackageDesigner::cleanupTestCase() {
    // The plugin's library stays loaded: Qt keeps plugin instances until exit.
}

QTEST_MAIN(TestPackageDesigner)
#include "test_package_designer.moc"
