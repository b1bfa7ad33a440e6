#include "dialogdriver.h"

#include "alias/aliasfile.h"
#include "app/ktarvexapplication.h"
#include "base/textfile.h"
#include "config/settings.h"
#include "lists/maillistfile.h"
#include "platform/kconfigwidget.h"
#include "server/smtprejectfile.h"

#include <QDialog>
#include <QProcess>
#include <QSpinBox>
#include <QTabWidget>
#include <QTextBrowser>

#include <clocale>
#include <filesystem>

namespace fs = std::filesystem;

namespace {

const fs::path product{TEST_PRODUCT};
const fs::path master = product / "config/master";
const fs::path aliases = product / "config/alias";
const fs::path rejects = product / "config/reject";
const fs::path lists = product / "config/lists";
const fs::path runs = product / "runs"; ///< What the command saw of the files, run by run.

void write(const fs::path &path, const std::string &bytes) {
    fs::create_directories(path.parent_path());
    rewriteFile(path, bytes);
}

std::string read(const fs::path &path) { return readWholeFile(path).value_or(""); }

std::string pathLine(const char *key, const fs::path &path) {
    return std::string{"%"} + key + ": " + path.string() + "\n";
}

std::string pathLines() {
    return pathLine("mail.file.alias", aliases) + pathLine("mail.file.smtpreject", rejects) +
           pathLine("mail.file.maillist", lists);
}

/// A product tree in which every file has something that an apply changes in form.
void layProduct() {
    fs::remove_all(product);
    write(master, "| kept by hand\n" + pathLines() +
                      "%smtp.sock.port:2525\n%smtp.allow: 10.0.0.0/8\n\t192.168.1.7\n"
                      "%pop.hosts: *ann:secret@pop.example.com\n\tbob:hidden@mail.example.net\n"
                      "%mail.from.force: Caf\xe9 <x@example.com>\n%smtp.time: 3600\n"
                      "%not.known: 1\n");
    write(product / "config/templates/master",
          "| template\n\n" + pathLine("mail.file.alias", "/dev/null") +
              pathLine("mail.file.smtpreject", "/dev/null") +
              pathLine("mail.file.maillist", "/dev/null") +
              "%SMTP.Sock.Port: 25\n%pop.sock.port: 110\n%smtp.allow:\n%pop.hosts:\n"
              "%mail.from.force:\n%smtp.time: 0\n%mail.domains: kept.example.com\n%not.known: 0\n");
    write(aliases, "# comment\nann  bob,#staff\n");
    write(rejects, "a.example.com\nb.example.com rest\n");
    write(lists, "#new\n%name:cyclists\n%flags:71\n#start member\nann@x\n:bob@x\n#end\n#endlist\n");
    write(product / "bin/tvxreconf",
          "#!/bin/sh\ncd '" + product.string() +
              "' && cat config/alias config/reject config/lists config/master >> runs\nexit 3\n");
    fs::permissions(product / "bin/tvxreconf", fs::perms::owner_all);
}

std::string expectedMaster(const std::string &popPort, const std::string &domains) {
    return "| template\n" + pathLines() + "%SMTP.Sock.Port: 2525\n%pop.sock.port: " + popPort +
           "\n%smtp.allow: 10.0.0.0/8\n\t 192.168.1.7/32\n"
           "%pop.hosts: *ann:secret@pop.example.com\n*bob:hidden@mail.example.net\n\n"
           "%mail.from.force: Caf\xe9 <x@example.com>\n%smtp.time: 3600\n" +
           "%mail.domains: " + domains + "\n%not.known: 0\n";
}

const std::string expectedAliases = "ann,bob,#staff\n";
const std::string expectedRejects = "b.example.com\na.example.com\n";
const std::string expectedLists =
    "#new\n%name:cyclists\n%post:\n%admin:\n%support:\n%info:\n%footer:\n%header:\n%modrt:\n"
    "%info:\n%diglen:0\n%digno:0\n%digcnt:0\n%digcur:0\n%flags:71\n"
    "#start member\n:bob@x\nann@x\n#end\n#start allow\n#end\n#start block\n#end\n#endlist\n\n\n";

QDialog *mainDialog() {
    for (QWidget *widget : QApplication::topLevelWidgets()) {
        if (widget->findChild<QTabWidget *>() != nullptr) {
            return qobject_cast<QDialog *>(widget);
        }
    }
    return nullptr;
}

/// Where the help is shown; null until it was asked for.
QTextBrowser *help() {
    for (QWidget *widget : QApplication::topLevelWidgets()) {
        if (auto *browser = widget->findChild<QTextBrowser *>()) {
            return browser;
        }
    }
    return nullptr;
}

QWidget *page(const char *name) { return mainDialog()->findChild<KConfigWidget *>(name); }

} // namespace

