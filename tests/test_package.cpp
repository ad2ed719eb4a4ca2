// The Debian package as a user gets it: made by cpack from this build,
// unpacked with dpkg-deb into a temporary root, and its ardcard run there,
// end to end, with the container script of examples/scripts/.

#include <QDir>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>
#include <QTest>

namespace {

struct Run {
    int code = -1;
    QByteArray out;
    QByteArray err;
};

Run runProgram(const QString& program, const QStringList& args,
               const QProcessEnvironment& env = QProcessEnvironment::systemEnvironment(),
               const QString& workingDir = QString()) {
    QProcess process;
    process.setProcessEnvironment(env);
    if (!workingDir.isEmpty())
        process.setWorkingDirectory(workingDir);
    process.start(program, args);
    Run run;
    if (!process.waitForFinished(-1)) {
        run.err = process.errorString().toUtf8();
        return run;
    }
    run.code = process.exitStatus() == QProcess::NormalExit ? process.exitCode() : -1;
    run.out = process.readAllStandardOutput();
    run.err = process.readAllStandardError();
    return run;
}

// Hebrew letters and ASCII as the windows-1255 code page writes them: the
// letters alef to tav are the bytes 0xE0 to 0xFA.
QByteArray windows1255(const QString& text) {
    QByteArray out;
    for (const QChar c : text) {
        const char16_t u = c.unicode();
        if (u >= 0x05D0 && u <= 0x05EA)
            out.append(char(0xE0 + (u - 0x05D0)));
        else if (u < 0x80)
            out.append(char(u));
        else
            out.append('?');
    }
    return out;
}

} // namespace

class TestPackage : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void control_data();
    void control();
    void contents_data();
    void contents();
    void desktopEntry_data();
    void desktopEntry();
    void version_isTheProjectVersion();
    void help_listsEveryOption_data();
    void help_listsEveryOption();
    void manPage_listsEveryOption_data();
    void manPage_listsEveryOption();
    void statementsScript_writesAStatementPerAccount();

private:
    QString root(const QString& path = QString()) const {
        return QDir(dir_.filePath(QStringLiteral("root"))).filePath(path);
    }
    QProcessEnvironment environment() const;

    QTemporaryDir dir_;
    QString deb_;
    QString manPage_;
};

void TestPackage::initTestCase() {
    QVERIFY(dir_.isValid());
    const QString out = dir_.filePath(QStringLiteral("out"));
    Run run = runProgram(QStringLiteral(ARDCARD_CPACK),
                         {QStringLiteral("-G"), QStringLiteral("DEB"), QStringLiteral("--config"),
                          QStringLiteral(ARDCARD_BUILD_DIR "/CPackConfig.cmake"),
                          QStringLiteral("-B"), out});
    QVERIFY2(run.code == 0, run.out + run.err);
    const QStringList debs =
        QDir(out).entryList({QStringLiteral("*.deb")}, QDir::Files, QDir::Name);
    QCOMPARE(debs, QStringList{QStringLiteral("ardcard_" ARDCARD_VERSION "_amd64.deb")});
    deb_ = QDir(out).filePath(debs.first());

    run = runProgram(QStringLiteral("dpkg-deb"), {QStringLiteral("-x"), deb_, root()});
    QVERIFY2(run.code == 0, run.err);
    run = runProgram(
        QStringLiteral("gzip"),
        {QStringLiteral("-dc"), root(QStringLiteral("usr/share/man/man1/ardcard.1.gz"))});
    QVERIFY2(run.code == 0, run.err);
    manPage_ = QString::fromUtf8(run.out);
    for (const char* sub : {"config", "data", "tmp", "work"})
        QVERIFY(QDir(dir_.path()).mkpath(QLatin1String(sub)));
}

QProcessEnvironment TestPackage::environment() const {
    QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
    env.insert(QStringLiteral("LD_LIBRARY_PATH"), root(QStringLiteral("usr/lib")));
    env.insert(QStringLiteral("XDG_CONFIG_HOME"), dir_.filePath(QStringLiteral("config")));
    env.insert(QStringLiteral("XDG_DATA_HOME"), dir_.filePath(QStringLiteral("data")));
    env.insert(QStringLiteral("TMPDIR"), dir_.filePath(QStringLiteral("tmp")));
    env.remove(QStringLiteral("QT_QPA_PLATFORM")); // --headless chooses it
    return env;
}

