// Timing of the journal read: how much the ledger adds to the bare cost of
// reading the query's rows, and how much memory a large ledger takes.
//
//   ledger_bench [lines ...]      default: 10000 100000 1000000
//
// Company files are generated once into $TMPDIR/ardcard-ledger-bench and
// reused. For every size it prints
//   (a) bare scan: the main query read forward, every column of every row;
//   (b) the journal read into the ledger model alone;
//   (c) the same with a table view attached to the model (offscreen);
// lines per second, the ratios (b)/(a) and (c)/(a), and the peak resident set
// size of the process so far (sizes run in ascending order, so the figure
// after the largest size is its peak).

#include "common/module_state.h"
#include "ledger/fetch_command.h"
#include "ledger/journal_reader.h"
#include "ledger/journal_sql.h"
#include "ledger/ledger_model.h"

#include <QApplication>
#include <QDate>
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QSqlRecord>
#include <QTableView>
#include <algorithm>
#include <cstdio>
#include <ctime>
#include <sys/resource.h>

using namespace ardcard;

namespace {

const QString kAccount = QStringLiteral("1001");

// Wall time and the CPU time of this thread: the machine is shared, so the
// ratios are taken on CPU time, which other processes do not inflate.
struct Clock {
    QElapsedTimer wall;
    double cpuStart = cpuNow();
    Clock() { wall.start(); }
    static double cpuNow() {
        timespec ts{};
        clock_gettime(CLOCK_THREAD_CPUTIME_ID, &ts);
        return static_cast<double>(ts.tv_sec) + static_cast<double>(ts.tv_nsec) / 1e9;
    }
    double cpu() const { return cpuNow() - cpuStart; }
    double wallSeconds() const { return static_cast<double>(wall.nsecsElapsed()) / 1e9; }
};

struct Timing {
    double wall = 0;
    double cpu = 0;
};

long peakRssMb() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return usage.ru_maxrss / 1024; // kilobytes on Linux
}

void check(QSqlQuery& query, bool ok) {
    if (!ok) {
        std::fprintf(stderr, "%s\n", qPrintable(query.lastError().text()));
        std::exit(2);
    }
}

// One account with `lines` journal lines: each transaction has the account's
// move and the counter account's, over 50 counter accounts, 4 currencies,
// some 20 years of dates, every description different.
void buildCompany(const QString& path, int lines) {
    QFile::remove(path);
    const QString name = QStringLiteral("bench-build");
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name);
        db.setDatabaseName(path);
        if (!db.open()) {
            std::fprintf(stderr, "cannot create %s\n", qPrintable(path));
            std::exit(2);
        }
        QSqlQuery q(db);
        const char* ddl[] = {
            "PRAGMA journal_mode=OFF",
            "PRAGMA synchronous=OFF",
            "CREATE TABLE JurnalTrans (TransID INTEGER PRIMARY KEY, Type INTEGER, Status "
            "INTEGER, FixedID INTEGER, ValueDate DATETIME, DueDate DATETIME, BatchNo INTEGER, "
            "Referance INTEGER, Ref2 INTEGER, Description TEXT, CostCode TEXT, TransType TEXT, "
            "CurrencyCode TEXT, TransDebID TEXT, TransCredID TEXT)",
            "CREATE TABLE JurnalTransMoves (ID INTEGER PRIMARY KEY, TransID INTEGER, AccountKey "
            "TEXT, SuF REAL, SuFDlr REAL, DebitCredit INTEGER, FullMatch INTEGER)",
            "CREATE TABLE Currencies (ID INTEGER, CurrencyCode TEXT PRIMARY KEY)",
            "CREATE TABLE Accounts (AccountKey TEXT PRIMARY KEY, FullName TEXT, Filter TEXT)",
        };
        for (const char* sql : ddl)
            check(q, q.exec(QString::fromLatin1(sql)));
        db.transaction();
        const QStringList codes = {QStringLiteral("ש\"ח"), QStringLiteral("$"),
                                   QStringLiteral("EUR"), QStringLiteral("GBP")};
        for (int i = 0; i < codes.size(); ++i) {
            q.prepare(QStringLiteral("INSERT INTO Currencies VALUES (?, ?)"));
            q.addBindValue(i + 1);
            q.addBindValue(codes[i]);
            check(q, q.exec());
        }
        for (int i = 0; i <= 50; ++i) {
            q.prepare(QStringLiteral("INSERT INTO Accounts VALUES (?, ?, '')"));
            q.addBindValue(QString::number(1001 + i * 1000));
            q.addBindValue(QStringLiteral("חשבון %1").arg(i));
            check(q, q.exec());
        }
        QSqlQuery t(db);
        t.prepare(QStringLiteral("INSERT INTO JurnalTrans VALUES "
                                 "(?, 0, 1, 0, ?, ?, ?, ?, ?, ?, ?, '', ?, ?, ?)"));
        QSqlQuery m(db);
        m.prepare(QStringLiteral("INSERT INTO JurnalTransMoves (TransID, AccountKey, SuF, SuFDlr, "
                                 "DebitCredit, FullMatch) VALUES (?, ?, ?, ?, ?, ?)"));
        const QDate start(2006, 1, 1);
        for (int i = 1; i <= lines; ++i) {
            const QDate date = start.addDays((i * 7LL) % 7300);
            const QString counter = QString::number(2001 + (i % 50) * 1000);
            const bool debit = i % 3 != 0;
            const double amount = (i % 997) * 10.5 + 1;
            t.addBindValue(i);
            t.addBindValue(date.toString(Qt::ISODate));
            t.addBindValue(date.addDays(30).toString(Qt::ISODate));
            t.addBindValue(i / 100 + 1);
            t.addBindValue(100000 + i);
            t.addBindValue(i % 5 == 0 ? QVariant() : QVariant(i % 1000));
            t.addBindValue(QStringLiteral("חשבונית מס %1 ללקוח").arg(i));
            t.addBindValue(i % 4 == 0 ? QVariant() : QVariant(QStringLiteral("C%1").arg(i % 7)));
            t.addBindValue(codes[i % codes.size()]);
            t.addBindValue(debit ? kAccount : counter);
            t.addBindValue(debit ? counter : kAccount);
            check(t, t.exec());
            for (int side = 0; side < 2; ++side) {
                m.addBindValue(i);
                m.addBindValue(side == 0 ? kAccount : counter);
                m.addBindValue(amount);
                m.addBindValue(amount / 3.7);
                m.addBindValue(side == 0 ? (debit ? 0 : 1) : (debit ? 1 : 0));
                m.addBindValue(i % 4 == 1 ? i : 0);
                check(m, m.exec());
            }
        }
        check(q, q.exec(QStringLiteral("CREATE INDEX MovesByAccount ON JurnalTransMoves "
                                       "(AccountKey)")));
        db.commit();
        db.close();
    }
    QSqlDatabase::removeDatabase(name);
}

