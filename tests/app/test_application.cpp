#include "datafiles.h"
#include "dialogdriver.h"

#include "alias/aliasfile.h"
#include "app/ktarvexapplication.h"
#include "config/settings.h"
#include "platform/kconfigwidget.h"
#include "server/smtprejectfile.h"

#include <QScrollArea>
#include <QSpinBox>
#include <QTabWidget>
#include <QTextBrowser>

namespace fs = std::filesystem;

namespace {

const fs::path product{TEST_PRODUCT};
const fs::path master = product / "config/master";
const fs::path aliases = product / "config/alias";
const fs::path rejects = product / "config/reject";
const fs::path lists = product / "config/lists";
const fs::path runs = product / "runs"; ///< Has a line for each run of the command.

std::string read(const fs::path &path) { return bytesAt(path.string()); }

const std::string expectedFiles =
    given("applied/alias") + given("applied/reject") + given("applied/lists");

QTabWidget *tabs() { return anywhere<QTabWidget>(); }

QWidget *mainDialog() { return tabs()->window(); }

QTextBrowser *help() { return anywhere<QTextBrowser>(); }

QWidget *page(const char *name) { return mainDialog()->findChild<KConfigWidget *>(name); }

} // namespace

/// The whole program on a product tree of its own. The tests build on each other, in their order:
/// the application object is one, and so is what it holds in memory.
class TestApplication : public QObject {
    Q_OBJECT

private slots:
    void applyWithoutEditsKeepsEveryValue() {
        for (const char *ran : {"ran\n", "ran\nran\n"}) {
            press(mainDialog(), "Apply");
            QCOMPARE(read(master), given("applied/master"));
            QCOMPARE(read(aliases) + read(rejects) + read(lists), expectedFiles);
            QCOMPARE(read(runs), std::string{ran});
        }
    }

    void editsOfAllPagesAreWritten() {
        const std::string before = read(master);
        for (const char *server : {"smtpserver", "pop3server", "imapserver"}) {
            type(fieldBeside<QSpinBox>(page(server), "&Port:"), "1110");
        }
        type(fieldBeside<QSpinBox>(page("fetch"), "Poll time (s):"), "60");
        type(fieldBeside(page("debatch"), "&Local Domains:"), "a.example.com, b");
        QCOMPARE(read(master), before);
        press(mainDialog(), "Apply");
        QCOMPARE(read(master), given("applied/master.edited"));
    }

