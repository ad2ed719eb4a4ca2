#pragma once

#include <QMap>
#include <QString>
#include <QStringList>

namespace ardcard::app {

// What the command line asks of the host:
//   ardcard [--address TEXT] [--set NAME=VALUE]... [--script FILE]
//           [--headless] [--system-browser] [--demo]
//   ardcard --help | --version
struct Arguments {
    QString address;               // the hosting page's address
    QMap<QString, QString> values; // named page values given with --set
    QString script;                // empty: show the window until the user closes it
    bool headless = false;
    bool systemBrowser = false;
    bool demo = false;
    // Either ends the run before anything is placed; the rest of the
    // command line is not read.
    bool help = false;
    bool version = false;
};

struct ParseResult {
    Arguments arguments;
    QString error; // empty when the command line is sound
};

// Reads the arguments after the program name. A script file that does not
// exist is an error of the command line, like an unknown option.
ParseResult parseArguments(const QStringList& args);

// One line for stderr after a wrong command line.
QString usage();
// What --help prints: every option with its meaning. The man page is made
// from this same text, so it is laid out the way the page generator reads
// it: a usage line, a paragraph, then headed sections ("Options:" entries
// start with two spaces and "--").
QString helpText();
// What --version prints.
QString versionText();

} // namespace ardcard::app