void TestPackage::control_data() {
    QTest::addColumn<QString>("field");
    QTest::addColumn<QString>("expected"); // what the value contains
    QTest::newRow("package") << "Package"
                             << "ardcard";
    QTest::newRow("version") << "Version" << ARDCARD_VERSION;
    QTest::newRow("architecture") << "Architecture"
                                  << "amd64";
    QTest::newRow("sqlite driver") << "Depends"
                                   << "libqt6sql6-sqlite";
    QTest::newRow("odbc driver") << "Depends"
                                 << "libqt6sql6-odbc";
    QTest::newRow("web engine") << "Depends"
                                << "libqt6webenginewidgets6";
    QTest::newRow("fonts") << "Recommends"
                           << "fonts-liberation2, culmus";
}

void TestPackage::control() {
    QFETCH(QString, field);
    QFETCH(QString, expected);
    const Run run = runProgram(QStringLiteral("dpkg-deb"), {QStringLiteral("-f"), deb_, field});
    QCOMPARE(run.code, 0);
    QVERIFY2(QString::fromUtf8(run.out).contains(expected), run.out);
}

void TestPackage::contents_data() {
    QTest::addColumn<QString>("path");
    QTest::newRow("host application") << "usr/bin/ardcard";
    QTest::newRow("demo builder") << "usr/bin/ardcard-demo";
    QTest::newRow("library") << "usr/lib/libardcard.so.7";
    QTest::newRow("card header") << "usr/include/ardcard/card.h";
    QTest::newRow("package config") << "usr/lib/cmake/ardcard/ardcardConfig.cmake";
    QTest::newRow("designer plugin") << "usr/" ARDCARD_DESIGNER_DIR "/libardcard_designer.so";
    QTest::newRow("desktop entry") << "usr/share/applications/ardcard.desktop";
    QTest::newRow("icon") << "usr/share/icons/hicolor/scalable/apps/ardcard.svg";
    QTest::newRow("man page") << "usr/share/man/man1/ardcard.1.gz";
}

void TestPackage::contents() {
    QFETCH(QString, path);
    QVERIFY2(QFile::exists(root(path)), qPrintable(path));
}

void TestPackage::desktopEntry_data() {
    QTest::addColumn<QString>("line");
    QTest::newRow("type") << "Type=Application";
    QTest::newRow("command") << "Exec=ardcard";
    QTest::newRow("icon") << "Icon=ardcard";
    QTest::newRow("hebrew name") << "Name[he]=כרטסת חשבון";
    QTest::newRow("demo action") << "Exec=ardcard --demo";
}

void TestPackage::desktopEntry() {
    QFETCH(QString, line);
    QFile file(root(QStringLiteral("usr/share/applications/ardcard.desktop")));
    QVERIFY(file.open(QIODevice::ReadOnly));
    const QStringList lines = QString::fromUtf8(file.readAll()).split(u'\n');
    QVERIFY2(lines.contains(line), qPrintable(line));
}

void TestPackage::version_isTheProjectVersion() {
    const Run run = runProgram(root(QStringLiteral("usr/bin/ardcard")),
                               {QStringLiteral("--version")}, environment());
    QCOMPARE(run.code, 0);
    QCOMPARE(run.out, QByteArray("ardcard " ARDCARD_VERSION "\n"));
    QCOMPARE(run.err, QByteArray());
}

void TestPackage::help_listsEveryOption_data() {
    QTest::addColumn<QString>("entry");
    QTest::newRow("usage") << "Usage: ardcard [OPTION]...";
    QTest::newRow("address") << "  --address TEXT ";
    QTest::newRow("set") << "  --set NAME=VALUE ";
    QTest::newRow("script") << "  --script FILE ";
    QTest::newRow("headless") << "  --headless ";
    QTest::newRow("system browser") << "  --system-browser ";
    QTest::newRow("demo") << "  --demo ";
    QTest::newRow("help") << "  --help ";
    QTest::newRow("version") << "  --version ";
}

