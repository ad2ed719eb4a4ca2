// The library as another program uses it: the build installed into a
// temporary prefix, examples/embed configured and built against that prefix
// alone, and run headless with two cards on the demo companies.

#include <QDir>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>
#include <QTest>

namespace {

struct Run {
    int code = -1;
    QString out;
    QString err;
};

Run runProgram(const QString& program, const QStringList& args,
               const QProcessEnvironment& env = QProcessEnvironment::systemEnvironment()) {
    QProcess process;
    process.setProcessEnvironment(env);
    process.start(program, args);
    Run run;
    if (!process.waitForFinished(-1)) {
        run.err = process.errorString();
        return run;
    }
    run.code = process.exitStatus() == QProcess::NormalExit ? process.exitCode() : -1;
    run.out = QString::fromUtf8(process.readAllStandardOutput());
    run.err = QString::fromUtf8(process.readAllStandardError());
    return run;
}

} // namespace

class TestEmbed : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void installed_data();
    void installed();
    void consumer_seesOnlyTheInstalledHeaders();
    void twoCards_lastWriterOfTheDirectoriesDecides();

private:
    QString prefix() const { return dir_.filePath(QStringLiteral("prefix")); }
    QString embedBuild() const { return dir_.filePath(QStringLiteral("embed")); }

    QTemporaryDir dir_;
};

void TestEmbed::initTestCase() {
    QVERIFY(dir_.isValid());
    const QString cmake = QStringLiteral(ARDCARD_CMAKE);
    Run run = runProgram(cmake, {QStringLiteral("--install"), QStringLiteral(ARDCARD_BUILD_DIR),
                                 QStringLiteral("--prefix"), prefix()});
    QVERIFY2(run.code == 0, qPrintable(run.err));

    QStringList configure{QStringLiteral("-S"),
                          QStringLiteral(ARDCARD_EMBED_SOURCE),
                          QStringLiteral("-B"),
                          embedBuild(),
                          QStringLiteral("-G"),
                          QStringLiteral(ARDCARD_GENERATOR),
                          QStringLiteral("-DCMAKE_PREFIX_PATH=") + prefix(),
                          QStringLiteral("-DCMAKE_BUILD_TYPE=Release"),
                          QStringLiteral("-DCMAKE_EXPORT_COMPILE_COMMANDS=ON")};
    const QString flags = QStringLiteral(ARDCARD_CONSUMER_FLAGS);
    if (!flags.isEmpty())
        configure << QStringLiteral("-DCMAKE_CXX_FLAGS=") + flags
                  << QStringLiteral("-DCMAKE_EXE_LINKER_FLAGS=") + flags;
    run = runProgram(cmake, configure);
    QVERIFY2(run.code == 0, qPrintable(run.out + run.err));
    run = runProgram(cmake, {QStringLiteral("--build"), embedBuild()});
    QVERIFY2(run.code == 0, qPrintable(run.out + run.err));
}

void TestEmbed::installed_data() {
    QTest::addColumn<QString>("path");
    QTest::addColumn<bool>("present");
    QTest::newRow("library") << "lib/libardcard.so.7" << true;
    QTest::newRow("card header") << "include/ardcard/card.h" << true;
    QTest::newRow("dialog header") << "include/ardcard/conn_dialog.h" << true;
    QTest::newRow("hosting page") << "include/ardcard/hosting_page.h" << true;
    QTest::newRow("failure") << "include/ardcard/failure.h" << true;
    QTest::newRow("web engine") << "include/ardcard/prepare_web_engine.h" << true;
    QTest::newRow("version") << "include/ardcard/version.h" << true;
    QTest::newRow("package config") << "lib/cmake/ardcard/ardcardConfig.cmake" << true;
    QTest::newRow("package version") << "lib/cmake/ardcard/ardcardConfigVersion.cmake" << true;
    QTest::newRow("host application") << "bin/ardcard" << true;
    QTest::newRow("demo builder") << "bin/ardcard-demo" << true;
    QTest::newRow("man page") << "share/man/man1/ardcard.1.gz" << true;
    QTest::newRow("desktop entry") << "share/applications/ardcard.desktop" << true;
    QTest::newRow("icon") << "share/icons/hicolor/scalable/apps/ardcard.svg" << true;
    QTest::newRow("designer plugin") << ARDCARD_DESIGNER_DIR "/libardcard_designer.so" << true;
    QTest::newRow("information pages stay inside") << "include/ardcard/ard7info.h" << false;
    QTest::newRow("screen stays inside") << "include/ardcard/card_screen.h" << false;
    QTest::newRow("no folder headers") << "include/card/card.h" << false;
}

