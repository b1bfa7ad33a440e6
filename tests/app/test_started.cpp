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

/// What is done to a product of which nothing is lost, and the line above the buttons; then again,
/// before an apply and after it.
struct NoteRow {
    const char *lines, *note;
    const char *later = ":", *noteAfterApply = "";
};
constexpr const char *noFile = "Aliases will not be saved: no file is set. Blocked domains "
                               "will not be saved: no file is set. Mailing lists will not "
                               "be saved: no file is set.";
constexpr const char *noTemplate = "Settings will not be saved: there is no template.";
const NoteRow noteRows[]{
    {":", ""},
    {"rm config/master", noFile, ":", noFile},
    {"sed -i '/file.alias/s/:.*/:/' config/master", "Aliases will not be saved: no file is set.",
     ":", "Aliases will not be saved: no file is set."},
    {"chmod 200 config/alias; rm config/lists; mkdir config/lists",
     "Aliases will not be saved: the file could not be read. "
     "Mailing lists will not be saved: the file could not be read.",
     "chmod 600 config/alias",
     "Aliases will not be saved: the file could not be read. "
     "Mailing lists will not be saved: the file could not be read."},
    {"sed -i s:config/reject:none/x: config/master; ln -sf none/lists config/lists",
     "Blocked domains will not be saved: there is no such folder. "
     "Mailing lists will not be saved: there is no such folder.",
     "mkdir none config/none"},
    {"chmod 400 config/reject config/master; mkdir shut; ln -sf ../shut/x config/alias; "
     "chmod 500 shut",
     "Settings will not be saved: the file may not be written. "
     "Aliases will not be saved: the file may not be written. "
     "Blocked domains will not be saved: the file may not be written.",
     "chmod 600 config/reject config/master; chmod 700 shut"},
    {"rm config/templates/master; echo '%x: 1' >>config/master", noTemplate, ":", noTemplate},
    {"rm config/alias; echo x >>config/reject", ""},
    {"rm config/lists", "", "echo kept >config/lists",
     "Mailing lists will not be saved: the file appeared meanwhile."},
    {"printf '%%a: 1\\n%%B:\\n%%not.known:0 \\n%%mail.domains: a\\rb\\n' >>config/master",
     "An apply will drop: settings that cannot be kept (a, B, mail.domains)."},
    {"printf '%%x: 0\\n%%X: 1\\n\\t2\\n%%smtp.allow: x\\n%%SMTP.allow: all' >>config/master; "
     "echo '%X: 1, 2' >>config/templates/master",
     ""},
    {"printf '%%not.known: 2\\n%%c:\\n%%d:\\n%%e:\\n' >>config/master; "
     "sed -i '/smtp.time/s/:.*//' config/templates/master",
     "An apply will drop: settings that cannot be kept (c, d, e, ...).", ":", ""},
    {"printf '%%smtp.allow: 10.0.0.0/12\\n%%pop.block: x\\n' >>config/master; "
     "printf '%%pop.block:\\n' >>config/templates/master",
     "An apply will drop: items of pop.block, items of smtp.allow."},
    {"printf '%%pop.hosts:a:b@c\\n\\tx\\n' >>config/master; echo '# c' | tee -a "
     "config/alias "
     "config/reject >>config/lists",
     "An apply will drop: fetchers that cannot be read (1), lines of the alias file (1), "
     "lines of the reject file (1), lines of the mailing-list file (1)."}};

QString noteOf(const Program &program) {
    const QString texts =
        program.does('t') ? QString::fromStdString(bytesAt("texts")) : "note hangs";
    return texts.section("note ", 1, 1).section('\n', 0, 0);
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
             .unshown = {"note Settings"}},
            {.name = "no bus for root",
             .environment = {"DBUS_SESSION_BUS_ADDRESS="},
             .shown = {geteuid() == 0 ? "bus disabled:" : "bus "}},
            {.name = "a bus that is given",
             .environment = {"DBUS_SESSION_BUS_ADDRESS=unix:path=/none"},
             .shown = {"bus unix:path=/none"}},
            {.name = "two pages",
             .pages = {"alias", "fetch"},
             .shown = {"tab Fetchers", "tab &Aliasing"},
             .unshown = {"tab &SMTP", "tab &POP3", "tab &IMAP", "tab &Delivery", "tab &Mail List"}},
            {.name = "translations", // Of the toolkit, of the help and the program's own.
             .environment = german,
             .lines = "rm config/templates/master",
             .shown = {"Abbrechen", "Dieser Reiter", "note Die Einstellungen werden nicht"},
             .unshown = {"Cancel"}},
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

    void lineAboveTheButtons() {
        for (const auto &[lines, note, later, noteAfterApply] : noteRows) {
            layProduct();
            QVERIFY(chdir(TEST_PRODUCT) == 0 &&
                    shell(": >config/alias; : >config/reject; sed -i /not.known/d config/master"));
            QVERIFY2(shell(lines), lines);
            const Program program;
            QVERIFY(program.isReady());
            QCOMPARE(noteOf(program), QString{note});
            QVERIFY(!QString{note}.contains("...") ||
                    bytesAt("texts").find("(c, d, e, not.known, smtp.time)") != std::string::npos);
            QVERIFY2(shell(later) && program.applies(), lines);
            QCOMPARE(noteOf(program), QString{noteAfterApply});
        }
        QCOMPARE(bytesAt("config/lists").substr(0, 4), "#new");
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
