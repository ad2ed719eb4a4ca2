// Processor time of the statement, the CSV export and the graph page over a
// large ledger, against a floor: the same number of bytes written to the same
// directory by one plain buffered loop. Run:
//   build/bench/reports_bench [rows...]      (default 100000 1000000)

#include "common/module_state.h"
#include "ledger/ledger_model.h"
#include "reports/csv_writer.h"
#include "reports/graph_writer.h"
#include "reports/report_screen.h"
#include "reports/statement_writer.h"

#include <QCoreApplication>
#include <QDate>
#include <QFileInfo>
#include <QTemporaryDir>
#include <algorithm>
#include <cstdio>
#include <ctime>
#include <functional>
#include <vector>

using namespace ardcard;

namespace {

// The machine is shared: the best of several runs (five at least, more for
// short ones, up to about a second in all), in processor time of this
// process (user and system, so the floor's write calls count too).
double cpuNow() {
    timespec t{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &t);
    return static_cast<double>(t.tv_sec) + static_cast<double>(t.tv_nsec) / 1e9;
}

double secondsOf(const std::function<void()>& work) {
    double best = 1e300;
    double total = 0;
    for (int run = 0; run < 50 && (run < 5 || total < 1.0); ++run) {
        const double start = cpuNow();
        work();
        const double seconds = cpuNow() - start;
        best = std::min(best, seconds);
        total += seconds;
    }
    return best;
}

// Rows as a busy customer account gives them: two companies, Hebrew details,
// amounts with thousands, a running balance, some foreign currency.
void fillLedger(LedgerModel& ledger, ModuleState& state, int rows) {
    static const QString kDetails[] = {
        QStringLiteral("חשבונית מס 10452"),        QStringLiteral("קבלה - העברה בנקאית"),
        QStringLiteral("זיכוי החזרת סחורה"),       QStringLiteral("תשלום בשיק דחוי 3 חודשים"),
        QStringLiteral("Invoice & <credit> note"),
    };
    static const QString kCodes[] = {QStringLiteral("ש\"ח"), QStringLiteral("USD"),
                                     QStringLiteral("EUR")};
    // The journal read keeps one string per distinct counter account and
    // name, shared by every row that names it.
    std::vector<QString> counterKeys;
    std::vector<QString> counterNames;
    for (int k = 0; k < 250; ++k) {
        counterKeys.push_back(QString::number(3000 + k));
        counterNames.push_back(QStringLiteral("ספק מספר ") + QString::number(k));
    }
    ledger.clear();
    ledger.reserve(rows);
    state.periods.clear();
    double balance = 0;
    const QDate first(2015, 1, 1);
    for (int i = 0; i < rows; ++i) {
        LedgerRow r;
        r.rowNumber = i + 1;
        r.valueDate = first.addDays(i / 40);
        r.dueDate = r.valueDate.addDays(30);
        r.batchNo = 1000 + i / 25;
        r.transId = 50000 + i;
        r.referance = 20000 + i;
        r.ref2 = i % 7 == 0 ? 0 : 300 + i % 91;
        r.description = kDetails[i % 5];
        r.amount = ((i * 7919) % 200000 - 100000) / 100.0 * 3.7;
        r.foreignAmount = i % 3 == 0 ? 0 : r.amount / 3.6;
        r.currencyCode = kCodes[i % 3];
        balance += r.amount;
        r.balance = balance;
        r.costCode = i % 4 == 0 ? QStringLiteral("A-12") : QStringLiteral(" ");
        r.currencyId = i % 3 + 1;
        r.detail.CompIndex = i < rows / 2 ? 1 : 2;
        r.detail.CounterKey = counterKeys[static_cast<size_t>(i % 250)];
        r.detail.CounterName = counterNames[static_cast<size_t>(i % 250)];
        state.periods.add(r.valueDate, r.amount);
        ledger.stage(std::move(r));
    }
    ledger.commitStaged();
}

// The same number of bytes in lines of about the writers' length, through
// one std::FILE with a large buffer.
double floorSeconds(const QString& path, qint64 bytes) {
    static char buffer[1 << 20];
    static const char line[] = "    <td>1,234,567.89</td> some text of a believable length\r\n";
    const qint64 lineLength = sizeof line - 1;
    return secondsOf([&] {
        std::FILE* f = std::fopen(QFile::encodeName(path).constData(), "wb");
        if (!f)
            return;
        std::setvbuf(f, buffer, _IOFBF, sizeof buffer);
        qint64 written = 0;
        while (written + lineLength <= bytes) {
            std::fwrite(line, 1, lineLength, f);
            written += lineLength;
        }
        std::fwrite(line, 1, static_cast<size_t>(bytes - written), f);
        std::fclose(f);
    });
}

void report(const char* name, int rows, double seconds, qint64 bytes, double floor) {
    std::printf("%-10s %9d rows  %7.3f s  %10.0f rows/s  %7.1f MB/s  floor %6.3f s  ratio %5.2f\n",
                name, rows, seconds, rows / seconds, bytes / seconds / 1e6, floor, seconds / floor);
}

} // namespace

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    std::vector<int> sizes;
    for (int i = 1; i < argc; ++i)
        sizes.push_back(QString::fromLocal8Bit(argv[i]).toInt());
    if (sizes.empty())
        sizes = {100000, 1000000};

    QTemporaryDir dir;
    ModuleState& state = moduleState();
    state.CompanyDirList = {QString(), QStringLiteral("C:\\Ardeco\\co1"),
                            QStringLiteral("C:\\Ardeco\\co2")};
    state.CompanyDirCount = 2;
    state.company.ShortName = QStringLiteral("חברת הדגמה");
    state.CurrencyCodes[2] = QStringLiteral("USD");
    state.CurrencyTotals[2] = 1234.5;
    reports::ReportScreen screen;
    screen.accountKey = QStringLiteral("1001");
    screen.accountName = QStringLiteral("לקוח א");
    screen.showHeadDetails = true;
    const QString floorPath = dir.filePath(QStringLiteral("floor.bin"));

    for (const int rows : sizes) {
        LedgerModel ledger;
        const double start = cpuNow();
        fillLedger(ledger, state, rows);
        const double fill = cpuNow() - start;
        std::printf("fill       %9d rows  %7.3f s\n", rows, fill);

        // What the writers cannot avoid: reading the 13 printed cells of every
        // row from the ledger (one formatted text per cell).
        qsizetype chars = 0;
        const double cells = secondsOf([&] {
            chars = 0;
            for (int r = 1; r <= ledger.gridRowCount() - 2; ++r)
                for (int c = 0; c <= LedgerModel::kColumns - 5; ++c)
                    chars += ledger.cellText(r, c).size();
        });
        std::printf("cells      %9d rows  %7.3f s  %10.0f rows/s  (%lld chars)\n", rows, cells,
                    rows / cells, static_cast<long long>(chars));

        const QString statement = dir.filePath(QStringLiteral("vlprint.htm"));
        const double st =
            secondsOf([&] { reports::WriteStatement(statement, ledger, state, screen); });
        const qint64 stBytes = QFileInfo(statement).size();
        report("statement", rows, st, stBytes, floorSeconds(floorPath, stBytes));

        const QString csv = dir.filePath(QStringLiteral("vltrans1.csv"));
        const double cs = secondsOf([&] { reports::WriteCsv(csv, ledger, state, true); });
        const qint64 csBytes = QFileInfo(csv).size();
        report("csv", rows, cs, csBytes, floorSeconds(floorPath, csBytes));

        const QString graph = dir.filePath(QStringLiteral("vtransg.htm"));
        const double gr = secondsOf([&] {
            reports::WriteGraph(graph, state.periods, 0, state.company.ShortName, screen.accountKey,
                                screen.accountName);
        });
        const qint64 grBytes = QFileInfo(graph).size();
        report("graph", rows, gr, grBytes, floorSeconds(floorPath, grBytes));
    }
    return 0;
}
