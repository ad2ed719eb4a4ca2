// Timing of the journal read: how much the ledger adds to the bare cost of
// reading the query's rows, and how much memory a large ledger takes.
//
//   ledger_bench [lines ...]      default: 10000 100000 1000000
//
// Company files (the demo ledger company: one account, `lines` lines) are
// generated once into $TMPDIR/ardcard-ledger-bench and reused. For every size it prints
//   (a) bare scan: the main query read forward, every column of every row;
//   (b) the journal read into the ledger model alone;
//   (c) the same with a table view attached to the model (offscreen);
//   (d) the fetch button of a real card shown offscreen, one company;
// lines per second (the fastest of five runs), the ratios to (a), and the peak resident set
// size of the process so far (sizes run in ascending order, so the figure
// after the largest size is its peak).

#include "card/card.h"
#include "common/module_state.h"
#include "demo/demo_builder.h"
#include "host/seams.h"
#include "ledger/fetch_command.h"
#include "ledger/journal_reader.h"
#include "ledger/journal_sql.h"
#include "ledger/ledger_model.h"

#include <QApplication>
#include <QDate>
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QPushButton>
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

// Each measurement is taken kRuns times, interleaved, and the fastest run
// counts: what other processes add to a run is noise, never the code's own cost.
constexpr int kRuns = 5;

Timing fastest(const Timing& best, const Timing& run) {
    return best.cpu == 0 || run.cpu < best.cpu ? run : best;
}

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

// (d): the fetch button of a real card on the screen, one company.
Timing cardFetch(const QString& path, qint64& rows) {
    Card card;
    // The card loads the stored connection values when it is made.
    moduleState().conn = ConnValues{};
    moduleState().conn.ConnType = 4;
    card.resize(1200, 800);
    card.show();
    QApplication::processEvents();
    moduleState().CompanyDirText = path;
    card.setAccountKey(kAccount);
    const Clock clock;
    card.findChild<QPushButton*>(QStringLiteral("ShowTransButt"))->click();
    QApplication::processEvents();
    const Timing seconds{clock.wallSeconds(), clock.cpu()};
    rows = card.ledger().dataRowCount();
    return seconds;
}

} // namespace

int main(int argc, char** argv) {
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    // A failure is printed instead of waiting in a message box.
    host::MessageRecorder messages(true);
    host::ScopedSeams seams(&messages, nullptr);
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
    std::printf("%9s %19s %19s %19s %19s %5s %5s %5s %7s\n", "lines", "(a) scan", "(b) model",
                "(c) view", "(d) card", "b/a", "c/a", "d/a", "RSS MB");
    for (const int lines : sizes) {
        const QString path = dir + QStringLiteral("/ledger_demo_%1.db").arg(lines);
        if (!QFile::exists(path)) {
            QElapsedTimer build;
            build.start();
            demo::BuildLedgerCompany(path, kAccount, lines);
            std::fprintf(stderr, "built %s in %.1f s\n", qPrintable(path),
                         build.nsecsElapsed() / 1e9);
        }
        qint64 scanned = 0;
        qint64 modelRows = 0;
        qint64 viewRows = 0;
        bareScan(path, scanned); // warms the file cache for every measurement
        Timing a;
        Timing b;
        Timing c;
        Timing d;
        qint64 cardRows = 0;
        for (int run = 0; run < kRuns; ++run) {
            a = fastest(a, bareScan(path, scanned));
            b = fastest(b, ledgerRead(path, false, modelRows));
            c = fastest(c, ledgerRead(path, true, viewRows));
            d = fastest(d, cardFetch(path, cardRows));
        }
        if (scanned != lines || modelRows != lines || viewRows != lines || cardRows != lines)
            std::fprintf(stderr, "row counts differ: %lld %lld %lld %lld\n",
                         static_cast<long long>(scanned), static_cast<long long>(modelRows),
                         static_cast<long long>(viewRows), static_cast<long long>(cardRows));
        const auto rate = [lines](double seconds) { return lines / seconds; };
        std::printf("%9d %8.0f (%8.0f) %8.0f (%8.0f) %8.0f (%8.0f) %8.0f (%8.0f) %5.2f %5.2f "
                    "%5.2f %7ld\n",
                    lines, rate(a.cpu), rate(a.wall), rate(b.cpu), rate(b.wall), rate(c.cpu),
                    rate(c.wall), rate(d.cpu), rate(d.wall), b.cpu / a.cpu, c.cpu / a.cpu,
                    d.cpu / a.cpu, peakRssMb());
        std::fflush(stdout);
    }
    return 0;
}