/// The whole program on a product tree of its own. The tests build on each other, in their order:
/// the application object is one, and so is what it holds in memory.
class TestApplication : public QObject {
    Q_OBJECT

public:
    explicit TestApplication(KTarvexApplication &application) : application_{application} {}

private slots:
    void startsWithAllTabs() {
        auto *tabs = mainDialog()->findChild<QTabWidget *>();
        QStringList labels;
        for (int tab = 0; tab < tabs->count(); ++tab) {
            labels << tabs->tabText(tab) + '=' + tabs->widget(tab)->objectName();
        }
        QCOMPARE(labels.join(' '),
                 QStringLiteral("&SMTP=smtpserver &POP3=pop3server &IMAP=imapserver Fetchers=fetch "
                                "&Delivery=debatch &Aliasing=alias &Mail List=list"));
        QVERIFY(QTest::qWaitForWindowActive(mainDialog()));
        QCOMPARE(mainDialog()->windowTitle(), QStringLiteral("Tarvex Mail Config"));
        QVERIFY(!fs::exists(runs));
    }

    void tabLetterShowsItsTab() {
        QTest::keyClick(mainDialog(), Qt::Key_D, Qt::AltModifier);
        QCOMPARE(mainDialog()->findChild<QTabWidget *>()->currentIndex(), 4);
    }

    void applyWithoutEditsKeepsEveryValue() {
        press(mainDialog(), "Apply");
        QCOMPARE(read(master), expectedMaster("110", "kept.example.com"));
        QCOMPARE(read(aliases), expectedAliases);
        QCOMPARE(read(rejects) + read(lists), expectedRejects + expectedLists);
    }

    void commandRunsOnceAfterAllFilesWhateverItReturns() {
        const std::string seen = expectedAliases + expectedRejects + expectedLists +
                                 expectedMaster("110", "kept.example.com");
        QCOMPARE(read(runs), seen);
        press(mainDialog(), "Apply");
        QCOMPARE(read(runs), seen + seen); // The second apply changed no byte more.
    }

    void editsReachTheirSettingsOnly() {
        type(fieldBeside<QSpinBox>(page("pop3server"), "&Port:"), "1110");
        type(fieldBeside(page("debatch"), "&Local Domains:"), "a.example.com, b");
        QCOMPARE(read(master), expectedMaster("110", "kept.example.com"));
        press(mainDialog(), "Apply");
        QCOMPARE(read(master), expectedMaster("1110", "a.example.com\n\t b"));
    }

    /// Two files behind one path: what stands there after an apply is the later one's.
    void filesAreWrittenInOrder_data() {
        QTest::addColumn<QString>("first");
        QTest::addColumn<QString>("second");
        QTest::addColumn<QString>("written");
        QTest::newRow("alias, reject") << "mail.file.alias"
                                       << "mail.file.smtpreject"
                                       << "b.exa";
        QTest::newRow("reject, list") << "mail.file.smtpreject"
                                      << "mail.file.maillist"
                                      << "#new\n";
        QTest::newRow("list, alias") << "mail.file.alias"
                                     << "mail.file.maillist"
                                     << "#new\n";
    }

