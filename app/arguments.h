#pragma once

#include <QMap>
#include <QString>
#include <QStringList>

namespace ardcard::app {

// What the command line asks of the host:
//   ardcard [--address TEXT] [--set NAME=VALUE]... [--script FILE]
//           [--headless] [--system-browser] [--demo]
struct Arguments {
    QString address;               // the hosting page's address
    QMap<QString, QString> values; // named page values given with --set
    QString script;                // empty: show the window until the user closes it
    bool headless = false;
    bool systemBrowser = false;
    bool demo = false;
};

struct ParseResult {
    Arguments arguments;
    QString error; // empty when the command line is sound
};

// Reads the arguments after the program name. A script file that does not
// exist is an error of the command line, like an unknown option.
ParseResult parseArguments(const QStringList& args);

QString usage();

} // namespace ardcard::app
