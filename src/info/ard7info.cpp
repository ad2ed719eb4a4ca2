#include "info/ard7info.h"

#include "common/failure.h"
#include "common/module_state.h"
#include "common/text_helpers.h"
#include "connection/conn_string.h"
#include "connection/database.h"
#include "host/message_box.h"
#include "host/page_window.h"
#include "host/seams.h"
#include "info/account_page.h"
#include "info/doc_types_page.h"
#include "info/info_page_frame.h"
#include "info/item_page.h"

#include <functional>

namespace ardcard {

namespace {

// Wait page, window on it, the page itself, then the same window on the page.
// Any failure ends the request: the page builders' writers have closed their
// files by the time it arrives here; the user sees its description and the
// window stays on the wait page.
void showSequence(const QString& waitFile, const QString& pageFile,
                  const std::function<void(const QString&)>& buildPage) {
    try {
        const QString waitPath = Ard7Info::PagePath(waitFile);
        info::WriteWaitPage(waitPath);
        host::PageWindow* window = host::showPage(host::pageWindows(), waitPath);
        const QString pagePath = Ard7Info::PagePath(pageFile);
        buildPage(pagePath);
        window->Navigate(pagePath);
    } catch (const Failure& failure) {
        host::messageBox().show(QStringLiteral("תקלה"), failure.description(),
                                host::MessageIcon::Critical);
    } catch (const std::exception& error) {
        host::messageBox().show(QStringLiteral("תקלה"), QString::fromLocal8Bit(error.what()),
                                host::MessageIcon::Critical);
    }
}

// The one failure the check lets pass (a duplicate-key complaint some
// drivers raise on opening); anything else means the database does not answer.
constexpr int kPassedOverError = 3022;

} // namespace

Ard7Info::Ard7Info(QObject* parent) : QObject(parent) {}

QString Ard7Info::PagePath(const QString& fileName) {
    return TempDirectory() + u'/' + fileName;
}

void Ard7Info::OpenItemHTML(const QString& pItemCode, const QString& pConnStr, int pConnType) {
    const QString key = pItemCode.trimmed();
    showSequence(QStringLiteral("vlicrd0.htm"), QStringLiteral("vlicrd1.htm"),
                 [&](const QString& path) { CreateItemHTML(path, key, pConnStr, pConnType); });
}

void Ard7Info::OpenAccountHTML(const QString& pAccountCode, const QString& pConnStr,
                               int pConnType) {
    const QString key = pAccountCode.trimmed();
    showSequence(QStringLiteral("vlicrd0.htm"), QStringLiteral("vlicrd1.htm"),
                 [&](const QString& path) { CreateAccountHTML(path, key, pConnStr, pConnType); });
}

void Ard7Info::OpenInfoHTML(int pPageType, const QString& pConnStr, int /*pConnType*/) {
    showSequence(QStringLiteral("vlinf0.htm"), QStringLiteral("vlinf1.htm"),
                 [&](const QString& path) {
                     if (pPageType == 1)
                         CreateDocTypeHTML(path, pConnStr);
                 });
}

void Ard7Info::CreateItemHTML(const QString& pFileName, const QString& pItemCode,
                              const QString& pConnStr, int pConnType) {
    info::WriteItemPage(pFileName, pItemCode, pConnStr, pConnType);
}

void Ard7Info::CreateAccountHTML(const QString& pFileName, const QString& pAccountCode,
                                 const QString& pConnStr, int pConnType) {
    info::WriteAccountPage(pFileName, pAccountCode, pConnStr, pConnType);
}

void Ard7Info::CreateDocTypeHTML(const QString& pFileName, const QString& pConnStr) {
    info::WriteDocTypesPage(pFileName, pConnStr);
}

void Ard7Info::CreateWaitHTML(const QString& pFileName) {
    info::WriteWaitPage(pFileName);
}

void Ard7Info::CreateHTMLStyle(TextFileWriter& out) {
    info::WriteHtmlStyle(out);
}

bool Ard7Info::CheckConnArd7(const QString& pCompPath) {
    const ConnValues& conn = moduleState().conn;
    const QString database = pCompPath.isEmpty() ? conn.ConnDataBase : pCompPath;
    // Each step may fail on its own; only the one passed-over error lets the
    // check go on to the next step.
    auto step = [](const std::function<void()>& action) {
        try {
            action();
            return true;
        } catch (const Failure& failure) {
            return failure.number() == kPassedOverError;
        } catch (const std::exception&) {
            return false;
        }
    };
    QString connStr;
    Connection connection;
    Recordset rs(connection);
    return step([&] {
               connStr = BuildConnString(conn.ConnServer, conn.ConnUID, conn.ConnPWD, database,
                                         conn.ConnType);
           }) &&
           step([&] {
               connection.setTimeout(2);
               connection.open(connStr);
           }) &&
           step([&] {
               rs.Open(QStringLiteral("SELECT DocumentID FROM DocumentsDef WHERE DocumentID = 1"));
           });
}

} // namespace ardcard