    void filesAreWrittenInOrder() {
        QFETCH(QString, first);
        QFETCH(QString, second);
        QFETCH(QString, written);
        const fs::path shared = product / "config/shared";
        const auto firstPath = settingByKey(first.toStdString(), std::nullopt);
        const auto secondPath = settingByKey(second.toStdString(), std::nullopt);
        settingByKey(first.toStdString(), shared.string());
        settingByKey(second.toStdString(), shared.string());
        application_.applyChanges();
        QCOMPARE(read(shared).substr(0, 5), written.toStdString());
        settingByKey(first.toStdString(), *firstPath);
        settingByKey(second.toStdString(), *secondPath);
    }

    void masterIsWrittenLast() {
        settings().mail_file_maillist.value = master.string();
        application_.applyChanges();
        QVERIFY(read(master).starts_with("| template\n"));
        settings().mail_file_maillist.value = lists.string();
    }

    void failedWritesStopNothing() {
        fs::remove(aliases);
        fs::create_directory(aliases);
        fs::remove(rejects);
        fs::create_symlink("/dev/full", rejects);
        write(product / "bin/tvxreconf", "#!/bin/sh\necho ran > '" + runs.string() + "'\n");
        settings().mail_file_maillist.value.reset();
        fs::remove(runs);
        write(master, "");
        press(mainDialog(), "Apply");
        QVERIFY(fs::is_directory(aliases));
        QVERIFY(read(master).starts_with("| template\n"));
        QVERIFY(fs::exists(runs));
        QVERIFY(mainDialog()->isVisible());
        QCOMPARE(smtpreject_list.head->domain, std::string{"b.example.com"});
        QCOMPARE(alias_list.head->address, std::string{"ann"});
    }

    void captionsLettersReachTheirFields() {
        auto *tabs = mainDialog()->findChild<QTabWidget *>();
        QStringList pressed;
        for (int tab = 0; tab < tabs->count(); ++tab) {
            tabs->setCurrentIndex(tab);
            for (const QLabel *label : tabs->widget(tab)->findChildren<QLabel *>()) {
                const QKeySequence letter = QKeySequence::mnemonic(label->text());
                // The second press comes from another field, as a user's would.
                for (int press = 0; !letter.isEmpty() && press < 2; ++press) {
                    tabs->setFocus();
                    QTest::keySequence(mainDialog(), letter);
                    QCOMPARE(tabs->currentIndex(), tab);
                    QVERIFY2(label->buddy()->hasFocus(), qPrintable(label->text()));
                    pressed << letter.toString();
                }
            }
        }
        QCOMPARE(pressed.size(), 2 * (6 + 5 + 5 + 7));
        QTest::keyClick(mainDialog(), Qt::Key_S, Qt::AltModifier);
        QCOMPARE(tabs->currentIndex(), 0);
    }

    void helpShowsThePageOrSaysThatItIsMissing() {
        mainDialog()->findChild<QTabWidget *>()->setCurrentIndex(1);
        QTest::keyClick(mainDialog(), Qt::Key_F1);
        QVERIFY(help() != nullptr && help()->isVisible());
        QVERIFY(help()->toPlainText().contains("pop.sock.port"));
        QCOMPARE(help()->window()->windowTitle(), "POP3");
        const QString file = KApplication::shared("kcmtarvex_mail/help/en/tarvex-mail-pop3.html");
        const fs::path installed = file.toStdString();
        fs::rename(installed, product / "away");
        press(mainDialog(), "Help");
        fs::rename(product / "away", installed);
        QVERIFY(help()->toPlainText().contains("\"tarvex-mail-pop3.html\" is not installed"));
    }

    void helpLeadsToHelpFilesOnly() {
        using Case = std::pair<const char *, const char *>;
        for (const auto &[link, title] :
             std::initializer_list<Case>{{"tarvex-mail-imap.html", "IMAP"},
                                         {"tarvex-mail-smtp.html#access", "SMTP"},
                                         {"https://example.com/tarvex-mail-imap.html", "SMTP"},
                                         {"/etc/passwd", "SMTP"},
                                         {"../en/tarvex-mail-imap.html/", "SMTP"},
                                         {"nothing.html", "SMTP"}}) {
            emit help()->anchorClicked(help()->source().resolved(QUrl{link}));
            QCOMPARE(help()->window()->windowTitle(), title);
        }
    }

