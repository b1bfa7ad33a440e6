#include "alias/aliasfile.h"
#include "config/settings.h"
#include "fetch/pophosts.h"
#include "server/smtprejectfile.h"

#include "datafiles.h"
#include "dialogdriver.h"
#include "windows.h"

#include <QComboBox>
#include <QFileDialog>
#include <QGroupBox>
#include <QMessageBox>
#include <QTemporaryDir>
#include <QTemporaryFile>
#include <QToolTip>

#include <memory>

namespace {

template <class Record, class Field>
QString joined(const RecordChain<Record> &records, Field field) {
    QStringList texts;
    for (const Record &record : records) {
        if constexpr (std::is_same_v<decltype(record.*field), const KeptText &>) {
            texts << textFromBytes(record.*field);
        } else {
            texts << textFromBytes((record.*field).data());
        }
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
void withFirst(const QWidget *window, const Use &use) {
    QVERIFY(withDialog([&] { doubleClickRow(boxIn(window), 0); }, use));
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

/// A list in its file. Its texts are the captions of their fields, behind a prefix.
std::string block(const QByteArray &prefix, const QByteArray &numbers, const QByteArray &members) {
    QByteArray text = QByteArray::fromStdString(bytesAt(TEST_DATA "/list.txt"));
    text.replace("&", prefix + '&').replace("@numbers\n", numbers).replace("@members\n", members);
    return text.toStdString();
}

/// The lists are one list; its editor is open while `use` runs, and ends with `closing`. Reading
/// turns the members round.
template <class Use>
void withEditor(const QByteArray &members, Use use, const char *closing = "OK") {
    maillist_list.clear();
    parseMailLists(keep(block("", "%diglen:5000\n%digno:-3\n", members)), maillist_list);
    withFirst(shownPage<MailList>().get(), [&](QWidget *editor) {
        use(editor);
        press(editor, closing);
    });
}

QString joined(const AddressChain &addresses) {
    return joined(addresses, &maillist_addr_entry::addr);
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
        for (const auto &[caption, stored] : {std::pair{"&Server:", "-*ann:secret@new\n"},
                                              {"&Username:", "-*new:secret@pop.example.com\n"},
                                              {"&Password:", "-*ann:new@pop.example.com\n"}}) {
            parsePopHosts("-ann:secret@pop.example.com");
            const auto page = shownPage<MailFetch>();
            withFirst(page.get(), answer(caption, "new"));
            page->storeValues();
            QCOMPARE(settings().pop_hosts.value, stored);
            QCOMPARE(settings().pop_time.value, 3600);
        }
    }

    void aliasTargets() {
        struct Case {
            const char *line, *type, *chosen, *closing, *after;
        };
        for (const Case &row :
             {Case{"a,!ann,cy\n", "Address", "Mailing List Admin", "OK", "a,new@x,!#bob\n"},
              {"a,#ann,cy\n", "Mailing List Admin", "Address", "OK", "a,new@x,bob\n"},
              {"a,!#ann,cy\n", "Mailing List Admin", "Auto Responder", "OK", "a,new@x,!#bob\n"},
              {"a,#$ann,cy\n", "Mailing List Admin", "Address", "Cancel", "a,#$ann,cy\n"},
              {"a,$n,cy\n", "Mailing List Posting", "External Task", "OK", "a,new@x,bob\n"}}) {
            alias_list.clear();
            parseAliases(keep(row.line), alias_list);
            withFirst(shownPage<MailAlias>().get(), [&](QWidget *dialog) {
                withFirst(dialog, [&](QWidget *target) {
                    auto *types = fieldBeside<QComboBox>(target, "Alias Type:");
                    QCOMPARE(types->currentText(), row.type);
                    types->setCurrentText(row.chosen);
                    answer("&Alias:", "bob")(target);
                });
                act(dialog, "Add...", "&Alias:", "new@x");
                boxIn(dialog)->setCurrentRow(1);
                press(dialog, "Remove");
                QCOMPARE(rowsOf(boxIn(dialog)), "bob|new@x");
                QCOMPARE(whole(formatAliases, alias_list), row.line);
                press(dialog, row.closing);
            });
            QCOMPARE(whole(formatAliases, alias_list), row.after);
        }
    }

    void listFields() {
        const std::string unchanged = block("", "%diglen:5000\n%digno:-3\n", ":ann\n");
        withEditor(":ann\n", [](QWidget *) {});
        QCOMPARE(whole(formatMailLists, maillist_list), unchanged);
        withEditor(":ann\n", [&](QWidget *editor) {
            for (const QLabel *label : editor->findChildren<QLabel *>()) {
                if (label->text().contains('&')) {
                    type(label->buddy(), "new " + label->text());
                }
            }
            type(fieldBeside<QWidget>(editor, "Digest size trigger:"), "1024");
            type(fieldBeside<QWidget>(editor, "Digest count trigger:"), "1025");
            QCOMPARE(whole(formatMailLists, maillist_list), unchanged);
        });
        QCOMPARE(whole(formatMailLists, maillist_list),
                 block("new ", "%diglen:1024\n%digno:102\n", ":ann\n"));
    }

    void listOptions() {
        for (const auto &[caption, flags] :
             {std::pair{"Allow posting from any address (open list)", 69U},
              {"Allow posting by members", 67},
              {"Add reply-to header", 79},
              {"Block posts containing MIME attachments", 103},
              {"Allow digest subscriptions", 87}}) {
            withEditor("", [caption = caption](QWidget *editor) { press(editor, caption); });
            QCOMPARE(maillist_list.head->flags, flags);
        }
        maillist_list.clear();
        act(shownPage<MailList>().get(), "Add...", "&Mail list Name:", "new");
        QCOMPARE(maillist_list.head->flags, 2U + 4U + 8U + 16U + 32U);
    }

    void membersOnTheDigest() {
        using Case = std::tuple<const char *, bool, const char *, const char *>;
        for (const auto &[members, isDigestPressed, closing, after] :
             {Case{"ann\n", false, "OK", "annx"},
              {":\n", false, "OK", ":x"},
              {"ann\n", true, "OK", ":annx"},
              {":ann\n", false, "OK", ":annx"},
              {":ann\n", true, "OK", "annx"},
              {":ann\n", true, "Cancel", ":ann"}}) {
            const auto editFirst = [isPressed = isDigestPressed](QWidget *editor) {
                const QString shown = rowsOf(boxIn(editor));
                withFirst(editor, [&](QWidget *dialog) {
                    if (isPressed) {
                        press(dialog, "Digest List");
                    }
                    QCOMPARE(fieldBeside(dialog, "&Email:")->text(), shown);
                    answer("&Email:", shown + "x")(dialog);
                });
                QCOMPARE(rowsOf(boxIn(editor)), shown + "x");
            };
            withEditor(members, editFirst, closing);
            QCOMPARE(joined(maillist_list.head->member), after);
        }
    }

    /// Each by its own buttons; the others stay.
    void addressGroups() {
        QTemporaryFile file;
        QVERIFY(file.open() && file.write("c@x\nno address\n:\xff@x\n") > 0 && file.flush());
        const QStringList titles{"List Members", "Allowed Posters", "Blocked Posters"};
        const QStringList rows{"ann", ":al", ":bl"}; // Only a member is shown without its colon.
        for (const QString &title : titles) {
            withEditor(":ann\n", [&](QWidget *editor) {
                const QGroupBox *group = captioned(editor, &QGroupBox::title, title);
                QVERIFY2(rowsOf(boxIn(group)) == rows.at(titles.indexOf(title)), qPrintable(title));
                act(group, "Load File", "&Filename:", file.fileName());
                act(group, "Search...", "&Search for:", "c@");
                act(group, "Modify...", "&Email:", "new");
                act(group, "Add...", "&Email:", "added");
                QVERIFY(rowsOf(boxIn(group)).endsWith(textFromBytes("|new|:\xff@x|added")));
                act(group, "Search...", "&Search for:", "ad");
                press(group, "Remove");
            });
            const maillist_entry &list = *maillist_list.head;
            QStringList after{":ann", ":al", ":bl"};
            after[titles.indexOf(title)].prepend(textFromBytes(":\xff@x|new|"));
            const QStringList seen{joined(list.member), joined(list.allow), joined(list.block)};
            QVERIFY2(seen == after, qPrintable(title + ": " + seen.join("; ")));
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
        const EditList list{nullptr, "edit", nullptr};
        using Case = std::tuple<const QDialog *, QString, QString, const char *>;
        for (const auto &[dialog, caption, chosen, name] :
             {Case{&target, "Alias:", "in", "browse"},
              {&load, "Filename:", "in/file", "QFileDialog"},
              {&load, "Filename:", "in/not UTF-8: \ufffd", "QFileDialog"},
              {&list, "Info file:", "in/file", "QFileDialog"},
              {&list, "Header file:", "in/file", "QFileDialog"},
              {&list, "Footer file:", "in/file", "QFileDialog"}}) {
            QLineEdit *field = fieldBeside(dialog, '&' + caption);
            auto *button = qobject_cast<QAbstractButton *>(
                captioned(dialog, &QWidget::accessibleName, caption + " Browse..."));
            const QString path = folder.filePath(chosen);
            for (const bool isAccepted : {false, true}) {
                field->setText(folder.path());
                QString seen;
                const auto choose = [&](QFileDialog *chooser) {
                    seen = chooser->objectName() + " in " + chooser->directory().path();
                    chooser->selectFile(path);
                    static_cast<QDialog *>(chooser)->done(isAccepted ? 1 : 0);
                };
                withDialog<QFileDialog>([&] { button->click(); }, choose);
                QCOMPARE(seen.section('/', 0, 2), name + (" in " + folder.path()));
                const bool isTaken = isAccepted && !path.contains(QChar::ReplacementCharacter);
                QVERIFY2(field->text() == (isTaken ? path : folder.path()), qPrintable(path));
                QVERIFY(isTaken || !isAccepted || !QToolTip::text().isEmpty());
            }
        }
    }

    /// Among the members, in the first group; each from the row that the one before found.
    void search() {
        withEditor("hannah\nANN\nbob\n:ann\n", [](QWidget *editor) {
            QStringList found;
            for (const char *needle : {":", "a.n", "ann", "ann", "ann", "zoe", ""}) {
                act(editor, "Search...", "&Search for:", needle);
                found << QString::number(boxIn(editor)->currentRow().value_or(-1));
            }
            QCOMPARE(found.join(' '), "-1 -1 0 3 0 0 1");
        });
    }

    void fileThatCannotBeRead() {
        withEditor("ann\n", [](QWidget *editor) {
            const auto confirm = [](QMessageBox *message) {
                QCOMPARE(message->windowTitle(), "Mailling List Manager");
                QCOMPARE(message->text(), "Could not open file for reading - perhaps permission "
                                          "denied?.\n\n");
                message->accept();
            };
            QVERIFY(withDialog<QMessageBox>(
                [&] { act(editor, "Load File", "&Filename:", "/no/such/file"); }, confirm));
            QCOMPARE(rowsOf(boxIn(editor)), "ann");
        });
    }
};

QTEST_MAIN(TestListPages)
#include "test_listpages.moc"