void TestPackage::help_listsEveryOption() {
    QFETCH(QString, entry);
    const Run run = runProgram(root(QStringLiteral("usr/bin/ardcard")), {QStringLiteral("--help")},
                               environment());
    QCOMPARE(run.code, 0);
    QCOMPARE(run.err, QByteArray());
    QVERIFY2(QString::fromUtf8(run.out).contains(entry), run.out);
}

void TestPackage::manPage_listsEveryOption_data() {
    QTest::addColumn<QString>("entry");
    QTest::newRow("title") << ".TH ARDCARD 1 \"\" \"ardcard " ARDCARD_VERSION
                              "\" \"User Commands\"";
    QTest::newRow("name") << ".SH NAME\nardcard \\- the Ardeco account card\n";
    QTest::newRow("address") << ".TP\n.BI \"\\-\\-address \" TEXT\n";
    QTest::newRow("set") << ".TP\n.BI \"\\-\\-set \" NAME=VALUE\n";
    QTest::newRow("script") << ".TP\n.BI \"\\-\\-script \" FILE\n";
    QTest::newRow("headless") << ".TP\n.B \\-\\-headless\n";
    QTest::newRow("system browser") << ".TP\n.B \\-\\-system\\-browser\n";
    QTest::newRow("demo") << ".TP\n.B \\-\\-demo\n";
    QTest::newRow("help") << ".TP\n.B \\-\\-help\nshow this help and exit\n";
    QTest::newRow("version") << ".TP\n.B \\-\\-version\nshow the version and exit\n";
    QTest::newRow("exit status") << ".SH EXIT STATUS\n";
    QTest::newRow("files") << ".SH FILES\n";
}

void TestPackage::manPage_listsEveryOption() {
    QFETCH(QString, entry);
    QVERIFY2(manPage_.contains(entry), qPrintable(manPage_));
}

void TestPackage::statementsScript_writesAStatementPerAccount() {
    const QString work = dir_.filePath(QStringLiteral("work"));
    const Run run = runProgram(
        root(QStringLiteral("usr/bin/ardcard")),
        {QStringLiteral("--headless"), QStringLiteral("--demo"), QStringLiteral("--script"),
         QStringLiteral(ARDCARD_SOURCE_DIR "/examples/scripts/statements.js")},
        environment(), work);
    QVERIFY2(run.code == 0, run.err);

    // Three accounts of the demo company and one it does not have.
    struct Account {
        const char* key;
        QString name;
    };
    const Account accounts[] = {{"10001", QStringLiteral("פיצריית הים")},
                                {"10002", QStringLiteral("אברהם וקנין")},
                                {"10006", QStringLiteral("צביקה פרץ")}};
    const QStringList lines = QString::fromUtf8(run.out).split(u'\n', Qt::SkipEmptyParts);
    QCOMPARE(lines.size(), 4);
    for (int i = 0; i < 3; ++i) {
        const QString key = QLatin1String(accounts[i].key);
        const QString file = QStringLiteral("statement-") + key + QStringLiteral(".htm");
        const QString head = key + u' ' + accounts[i].name + QStringLiteral(": ");
        QVERIFY2(lines[i].startsWith(head), qPrintable(lines[i]));
        QVERIFY2(lines[i].endsWith(QStringLiteral(" lines -> ") + file), qPrintable(lines[i]));
        QVERIFY(lines[i].section(u' ', -4, -4).toInt() > 0);

        QFile page(QDir(work).filePath(file));
        QVERIFY2(page.open(QIODevice::ReadOnly), qPrintable(file));
        const QByteArray bytes = page.readAll();
        QVERIFY(bytes.startsWith("<HTML>\r\n<HEAD>\r\n"));
        QVERIFY(bytes.contains(
            windows1255(QStringLiteral("<TITLE>ולמור מערכות מידע מציגה</TITLE>\r\n"))));
        QVERIFY(bytes.contains(windows1255(accounts[i].name)));
        QVERIFY(
            bytes.contains(windows1255(QStringLiteral("<p align='center'>ולמור מערכות מידע</p>"))));
    }
    QCOMPARE(lines[3], QStringLiteral("99999: no such account"));
    QVERIFY(!QFile::exists(QDir(work).filePath(QStringLiteral("statement-99999.htm"))));
}

QTEST_GUILESS_MAIN(TestPackage)
#include "test_package.moc"