    /// Clicks reach a window only where no modal dialog is in their way.
    void helpIsUsableWhileADialogIsOpen() {
        help()->window()->hide();
        mainDialog()->findChild<QTabWidget *>()->setCurrentIndex(5);
        QVERIFY(withDialog([] { press(page("alias"), "Add..."); },
                           [](QWidget *dialog) {
                               QTRY_COMPARE(QApplication::activeWindow(), dialog);
                               QTest::keyClick(dialog, Qt::Key_F1);
                               QVERIFY(help()->isVisible());
                               QCOMPARE(help()->window()->windowTitle(), "Aliasing");
                               const QWidget *close =
                                   captioned(help()->window(), &QAbstractButton::text, "Close");
                               QTest::mouseClick(help()->window()->windowHandle(), Qt::LeftButton,
                                                 {}, close->geometry().center());
                               QVERIFY(!help()->isVisible());
                               press(dialog, "Cancel");
                           }));
    }

    void cancelAndEscapeWriteNothing() {
        fs::remove(runs);
        press(mainDialog(), "Cancel");
        QVERIFY(!mainDialog()->isVisible());
        mainDialog()->show();
        QTest::keyClick(mainDialog(), Qt::Key_Escape);
        QVERIFY(!mainDialog()->isVisible());
        QVERIFY(!fs::exists(runs));
    }

    void okAppliesAndCloses() {
        mainDialog()->show();
        press(mainDialog(), "OK");
        QVERIFY(!mainDialog()->isVisible());
        QVERIFY(fs::exists(runs));
    }

    void captionsAreTranslated() {
        std::setlocale(LC_ALL, "C.UTF-8");
        qputenv("LANGUAGE", "de");
        QCOMPARE(KApplication::getLocale()->translate("&Password:"), QStringLiteral("&Kennwort:"));
        qunsetenv("LANGUAGE");
    }

    void commandLine_data() {
        QTest::addColumn<QStringList>("arguments");
        QTest::addColumn<int>("status");
        QTest::addColumn<QString>("output"); ///< Standard output, then standard error.
        const QString noMaster =
            QStringLiteral("Couldn't open config file:%1\n").arg(master.string().c_str());
        const QString names = "smtpserver, pop3server, imapserver, fetch, debatch, alias, list";
        QTest::newRow("init-only") << QStringList{"-init"} << 0 << noMaster;
        QTest::newRow("init-only, two dashes") << QStringList{"--init", "alias"} << 0 << noMaster;
        QTest::newRow("unknown page")
            << QStringList{"-init", "alias", "smtp"} << 2
            << "kcmtarvex_mail: unknown page \"smtp\"; the pages are " + names + "\n";
        QTest::newRow("unknown option")
            << QStringList{"-init", "-x"} << 2 << "kcmtarvex_mail: Unknown option 'x'.\n";
        QTest::newRow("version") << QStringList{"-v"} << 0 << "kcmtarvex_mail 1.0.0\n";
        QTest::newRow("no display")
            << QStringList{} << 1 << "kcmtarvex_mail: no display can be opened\n";
    }

    /// On a display that is not there.
    void commandLine() {
        QFETCH(QStringList, arguments);
        QFETCH(int, status);
        QFETCH(QString, output);
        fs::remove(master);
        QProcess program;
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert("QT_QPA_PLATFORM", "xcb");
        environment.insert("DISPLAY", ":nowhere");
        program.setProcessEnvironment(environment);
        program.start(TEST_PROGRAM, arguments);
        QVERIFY(program.waitForFinished());
        QCOMPARE(program.exitStatus(), QProcess::NormalExit);
        QCOMPARE(program.exitCode(), status);
        QCOMPARE(
            QString::fromUtf8(program.readAllStandardOutput() + program.readAllStandardError()),
            output);
        QVERIFY(!fs::exists(master));
    }

private:
    KTarvexApplication &application_;
};

int main(int argc, char **argv) {
    layProduct();
    int programArgumentCount = 1;
    KTarvexApplication application{programArgumentCount, argv, "kcmtarvex_mail"};
    application.setTitle("Tarvex Mail Config");
    TestApplication test{application};
    return QTest::qExec(&test, argc, argv);
}

#include "test_application.moc"
