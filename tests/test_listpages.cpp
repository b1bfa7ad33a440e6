#include "alias/aliasfile.h"
#include "alias/editaliasentry.h"
#include "alias/mailalias.h"
#include "config/settings.h"
#include "fetch/mailfetch.h"
#include "fetch/pophosts.h"
#include "lists/listload.h"
#include "lists/maillist.h"
#include "lists/maillistfile.h"
#include "server/mailsmtp.h"
#include "server/smtprejectfile.h"

#include "dialogdriver.h"

#include <QComboBox>
#include <QFileDialog>
#include <QGroupBox>
#include <QMessageBox>
#include <QTemporaryDir>
#include <QTemporaryFile>

#include <memory>

namespace {

template <class Record, class Field>
QString joined(const RecordChain<Record> &records, Field field) {
    QStringList texts;
    for (const Record &record : records) {
        texts << textFromBytes((record.*field).data());
    }
    return texts.join('|');
}

template <class Page>
std::unique_ptr<KConfigWidget> shownPage() {
    auto page = std::make_unique<Page>(nullptr, "page");
    page->show();
    return page;
}

/// Types into a field of the dialog and closes it.
auto answer(const char *field, const QString &text, const char *with = "OK") {
    return [=](QWidget *dialog) {
        type(fieldBeside(dialog, field), text);
        press(dialog, with);
    };
}

/// Presses a button and answers the dialog that it opens.
void act(const QWidget *window, const char *button, const char *field, const QString &text,
         const char *with = "OK") {
    QVERIFY(withDialog([&] { press(window, button); }, answer(field, text, with)));
}

QListBox *boxIn(const QWidget *window) { return window->findChild<QListBox *>(); }

/// Opens the dialog of the first row.
template <class Use>
[[nodiscard]] bool withFirst(const QWidget *window, Use use) {
    return withDialog([&] { doubleClickRow(boxIn(window), 0); }, use);
}

/// `caption` stands beside the field that the rows show. A new row stands at the bottom, its record
/// at the head; of equal texts the first record is meant.
template <class Page, auto &chain, auto field>
void editRows(const char *caption) {
    const auto page = shownPage<Page>();
    QListBox *box = boxIn(page.get());
    for (const char *text : {"x", "a", "x", "x", "b"}) {
        act(page.get(), "Add...", caption, text);
    }
    press(page.get(), "Remove"); // There is no current row yet.
    QVERIFY(!withDialog([&] { press(page.get(), "Modify..."); }, [](QWidget *) {}));
    box->setCurrentRow(1);
    act(page.get(), "Add...", caption, "no", "Cancel");
    act(page.get(), "Modify...", caption, "no", "Cancel");
    const auto state = [box] { return rowsOf(box) + ";" + joined(chain, field); };
    QCOMPARE(state(), "x|a|x|x|b;b|x|x|a|x");
    const auto byKeys = [&](QWidget *dialog) {
        QLineEdit *edit = fieldBeside(dialog, caption);
        QCOMPARE(edit->text(), "a");
        type(edit, "");
        QTest::keyClick(edit, Qt::Key_Return);
    };
    QVERIFY(withDialog([&] { QTest::keyClick(box, Qt::Key_Return); }, byKeys));
    box->setCurrentRow(2);
    act(page.get(), "Modify...", caption, "y");
    QCOMPARE(state(), "x||y|x|b;b|y|x||x");
    QCOMPARE(rowsOf(boxIn(shownPage<Page>().get())), "b|y|x||x");
    box->setCurrentRow(3);
    for (const char *left : {"x||y|b;b|y||x", "x||y;y||x", "x|;|x", "x;x", ";", ";"}) {
        press(page.get(), "Remove");
        QCOMPARE(state(), left);
    }
}

constexpr std::array<const char *, 9> textLines{
    "%name:&Mail list Name:",     "%post:&Posting Address:",    "%admin:&Subscribe Address:",
    "%support:&Support Address:", "%info:&Info file:",          "%footer:&Footer file:",
    "%header:&Header file:",      "%modrt:&Moderator Address:", "%info:&Info file:"};

/// A list in its file. Its texts are the captions of their fields, behind a prefix.
std::string block(const QByteArray &prefix, const QByteArray &numbers, const QByteArray &members) {
    QByteArray text = "#new\n";
    for (const QByteArray line : textLines) {
        text += QByteArray{line}.replace('&', prefix + '&') + '\n';
    }
    text += numbers + "%digcnt:7\n%digcur:8\n%flags:71\n#start member\n" + members +
            "#end\n#start allow\n:al\n#end\n#start block\nbl\n#end\n#endlist\n\n\n";
    return text.toStdString();
}

/// The lists are one list; its editor is open while `use` runs. Reading turns the members round.
template <class Use>
[[nodiscard]] bool withEditor(const QByteArray &members, Use use) {
    maillist_list.clear();
    parseMailLists(block("", "%diglen:5000\n%digno:-3\n", members), maillist_list);
    return withFirst(shownPage<MailList>().get(), use);
}

/// The addresses of the record.
QString stored() {
    const auto addr = &maillist_addr_entry::addr;
    const maillist_entry &list = *maillist_list.head;
    return joined(list.member, addr) + ";" + joined(list.allow, addr) + ";" +
           joined(list.block, addr);
}

} // namespace