// (a): what reading the rows costs with nothing done with them.
Timing bareScan(const QString& path, qint64& rows) {
    const QString name = QStringLiteral("bench-scan");
    Timing seconds;
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name);
        db.setDatabaseName(path);
        db.setConnectOptions(QStringLiteral("QSQLITE_OPEN_READONLY"));
        db.open();
        const Clock clock;
        QSqlQuery q(db);
        q.setForwardOnly(true);
        check(q, q.exec(JournalMainSql(kAccount, false, false)));
        const int columns = q.record().count();
        rows = 0;
        qint64 touched = 0;
        while (q.next()) {
            for (int c = 0; c < columns; ++c)
                touched += q.value(c).isNull() ? 0 : 1;
            ++rows;
        }
        seconds = {clock.wallSeconds(), clock.cpu()};
        if (touched == 0)
            std::fprintf(stderr, "no values read\n");
        db.close();
    }
    QSqlDatabase::removeDatabase(name);
    return seconds;
}

class FrameProgress final : public ProgressSink {
public:
    int frameWidth() const override { return 300; }
    void setFillWidth(int width) override { last = width; }
    int last = 0;
};

// (b) and (c): the journal read into the real model, with or without a view.
Timing ledgerRead(const QString& path, bool withView, qint64& rows) {
    LedgerModel model;
    QTableView view;
    if (withView) {
        view.setModel(&model);
        view.resize(1000, 600);
        view.show();
        QApplication::processEvents();
    }
    InitLedgerData(model);
    FrameProgress progress;
    QString failure;
    const Clock clock;
    const int result =
        ReadTransactions7(path, kAccount, 1, JournalOptions{}, model, progress, &failure);
    if (withView)
        QApplication::processEvents();
    const Timing seconds{clock.wallSeconds(), clock.cpu()};
    if (result != -1)
        std::fprintf(stderr, "read failed: %s\n", qPrintable(failure));
    rows = model.dataRowCount();
    return seconds;
}

} // namespace

int main(int argc, char** argv) {
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    QList<int> sizes;
    for (int i = 1; i < argc; ++i)
        sizes.append(QString::fromLocal8Bit(argv[i]).toInt());
    if (sizes.isEmpty())
        sizes = {10000, 100000, 1000000};
    std::sort(sizes.begin(), sizes.end());

    const QString dir = QDir::tempPath() + QStringLiteral("/ardcard-ledger-bench");
    QDir().mkpath(dir);
    moduleState().conn.ConnType = 4; // a database file named by the directory entry

    std::printf("lines/second on CPU time (wall time in brackets); ratios on CPU time\n");
    std::printf("%9s %20s %20s %20s %6s %6s %8s\n", "lines", "(a) scan", "(b) model", "(c) view",
                "b/a", "c/a", "RSS MB");
    for (const int lines : sizes) {
        const QString path = dir + QStringLiteral("/ledger_%1.db").arg(lines);
        if (!QFile::exists(path)) {
            QElapsedTimer build;
            build.start();
            buildCompany(path, lines);
            std::fprintf(stderr, "built %s in %.1f s\n", qPrintable(path),
                         build.nsecsElapsed() / 1e9);
        }
        qint64 scanned = 0;
        qint64 modelRows = 0;
        qint64 viewRows = 0;
        bareScan(path, scanned); // warms the file cache for every measurement
        const Timing a = bareScan(path, scanned);
        const Timing b = ledgerRead(path, false, modelRows);
        const Timing c = ledgerRead(path, true, viewRows);
        if (scanned != lines || modelRows != lines || viewRows != lines)
            std::fprintf(stderr, "row counts differ: %lld %lld %lld\n",
                         static_cast<long long>(scanned), static_cast<long long>(modelRows),
                         static_cast<long long>(viewRows));
        const auto rate = [lines](double seconds) { return lines / seconds; };
        std::printf("%9d %9.0f (%8.0f) %9.0f (%8.0f) %9.0f (%8.0f) %6.2f %6.2f %8ld\n", lines,
                    rate(a.cpu), rate(a.wall), rate(b.cpu), rate(b.wall), rate(c.cpu), rate(c.wall),
                    b.cpu / a.cpu, c.cpu / a.cpu, peakRssMb());
        std::fflush(stdout);
    }
    return 0;
}
