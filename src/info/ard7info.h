#pragma once

#include <QObject>
#include <QString>

namespace ardcard {

class TextFileWriter;

// Builds the read-only information pages straight from the host product's
// database (the account card, the item card, the list of document types) and
// shows each in a new page window: the window opens on a small wait page and
// switches to the page once it is written. The object keeps nothing between
// calls; the card creates one per request.
//
// Page files live in the temporary directory under fixed names
// ("vlicrd0.htm"/"vlicrd1.htm" for the item and account cards,
// "vlinf0.htm"/"vlinf1.htm" for the general pages) and are overwritten by the
// next request of the same kind.
//
// The Open* methods never throw: a failure closes the page file as far as it
// got, shows its description in a message box and leaves the window on the
// wait page. The Create* methods hand their failures to the caller.
//
// The methods keep their own names so that a container script can call them
// (`info.OpenItemHTML("A100", conn, 4)`).
class Ard7Info : public QObject {
    Q_OBJECT
public:
    explicit Ard7Info(QObject* parent = nullptr);

    Q_INVOKABLE void OpenItemHTML(const QString& pItemCode, const QString& pConnStr, int pConnType);
    Q_INVOKABLE void OpenAccountHTML(const QString& pAccountCode, const QString& pConnStr,
                                     int pConnType);
    // Page type 1 is the list of document types; any other type writes no page.
    Q_INVOKABLE void OpenInfoHTML(int pPageType, const QString& pConnStr, int pConnType);

    Q_INVOKABLE void CreateItemHTML(const QString& pFileName, const QString& pItemCode,
                                    const QString& pConnStr, int pConnType);
    Q_INVOKABLE void CreateAccountHTML(const QString& pFileName, const QString& pAccountCode,
                                       const QString& pConnStr, int pConnType);
    Q_INVOKABLE void CreateDocTypeHTML(const QString& pFileName, const QString& pConnStr);
    Q_INVOKABLE void CreateWaitHTML(const QString& pFileName);
    // The page style sheet into a page being written.
    void CreateHTMLStyle(TextFileWriter& out);

    // True when the database answers within 2 seconds: the stored connection
    // values with `pCompPath` as the database (the stored database when
    // empty). Never shows a message.
    Q_INVOKABLE bool CheckConnArd7(const QString& pCompPath = QString());

    // The full path of a page file in the temporary directory.
    static QString PagePath(const QString& fileName);
};

} // namespace ardcard
