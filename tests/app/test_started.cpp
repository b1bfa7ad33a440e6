#include "datafiles.h"
#include "program.h"

#include <QRegularExpression>

namespace {

const std::string master = TEST_PRODUCT "/config/master";

/// What the program shows to a user.
struct Case {
    const char *name;
    QStringList environment = {};
    QStringList pages = {};
    const char *lines = ":"; ///< Done to the product beforehand.
    QStringList shown;
    QStringList unshown = {};
};

/// The first text that is not as the case wants it, after "Help" was pressed; empty when all are.
QString firstWrong(const Case &row) {
    const Program program{row.pages, [] {}, row.environment};
    if (!program.isReady() || !program.does('H') || !program.does('t')) {
        return "it does not start";
    }
    const QString texts = QString::fromStdString('\n' + bytesAt(TEST_PRODUCT "/texts"));
    for (const QString &text : row.shown + row.unshown) {
        if (texts.contains('\n' + text) == row.unshown.contains(text)) {
            return text;
        }
    }
    return program.applies() ? "" : "it does not apply";
}

} // namespace

/// The program as a user starts it.
class TestStarted : public QObject {
    Q_OBJECT

private slots:
    void whatIsShown() {
        const QStringList german{"LC_ALL=de_DE.UTF-8"};
        const Case cases[]{
            {.name = "all pages",
             .shown = {"tab &SMTP", "tab &POP3", "tab &IMAP", "tab Fetchers", "tab &Delivery",
                       "tab &Aliasing", "tab &Mail List", "Cancel", "Enable server", "SMTP | POP3"},
             .unshown = {"Changes cannot be saved"}},
            {.name = "two pages",
             .pages = {"alias", "fetch"},
             .shown = {"tab Fetchers", "tab &Aliasing"},
             .unshown = {"tab &SMTP", "tab &POP3", "tab &IMAP", "tab &Delivery", "tab &Mail List"}},
            {.name = "translations", // Of the toolkit, of the help and the program's own.
             .environment = german,
             .lines = "chmod 400 config/master",
             .shown = {"Abbrechen", "Dieser Reiter",
                       "\u00c4nderungen lassen sich nicht speichern: "},
             .unshown = {"Cancel"}},
            {.name = "no right to write",
             .lines = "chmod 400 config/master",
             .shown = {"Changes cannot be saved: "}},
            {.name = "keys of a locale with another i",
             .environment = {"LC_ALL=tr_TR.UTF-8", "LANGUAGE=en"},
             .shown = {"tab &IMAP"}}};
        for (const Case &row : cases) {
            layProduct(); // A new folder.
            QVERIFY(chdir(TEST_PRODUCT) == 0 && shell(row.lines));
            const QString wrong = firstWrong(row);
            QVERIFY2(wrong.isEmpty(), qPrintable(QString{row.name} + ": " + wrong));
            QVERIFY2(!QString{row.lines}.startsWith(':') ||
                         bytesAt(master) == given("applied/master"),
                     row.name);
        }
    }

    /// On a display that is not there; words with "=" are put into the environment. What comes out:
    /// the status, then the standard output, then that of errors, with "..." for what the toolkit
    /// says.
    void commandLine() {
        QProcess program;
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert("QT_QPA_PLATFORM", "xcb");
        environment.insert("DISPLAY", ":nowhere");
        program.setProcessEnvironment(environment);
        std::filesystem::remove(master);
        const auto outputOf = [&](const std::string &arguments) {
            QStringList words = QString::fromStdString(arguments).split(' ', Qt::SkipEmptyParts);
            words.insert(words.filter("=").size(), TEST_PROGRAM);
            program.start("env", words);
            const bool isEnded = program.waitForFinished() && program.exitStatus() == 0;
            QString output = program.readAllStandardOutput() + program.readAllStandardError();
            output.prepend(QString::number(program.exitCode()) + (isEnded ? " " : " died "));
            static const QRegularExpression toolkits{"(?s)(opened\n)[^\n]*(:nowhere|nonsense).+"};
            output.replace(master.c_str(), "MASTER").replace(toolkits, "\\1...");
            return output.toStdString();
        };
        checkRows(outputOf, "[command line]");
        QVERIFY(bytesAt(master) == "none");
    }
};

int main(int argc, char **argv) {
    if (!enterProduct()) {
        return 1;
    }
    TestStarted test;
    return QTest::qExec(&test, argc, argv);
}

#include "test_started.moc"
