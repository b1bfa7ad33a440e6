#include "platform/commandline.h"

#include <QCommandLineParser>
#include <QCoreApplication>
#include <QFile>

#include <cstdio>
#include <cstdlib>

namespace {

[[noreturn]] void print(const QString &text) {
    std::fputs(qPrintable(text), stdout);
    std::exit(0);
}

[[noreturn]] void refuse(const char *name, const QString &problem) {
    std::fprintf(stderr, "%s: %s\n", name, qPrintable(problem));
    std::exit(2);
}

} // namespace

CommandLine parseCommandLine(int argc, char **argv, const char *name,
                             const QStringList &pageNames) {
    QStringList arguments;
    for (int index = 0; index < argc; ++index) {
        arguments << QFile::decodeName(argv[index]);
    }
    const QCommandLineOption init{"init", "Read the files, show nothing, end."};
    const QCommandLineOption help{{"h", "help"}, "Print this text."};
    const QCommandLineOption version{{"v", "version"}, "Print the version."};
    QCommandLineParser parser;
    parser.setSingleDashWordOptionMode(QCommandLineParser::ParseAsLongOptions);
    parser.addOptions({init, help, version});
    parser.addPositionalArgument("PAGE", "Show these pages alone: " + pageNames.join(", ") + '.',
                                 "[PAGE...]");
    if (!parser.parse(arguments)) {
        refuse(name, parser.errorText());
    }
    if (parser.isSet(help)) {
        // The text begins with the program's name, which the toolkit asks its application for.
        const QCoreApplication application{argc, argv};
        print(parser.helpText());
    }
    if (parser.isSet(version)) {
        print(QStringLiteral("%1 " TARVEX_VERSION "\n").arg(name));
    }
    for (const QString &page : parser.positionalArguments()) {
        if (!pageNames.contains(page)) {
            refuse(name, QStringLiteral("unknown page \"%1\"; the pages are %2")
                             .arg(page, pageNames.join(", ")));
        }
    }
    return {.isInitOnly = parser.isSet(init), .pages = parser.positionalArguments()};
}