class TestListPages : public QObject {
    Q_OBJECT

private slots:
    void domains() { editRows<MailSMTP, smtpreject_list, &smtpreject_entry::domain>("&Address:"); }
    void fetchers() { editRows<MailFetch, pop_host_list, &pop_host::user>("&Username:"); }
    void aliases() { editRows<MailAlias, alias_list, &alias_entry::address>("&Address:"); }
    void lists() { editRows<MailList, maillist_list, &maillist_entry::name>("&Mail list Name:"); }

    void fetchersAreStored() {
        settings().pop_time.value = 3600;
        parsePopHosts("-ann:secret@pop.example.com");
        const auto page = shownPage<MailFetch>();
        QVERIFY(withFirst(page.get(), answer("&Server:", "mail.example.net")));
        page->storeValues();
        QCOMPARE(settings().pop_hosts.value, "-*ann:secret@mail.example.net\n");
        QCOMPARE(settings().pop_time.value, 3600);
    }

    void aliasTargets() {
        struct Case {
            const char *line;
            const char *type;
            const char *chosen;
            const char *closing;
            const char *after;
        };
        for (const Case &test : std::initializer_list<Case>{
                 {"a,!ann,cy\n", "Address", "Mailing List Admin", "OK", "a,new@x,!#bob\n"},
                 {"a,#ann,cy\n", "Mailing List Admin", "Address", "OK", "a,new@x,bob\n"},
                 {"a,!#ann,cy\n", "Mailing List Admin", "Auto Responder", "OK", "a,new@x,!#bob\n"},
                 {"a,#$ann,cy\n", "Mailing List Admin", "Address", "Cancel", "a,#$ann,cy\n"},
                 {"a,$n,cy\n", "Mailing List Posting", "External Task", "OK", "a,new@x,bob\n"}}) {
            alias_list.clear();
            parseAliases(test.line, alias_list);
            QVERIFY(withFirst(shownPage<MailAlias>().get(), [&](QWidget *dialog) {
                QVERIFY(withFirst(dialog, [&](QWidget *target) {
                    auto *types = fieldBeside<QComboBox>(target, "Alias Type:");
                    QCOMPARE(types->currentText(), test.type);
                    types->setCurrentText(test.chosen);
                    answer("&Alias:", "bob")(target);
                }));
                act(dialog, "Add...", "&Alias:", "new@x");
                boxIn(dialog)->setCurrentRow(1);
                press(dialog, "Remove");
                QCOMPARE(rowsOf(boxIn(dialog)), "bob|new@x");
                QCOMPARE(formatAliases(alias_list), test.line);
                press(dialog, test.closing);
            }));
            QCOMPARE(formatAliases(alias_list), test.after);
        }
    }

    void listFields() {
        const std::string unchanged = block("", "%diglen:5000\n%digno:-3\n", ":ann\n");
        QVERIFY(withEditor(":ann\n", [](QWidget *editor) { press(editor, "OK"); }));
        QCOMPARE(formatMailLists(maillist_list), unchanged);
        QVERIFY(withEditor(":ann\n", [&](QWidget *editor) {
            for (const QString line : textLines) {
                const QString caption = line.mid(line.indexOf('&'));
                type(fieldBeside(editor, caption), "new " + caption);
            }
            type(fieldBeside<QWidget>(editor, "Digest size trigger:"), "1024");
            type(fieldBeside<QWidget>(editor, "Digest count trigger:"), "1025");
            QCOMPARE(formatMailLists(maillist_list), unchanged);
            press(editor, "OK");
        }));
        QCOMPARE(formatMailLists(maillist_list),
                 block("new ", "%diglen:1024\n%digno:102\n", ":ann\n"));
    }

    void listOptions() {
        for (const auto &[caption, flags] :
             {std::pair{"Allow posting from any address (open list)", 69U},
              {"Allow posting by members", 67},
              {"Add reply-to header", 79},
              {"Block posts containing MIME attachments", 103},
              {"Allow digest subscriptions", 87}}) {
            QVERIFY(withEditor("", [caption = caption](QWidget *editor) {
                press(editor, caption);
                press(editor, "OK");
            }));
            QCOMPARE(maillist_list.head->flags, flags);
        }
        maillist_list.clear();
        act(shownPage<MailList>().get(), "Add...", "&Mail list Name:", "new");
        QCOMPARE(maillist_list.head->flags, 2U + 4U + 8U + 16U + 32U);
    }

