// `monkey SEED EVENTS` sends random keys and clicks to the whole program on a product of its own
// and checks after each that rows, records and, after an apply, files agree. A seed stands for the
// same events each time; they stand in the product's file "events", too, should the program crash.

#include "datafiles.h"
#include "dialogdriver.h"

#include "alias/editalias.h"
#include "app/ktarvexapplication.h"
#include "config/masterfile.h"
#include "config/settings.h"
#include "fetch/pophosts.h"
#include "lists/editlist.h"
#include "platform/kcontroldialog.h"
#include "server/smtprejectfile.h"

#include <QFileDialog>
#include <QTabWidget>
#include <QTextBrowser>
#include <QWheelEvent>

namespace {

std::mt19937 source;
std::ofstream trace;
QStringList sent;

void require(bool holds, const QString &what) {
    if (!holds) {
        const QString last = sent.mid(std::max<qsizetype>(0, sent.size() - 20)).join('\n');
        qWarning("%s after event %lld:\n%s", qPrintable(what), sent.size(), qPrintable(last));
        std::_Exit(1);
    }
}

/// Reaches the alias dialog's working list: an explicit instantiation may name any member.
RecordChain<alias_list_entry> &targetsOf(EditAlias &dialog);
template <auto targets>
struct Reached {
    friend RecordChain<alias_list_entry> &targetsOf(EditAlias &dialog) { return dialog.*targets; }
};
template struct Reached<&EditAlias::targets_>;

/// Rows and records as counted texts, without the `unshown` that may begin them.
template <class Record, class TextOf>
void checkRows(const QListBox *box, const Record *record, TextOf textOf, const char *unshown = "") {
    std::array<std::vector<std::string>, 2> both;
    for (int row = 0; row < box->count(); ++row) {
        both[0].emplace_back(box->text(row));
    }
    for (; record != nullptr; record = record->next) {
        both[1].emplace_back(std::invoke(textOf, *record));
    }
    for (auto &texts : both) {
        for (std::string &text : texts) {
            require(text.find_first_of(std::string{"\r\n\0", 3}) == text.npos, "Broken row");
            text.erase(0, text.find_first_not_of(unshown));
        }
        std::ranges::sort(texts);
    }
    require(both[0] == both[1], "Other rows than records: " + box->accessibleName());
}

void checkWidget(QWidget *widget) {
    if (const auto *box = qobject_cast<QListBox *>(widget)) {
        const QModelIndex current = box->currentIndex();
        const QModelIndexList chosen = box->selectionModel()->selectedIndexes();
        require(chosen == QModelIndexList(current.isValid() ? 1 : 0, current), "Wrong highlight");
    } else if (const auto *field = qobject_cast<QLineEdit *>(widget)) {
        const bool isEdited = field == field->window()->focusWidget();
        require(!isEdited || bytesFromText(field->text()).size() <= 100'000, "Long text");
    } else if (auto *alias = qobject_cast<EditAlias *>(widget)) {
        checkRows(alias->findChild<QListBox *>(), targetsOf(*alias).head, &alias_list_entry::alias);
    } else if (auto *group = dynamic_cast<AddressGroup *>(widget)) {
        checkRows(group->box(), *group->chain(), addressStored,
                  group->title() == "List Members" ? ":" : "");
    }
}

void check(const QWidget *dialog) {
    std::ranges::for_each(QApplication::allWidgets(), checkWidget);
    const auto boxOf = [dialog](const char *page) {
        return dialog->findChild<QWidget *>(page)->findChild<ListGroup *>()->box();
    };
    checkRows(boxOf("alias"), alias_list.head, &alias_entry::address);
    checkRows(boxOf("smtpserver"), smtpreject_list.head, &smtpreject_entry::domain);
    checkRows(boxOf("list"), maillist_list.head, &maillist_entry::name);
    checkRows(boxOf("fetch"), pop_host_list.head, [](auto &host) { return host.user.data(); });
}

/// The files hold what is in memory. What is read of them again, the fuzz targets claim.
void checkFiles() {
    for (const auto &[file, bytes] : {std::pair{"alias", whole(formatAliases, alias_list)},
                                      {"reject", whole(formatSmtpRejects, smtpreject_list)},
                                      {"lists", whole(formatMailLists, maillist_list)}}) {
        require(bytesAt(std::string{TEST_PRODUCT "/config/"} + file) == bytes, file);
        require(bytes.find('\r') == std::string::npos, file);
    }
    const auto withoutMarks = [] { return QString::fromLatin1(formatPopHosts()).remove('*'); };
    const QString fetchers = withoutMarks();
    RecordChain<pop_host> hosts = std::move(pop_host_list);
    readMasterConfig();
    parsePopHosts(settings().pop_hosts.value);
    require(withoutMarks() == fetchers, "pop.hosts");
    pop_host_list = std::move(hosts);
}

int below(qsizetype limit) { return static_cast<int>(source() % static_cast<unsigned>(limit)); }

void note(const char *what, const QWidget *where, const QString &more) {
    sent << where->window()->windowTitle() + ": " + what + ' ' + where->metaObject()->className() +
                ' ' + more.left(40).simplified();
    trace << qPrintable(sent.back()) << '\n' << std::flush;
}

/// It could change other files: it gets no other events.
void choose(QFileDialog *chooser) {
    const bool isFile = chooser->fileMode() == QFileDialog::ExistingFile;
    const auto key = below(2) == 0 ? Qt::Key_Return : Qt::Key_Escape;
    note("choose", chooser, QKeySequence{key}.toString());
    chooser->selectFile(TEST_PRODUCT + QString{isFile ? "/config/load" : "/config"});
    QTest::keyClick(chooser->findChild<QLineEdit *>("fileNameEdit"), key);
}

void sendKey(QWidget *focus) {
    static const QStringList keys =
        QString{"Tab Tab Backtab Up Down Down Left Right Home End PgUp PgDown Return Return Return "
                "Esc Space Space Del Backspace F1 Ctrl+A Ctrl+A Ctrl+X Ctrl+Z Shift+Home Enter"}
            .split(' ');
    static const QStringList texts =
        textFromBytes(
            decoded("ann@x~bob~bob\\n~:carol@x\\n~::d~#staff~|x~a,b c~%name:x\\n~!x~$y~[spool]~"
                    "-*e~x:y@z~\\n#end~ \\tx\\v ~10.0.0.0/8, 1.2.3.4~config/load~config/load~"
                    "\\xe9 \\xff~x{300}~a\\r\\nb@c\\n#endlist\\n~a\\0b@~\\xc3\\xa9\\xe2~x{60000}"))
            .split('~');
    const int kind = below(10);
    const QString text = kind < 5   ? texts.at(below(texts.size()))
                         : kind < 9 ? keys.at(below(keys.size()))
                                    : QString{"Alt+"} + QChar('A' + below(26));
    note(kind < 3 ? "type" : kind < 5 ? "paste" : "key", focus, text);
    if (kind < 3) {
        QTest::sendKeyEvent(QTest::Click, focus, Qt::Key_unknown, text, Qt::NoModifier);
    } else if (kind < 5) {
        paste(focus, text);
    } else {
        QTest::keySequence(focus, QKeySequence{text});
    }
}

/// Half of them go to buttons and lists alone, and most to where the first rows of lists are.
void sendMouse(QWidget *window) {
    QList<QWidget *> widgets = window->findChildren<QWidget *>();
    widgets.removeIf([isAny = below(2) == 0](const QWidget *widget) {
        return !widget->isVisible() || !(isAny || widget->inherits("QPushButton") ||
                                         widget->objectName() == "qt_scrollarea_viewport");
    });
    QWidget *widget = widgets.empty() ? window : widgets.at(below(widgets.size()));
    const QPoint point{below(widget->width()), below(std::min(widget->height(), 80))};
    const int kind = below(10);
    note(kind < 7   ? "click"
         : kind < 9 ? "double click"
                    : "wheel",
         widget, widget->property("text").toString());
    if (kind < 7) {
        QTest::mouseClick(widget, Qt::LeftButton, {}, point);
    } else if (kind < 9) {
        QTest::mouseDClick(widget, Qt::LeftButton, {}, point);
    } else {
        QWheelEvent wheel{point, point, {}, {0, 240 * below(2) - 120}, {}, {}, {}, false};
        QCoreApplication::sendEvent(widget, &wheel);
    }
}

void next(QWidget *dialog, bool isOver) {
    check(dialog);
    QWidget *popup = QApplication::activePopupWidget();
    QWidget *modal = QApplication::activeModalWidget();
    QWidget *window = popup != nullptr ? popup : modal != nullptr ? modal : dialog;
    if (isOver) {
        captioned(dialog, &QAbstractButton::text, window == dialog ? "Apply" : "Help")->click();
        window->close();
    } else if (auto *chooser = qobject_cast<QFileDialog *>(window)) {
        choose(chooser);
    } else if (popup != nullptr || below(100) < 45) {
        sendKey(window->focusWidget() != nullptr ? window->focusWidget() : window);
    } else {
        const QTextBrowser *help = below(16) == 0 ? anywhere<QTextBrowser>() : nullptr;
        sendMouse(help != nullptr && help->isVisible() ? help->window() : window);
    }
}

} // namespace

int main(int argc, char **argv) {
    if (argc != 3) {
        std::puts("usage: monkey SEED EVENTS");
        return 2;
    }
    source.seed(std::stoul(argv[1]));
    const qsizetype events = std::stol(argv[2]);
    layProduct();
    rewriteFile(TEST_PRODUCT "/config/load", "ann@x\r\n:bob@x\nnone\n b c@#\n#d@e\n\xe9@\xff\n");
    trace.open(TEST_PRODUCT "/events");
    std::filesystem::current_path(TEST_PRODUCT); // File choosers begin there,
    qputenv("XDG_CONFIG_HOME", TEST_PRODUCT);    // and leave their settings there.
    qputenv("QT_QPA_PLATFORM", "offscreen");
    int programArgumentCount = 1;
    KTarvexApplication application{programArgumentCount, argv, "kcmtarvex_mail"};
    // Nothing depends on how fast the events follow each other.
    QApplication::setKeyboardInputInterval(1'000'000);
    QApplication::setDoubleClickInterval(0);
    auto *dialog = qobject_cast<KControlDialog *>(anywhere<QTabWidget>()->window());
    QObject::connect(dialog, &KControlDialog::applied, checkFiles);
    QTimer timer; // It does not send itself: it would stand still while a dialog is open.
    const auto step = [&] { next(dialog, sent.size() >= events); };
    timer.callOnTimeout([&] { QMetaObject::invokeMethod(dialog, step, Qt::QueuedConnection); });
    timer.start(0);
    for (; sent.size() < events || dialog->isVisible(); application.exec()) {
        dialog->show();
    }
    std::printf("seed %s, %s events\n", argv[1], argv[2]);
}
