// ardcard-demo DIR: writes the two demo company files into DIR.

#include "common/failure.h"
#include "demo/demo_builder.h"

#include <QCoreApplication>
#include <QDir>
#include <QTextStream>

int main(int argc, char* argv[]) {
    QCoreApplication app(argc, argv);
    QTextStream out(stdout);
    QTextStream err(stderr);
    const QStringList args = app.arguments();
    if (args.size() != 2) {
        err << "usage: ardcard-demo DIR\n";
        return 2;
    }
    const QString dir = QDir(args[1]).absolutePath();
    try {
        ardcard::demo::BuildDemoCompany(dir);
    } catch (const ardcard::Failure& failure) {
        err << failure.description() << '\n';
        return 1;
    }
    out << QDir(dir).filePath(ardcard::demo::DemoFileName()) << '\n'
        << QDir(dir).filePath(ardcard::demo::Demo2FileName()) << '\n';
    return 0;
}