    /// Members ann and cy: ann is changed, one is added, cy is removed.
    void addressLists() {
        struct Case {
            const char *members;
            bool isDigestPressed;
            const char *button;
            const char *after;
        };
        for (const Case &test : std::initializer_list<Case>{
                 {"cy\nann\n", false, "OK", "x|annx;Allowed Posters|:B;Blocked Posters|:B"},
                 {"cy\nann\n", true, "OK", ":x|:annx;Allowed Posters|:B;Blocked Posters|:B"},
                 {":cy\n:ann\n", false, "OK", "x|:annx;Allowed Posters|:B;Blocked Posters|:B"},
                 {":cy\n:ann\n", true, "OK", ":x|annx;Allowed Posters|:B;Blocked Posters|:B"},
                 {":cy\nann\n", true, "Cancel", "ann|:cy;:al;bl"}}) {
            QVERIFY(withEditor(test.members, [&](QWidget *editor) {
                const QGroupBox *members = captioned(editor, &QGroupBox::title, "List Members");
                const auto member = [&](QWidget *dialog) {
                    if (test.isDigestPressed) {
                        press(dialog, "Digest List");
                    }
                    answer("&Email:", fieldBeside(dialog, "&Email:")->text() + "x")(dialog);
                };
                QVERIFY(withFirst(members, member));
                QVERIFY(withDialog([&] { press(members, "Add..."); }, member));
                boxIn(members)->setCurrentRow(1);
                press(members, "Remove");
                QCOMPARE(rowsOf(boxIn(members)), "annx|x");
                for (const char *title : {"Allowed Posters", "Blocked Posters"}) {
                    const QGroupBox *posters = captioned(editor, &QGroupBox::title, title);
                    act(posters, "Add...", "&Email:", title);
                    QVERIFY(withFirst(posters, answer("&Email:", ":B")));
                }
                press(editor, test.button);
            }));
            QCOMPARE(stored(), test.after);
        }
    }

    /// The choosers begin in the folder that the field names.
    void browse() {
        const QTemporaryDir folder;
        QDir{folder.path()}.mkdir("in");
        QFile file{folder.filePath("in/file")};
        QVERIFY(file.open(QIODevice::WriteOnly));
        const EditAliasEntry target{nullptr, "edit", nullptr};
        const ListLoad load{nullptr, "load"};
        using Case = std::tuple<const QDialog *, const char *, QString, const char *>;
        for (const auto &[dialog, caption, chosen, name] :
             {Case{&target, "&Alias:", "in", "browse"},
              Case{&load, "&Filename:", "in/file", "QFileDialog"}}) {
            QLineEdit *field = fieldBeside(dialog, caption);
            field->setText(folder.path());
            for (const bool isAccepted : {false, true}) {
                QVERIFY(withDialog([&] { press(dialog, "Browse..."); },
                                   [&](QWidget *window) {
                                       auto *chooser = qobject_cast<QFileDialog *>(window);
                                       QCOMPARE(chooser->objectName(), name);
                                       QVERIFY(
                                           chooser->directory().path().startsWith(folder.path()));
                                       chooser->selectFile(folder.filePath(chosen));
                                       static_cast<QDialog *>(chooser)->done(isAccepted ? 1 : 0);
                                   }));
                QCOMPARE(field->text(), isAccepted ? folder.filePath(chosen) : folder.path());
            }
        }
    }

    /// Among the members, in the first group; each from the row that the one before found.
    void search() {
        QVERIFY(withEditor("hannah\nANN\nbob\n:ann\n", [](QWidget *editor) {
            QStringList found;
            for (const char *needle : {":", "a.n", "ann", "ann", "ann", "zoe", ""}) {
                act(editor, "Search...", "&Search for:", needle);
                found << QString::number(boxIn(editor)->currentRow().value_or(-1));
            }
            QCOMPARE(found.join(' '), "-1 -1 0 3 0 0 1");
            press(editor, "OK");
        }));
    }

    void load() {
        QTemporaryFile file;
        QVERIFY(file.open());
        file.write("c@x\nnot an address\n d@x \r\nc@x\n\n:\xff@x");
        file.close();
        QVERIFY(withEditor("ann\n", [&](QWidget *editor) {
            // The message comes when the dialog has gone: it is waited for beside it.
            QString message;
            QTimer confirm;
            connect(&confirm, &QTimer::timeout, [&] {
                if (auto *box = qobject_cast<QMessageBox *>(QApplication::activeModalWidget())) {
                    message += box->windowTitle() + "|" + box->text();
                    box->accept();
                }
            });
            confirm.start(0);
            act(editor, "Load File", "&Filename:", "/no/such/file");
            act(editor, "Load File", "&Filename:", file.fileName());
            QCOMPARE(message, "Mailling List Manager|Could not open file for reading - "
                              "perhaps permission denied?.\n\n");
            QCOMPARE(rowsOf(boxIn(editor)), textFromBytes("ann|c@x| d@x |c@x|:\xff@x"));
            press(editor, "OK");
        }));
        QCOMPARE(stored(), textFromBytes(":\xff@x|c@x| d@x |c@x|ann;:al;bl"));
    }
};

QTEST_MAIN(TestListPages)
#include "test_listpages.moc"