    void whatArrivesDuringAnApplyIsDropped() {
        layProduct();
        auto *apply = captioned(mainDialog(), &QAbstractButton::text, "Apply");
        for (const auto type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease}) {
            const QPoint centre = apply->rect().center();
            QCoreApplication::postEvent(apply,
                                        new QMouseEvent(type, centre, apply->mapToGlobal(centre),
                                                        Qt::LeftButton, Qt::LeftButton, {}));
        }
        for (const auto type : {QEvent::KeyPress, QEvent::KeyRelease}) {
            QCoreApplication::postEvent(apply, new QKeyEvent(type, Qt::Key_Space, {}));
        }
        tabs()->setFocus();
        apply->click();
        QCoreApplication::processEvents();
        QCOMPARE(read(runs), "ran\n");
        QVERIFY(!apply->hasFocus());
        press(mainDialog(), "Apply");
        QCOMPARE(read(runs), "ran\nran\n");
    }

    /// Whether it is marked as a repetition or not.
    void heldKeyPressesAButtonOnce() {
        tabs()->setCurrentIndex(5);
        auto *add = captioned(page("alias"), &QAbstractButton::text, "Add...");
        for (const auto &[key, isMarked] : {std::pair{Qt::Key_Return, true},
                                            {Qt::Key_Return, false},
                                            {Qt::Key_Space, false},
                                            {Qt::Key_Escape, true}}) {
            QKeyEvent release{QEvent::KeyRelease, key, {}};
            QKeyEvent again{QEvent::KeyPress, key, {}, {}, isMarked};
            release.setTimestamp(5);
            again.setTimestamp(isMarked ? 6 : 5);
            const auto send = [&] {
                QApplication::sendEvent(add, &release);
                QApplication::sendEvent(add, &again);
                QApplication::sendEvent(add, &release);
            };
            const bool isOpened = withDialog(send, [](QWidget *dialog) { dialog->close(); });
            QVERIFY2(!isOpened && mainDialog()->isVisible(),
                     qPrintable(QKeySequence{key}.toString() + (isMarked ? " marked" : "")));
        }
        QVERIFY(withDialog([&] { QTest::keyClick(add, Qt::Key_Return); },
                           [](QWidget *dialog) { dialog->close(); }));
        mainDialog()->activateWindow();
        QVERIFY(QTest::qWaitForWindowActive(mainDialog()));
    }

    void captionsLettersReachTheirFields() {
        for (int tab = 0; tab < tabs()->count(); ++tab) {
            tabs()->setCurrentIndex(tab);
            for (const QLabel *label : tabs()->widget(tab)->findChildren<QLabel *>()) {
                const QKeySequence letter = QKeySequence::mnemonic(label->text());
                // The second press comes from another field, as a user's would.
                for (int press = 0; !letter.isEmpty() && press < 2; ++press) {
                    tabs()->setFocus();
                    QTest::keySequence(mainDialog(), letter);
                    QCOMPARE(tabs()->currentIndex(), tab);
                    QVERIFY2(label->buddy()->hasFocus(), qPrintable(label->text()));
                }
            }
        }
        QTest::keyClick(mainDialog(), Qt::Key_S, Qt::AltModifier);
        QCOMPARE(tabs()->currentIndex(), 0);
    }

    void helpShowsThePageOrSaysThatItIsMissing() {
        const QStringList titles{"Mail List", "Aliasing", "Delivery", "Fetchers",
                                 "IMAP",      "POP3",     "SMTP"};
        for (const QString &title : titles) {
            tabs()->setCurrentIndex(6 - static_cast<int>(titles.indexOf(title)));
            QTest::keyClick(mainDialog(), Qt::Key_F1);
            QVERIFY(help() != nullptr && help()->isVisible());
            QCOMPARE(help()->window()->windowTitle(), title);
        }
        QVERIFY(help()->toPlainText().contains("smtp.sock.port"));
        const fs::path installed =
            KApplication::shared("kcmtarvex_mail/help/en/tarvex-mail-smtp.html").toStdString();
        fs::rename(installed, product / "away");
        press(mainDialog(), "Help");
        fs::rename(product / "away", installed);
        QVERIFY(help()->toPlainText().contains("\"tarvex-mail-smtp.html\" is not installed"));
    }

    void helpLeadsToHelpFilesOnly() {
        for (const auto &[link, title] : {std::pair{"tarvex-mail-imap.html", "IMAP"},
                                          {"tarvex-mail-smtp.html#access", "SMTP"},
                                          {"https://example.com/tarvex-mail-imap.html", "SMTP"},
                                          {"/etc/passwd", "SMTP"},
                                          {"../en/tarvex-mail-imap.html/", "SMTP"},
                                          {"nothing.html", "SMTP"}}) {
            help()->anchorClicked(help()->source().resolved(QUrl{link}));
            QVERIFY2(help()->window()->windowTitle() == title, link);
        }
        QCOMPARE(help()->source().fragment(), "access");
    }

    /// Clicks reach a window only where no modal dialog is in their way.
    void helpIsUsableWhileADialogIsOpen() {
        help()->window()->hide();
        tabs()->setCurrentIndex(5);
        QVERIFY(withDialog([] { press(page("alias"), "Add..."); },
                           [](QWidget *dialog) {
                               const auto isActive = [=] {
                                   return QApplication::activeWindow() == dialog;
                               };
                               QVERIFY(QTest::qWaitFor(isActive));
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

    void onlyOkApplies() {
        fs::remove(runs);
        for (const auto &[name, close] :
             {std::pair{"Cancel", +[] { press(mainDialog(), "Cancel"); }},
              {"Esc", +[] { QTest::keyClick(mainDialog(), Qt::Key_Escape); }},
              {"OK", +[] { press(mainDialog(), "OK"); }}}) {
            QVERIFY2(!fs::exists(runs), name);
            mainDialog()->show();
            help()->window()->show(); // Left open, it does not keep the program alive.
            QTimer::singleShot(0, close);
            QCoreApplication::exec();
            QVERIFY2(!mainDialog()->isVisible(), name);
        }
        QVERIFY(fs::exists(runs));
    }
};

int main(int argc, char **argv) {
    layProduct();
    int programArgumentCount = 1;
    KTarvexApplication application{programArgumentCount, argv, "kcmtarvex_mail"};
    application.setTitle("Tarvex Mail Config");
    TestApplication test;
    return QTest::qExec(&test, argc, argv);
}

#include "test_application.moc"