void TestEmbed::installed() {
    QFETCH(QString, path);
    QFETCH(bool, present);
    QCOMPARE(QFile::exists(QDir(prefix()).filePath(path)), present);
}

void TestEmbed::consumer_seesOnlyTheInstalledHeaders() {
    QFile commands(QDir(embedBuild()).filePath(QStringLiteral("compile_commands.json")));
    QVERIFY(commands.open(QIODevice::ReadOnly));
    const QString text = QString::fromUtf8(commands.readAll());
    QVERIFY(text.contains(QStringLiteral("-isystem ") + prefix() + QStringLiteral("/include")));
    QVERIFY2(!text.contains(QStringLiteral(ARDCARD_SOURCE_DIR "/src")), qPrintable(text));
    QVERIFY2(!text.contains(QStringLiteral(ARDCARD_BUILD_DIR)), qPrintable(text));
}

void TestEmbed::twoCards_lastWriterOfTheDirectoriesDecides() {
    const QString company = dir_.filePath(QStringLiteral("company"));
    Run run = runProgram(QDir(prefix()).filePath(QStringLiteral("bin/ardcard-demo")), {company});
    QVERIFY2(run.code == 0, qPrintable(run.err));

    QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
    env.insert(QStringLiteral("QT_QPA_PLATFORM"), QStringLiteral("offscreen"));
    env.insert(QStringLiteral("XDG_CONFIG_HOME"), dir_.filePath(QStringLiteral("config")));
    env.insert(QStringLiteral("TMPDIR"), dir_.path());
    run = runProgram(QDir(embedBuild()).filePath(QStringLiteral("ardcard-embed")),
                     {QStringLiteral("--self-test"), company}, env);
    QVERIFY2(run.code == 0, qPrintable(run.err));

    const QStringList lines = run.out.split(u'\n', Qt::SkipEmptyParts);
    QCOMPARE(lines.size(), 7);
    QCOMPARE(lines[0], QStringLiteral("ardcard " ARDCARD_VERSION));
    // Each card shows the account in the company its ShowAccount named; the
    // shared directories are the right card's, which called last.
    QCOMPARE(lines[1], QStringLiteral("-- each card shows its own company"));
    const QString name = QStringLiteral("פיצריית הים");
    QVERIFY2(
        lines[2].startsWith(QStringLiteral("left: box=demo.db shared=demo2.db key=10001 name=") +
                            name + QStringLiteral(" rows=")),
        qPrintable(lines[2]));
    QVERIFY2(
        lines[3].startsWith(QStringLiteral("right: box=demo2.db shared=demo2.db key=10001 name=") +
                            name + QStringLiteral(" rows=")),
        qPrintable(lines[3]));
    const QString leftRows = lines[2].section(u'=', -1);
    const QString rightRows = lines[3].section(u'=', -1);
    QVERIFY(leftRows.toInt() > 2);
    QVERIFY(rightRows.toInt() > 2);
    QVERIFY(leftRows != rightRows); // the two companies hold different lines

    // The left card sets the directories; the right card's box still says
    // demo2.db, but its fetch reads the left card's company.
    QCOMPARE(lines[4], QStringLiteral("-- the left card set the directories last"));
    QCOMPARE(lines[5], QStringLiteral("left: box=demo.db shared=demo.db key=10001 name=") + name +
                           QStringLiteral(" rows=") + leftRows);
    QCOMPARE(lines[6], QStringLiteral("right: box=demo2.db shared=demo.db key=10001 name=") + name +
                           QStringLiteral(" rows=") + leftRows);
}

QTEST_GUILESS_MAIN(TestEmbed)
#include "test_embed.moc"
