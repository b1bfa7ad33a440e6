#include "platform/kcontroldialog.h"

#include "dialogdriver.h"
#include "windows.h"

#include <QAccessible>
#include <QComboBox>
#include <QGroupBox>
#include <QHelpEvent>
#include <QPointer>
#include <QPushButton>
#include <QScreen>
#include <QScrollArea>
#include <QSpinBox>
#include <QStyleOptionButton>
#include <QTabWidget>
#include <QToolTip>

#include <memory>

namespace {

using Window = std::unique_ptr<QWidget>;

template <class Dialog>
Window empty() {
    if constexpr (std::is_constructible_v<Dialog, QWidget *, const char *, std::nullptr_t>) {
        return std::make_unique<Dialog>(nullptr, "Edit", nullptr);
    } else {
        return std::make_unique<Dialog>(nullptr, "page");
    }
}

constexpr std::array makers{
    empty<MailSMTP>,     empty<MailPOP3>,       empty<MailIMAP>,       empty<MailFetch>,
    empty<MailDebatch>,  empty<MailAlias>,      empty<MailList>,       empty<EditSMTP>,
    empty<EditFetch>,    empty<EditAlias>,      empty<EditAliasEntry>, empty<EditList>,
    empty<EditListAddr>, empty<EditListMember>, empty<ListSearch>,     empty<ListLoad>};

/// What a user reads or works with, as opposed to what only holds others.
QList<QWidget *> partsOf(const QWidget *window) {
    QList<QWidget *> parts = window->findChildren<QWidget *>();
    parts.removeIf([](const QWidget *part) {
        const auto inherits = [part](const char *name) { return part->inherits(name); };
        constexpr std::array names{"QLabel",    "QLineEdit",        "QAbstractButton",
                                   "QComboBox", "QAbstractSpinBox", "QListBox"};
        return std::ranges::none_of(names, inherits) || !part->isVisible() ||
               part->parentWidget()->inherits("QAbstractSpinBox");
    });
    return parts;
}

QRect placeOf(const QWidget *part) {
    return {part->mapTo(part->window(), QPoint{0, 0}), part->size()};
}

QString described(const QWidget *part) {
    return QString{"%1 %2 in %3"}.arg(part->metaObject()->className(),
                                      part->property("text").toString(),
                                      part->window()->metaObject()->className());
}

/// From left to right, and from top to bottom.
QString measured(QRect place) {
    return QString::asprintf("%d-%d %d-%d", place.left(), place.right() + 1, place.top(),
                             place.bottom() + 1);
}

/// Where a part of a dialog of fixed size is, or how wide one of fixed width; then what it tells.
QString listed(const QWidget *part) {
    const bool isInGroup = qobject_cast<const QGroupBox *>(part->parentWidget()) != nullptr;
    const auto *types = qobject_cast<const QComboBox *>(part);
    QStringList words{part->property("text").toString(), part->property("maximum").toString(),
                      part->toolTip()};
    for (int index = 0; types != nullptr && index < types->count(); ++index) {
        words << types->itemText(index);
    }
    if (!isInGroup && types == nullptr && part->window()->maximumWidth() < QWIDGETSIZE_MAX) {
        words.prepend(measured(placeOf(part)));
    } else if (part->minimumWidth() == part->maximumWidth()) {
        words.prepend(QString::number(part->width()));
    }
    const QString description = part->accessibleDescription();
    words << (description == part->toolTip() && !description.isEmpty() ? "described" : description);
    words.removeAll("");
    return (words.isEmpty() ? part->metaObject()->className() : words.join(" | "))
        .replace('\n', ' ');
}

/// The room that a part gives its text, and what the text needs.
std::pair<QSize, QSize> roomAndText(const QWidget *part) {
    if (const auto *box = qobject_cast<const QSpinBox *>(part)) {
        const int digits = box->fontMetrics().horizontalAdvance(QString::number(box->maximum()));
        return {box->findChild<QLineEdit *>()->size(), {digits + 2, box->fontMetrics().height()}};
    }
    const QFontMetrics metrics = part->fontMetrics();
    const QSize text{metrics.size(Qt::TextShowMnemonic, part->property("text").toString()).width(),
                     metrics.height()};
    if (qobject_cast<const QPushButton *>(part) != nullptr) {
        QStyleOptionButton option;
        option.initFrom(part);
        return {part->style()->subElementRect(QStyle::SE_PushButtonContents, &option, part).size(),
                text};
    }
    return {part->size(),
            qobject_cast<const QLabel *>(part) != nullptr ? text : QSize{0, text.height()}};
}

/// The first fault of the window's layout; empty when there is none.
QString layoutFault(const QWidget *window) {
    const QList<QWidget *> parts = partsOf(window);
    for (const QWidget *part : parts) {
        const auto &[room, text] = roomAndText(part);
        if (text.expandedTo(room) != room) {
            return described(part) + " is cut";
        }
        if (!window->rect().contains(placeOf(part))) {
            return described(part) + " is outside";
        }
        for (const QWidget *other : parts) {
            if (other != part && placeOf(other).intersects(placeOf(part))) {
                return described(part) + " overlaps " + described(other);
            }
        }
    }
    return {};
}

} // namespace

class TestWindows : public QObject {
    Q_OBJECT

private slots:
    void init() { setFont(10); }

    /// The fields of a form begin at one x; the editor has more than one.
    void nothingIsCut() {
        for (const int pixels : {10, 12, 15, 19}) {
            setFont(pixels);
            for (const auto make : makers) {
                const Window window = make();
                window->show();
                QVERIFY2(layoutFault(window.get()).isEmpty(),
                         qPrintable(QString::number(pixels) + layoutFault(window.get())));
                QSet<int> left;
                for (const QLabel *label : window->findChildren<QLabel *>()) {
                    left << (label->text().contains('&') ? placeOf(label->buddy()).left() : 0);
                }
                QVERIFY(left.subtract({0}).size() <= (window->inherits("EditList") ? 2 : 1));
            }
        }
    }

    /// As a list says: of each window its title, what it is divided into, and its parts. With a
    /// small font all given measures hold. To a screen reader every part has a name of its own.
    void windowsAreAsListed() {
        setFont(7);
        QFile list{TEST_DATA "/windows.txt"};
        QVERIFY(list.open(QIODevice::ReadOnly));
        QStringList lines;
        for (const auto make : makers) {
            const Window window = make();
            window->show();
            lines << window->metaObject()->className() + (": " + window->windowTitle());
            if (window->maximumWidth() < QWIDGETSIZE_MAX) {
                const auto *panel = window->findChild<QFrame *>({}, Qt::FindDirectChildrenOnly);
                lines << measured(window->rect()) + ", panel: " + measured(panel->geometry());
            }
            for (const QGroupBox *group : window->findChildren<QGroupBox *>()) {
                lines << "Group: " + group->title();
            }
            QStringList names;
            for (QWidget *part : partsOf(window.get())) {
                lines << listed(part);
                if (qobject_cast<QLabel *>(part) == nullptr) {
                    names << QAccessible::queryAccessibleInterface(part)->text(QAccessible::Name);
                }
            }
            QVERIFY2(!names.contains("") && names.removeDuplicates() == 0,
                     qPrintable(lines.last()));
            lines << "";
        }
        QCOMPARE(lines, QString::fromUtf8(list.readAll()).split('\n'));
    }

    /// From high to low: nothing overlaps, and no row gives way by more than what is missing.
    void editorShrinksByWhatIsMissing() {
        const Window editor = empty<EditList>();
        editor->show();
        QMap<QWidget *, int> heights;
        for (int height = 800; height >= 350; --height) {
            editor->resize(600, height);
            QVERIFY2(layoutFault(editor.get()).isEmpty(), qPrintable(layoutFault(editor.get())));
            for (QWidget *part : partsOf(editor.get())) {
                const int before = heights.value(part, part->height());
                QVERIFY2(before - part->height() <= 1, qPrintable(described(part)));
                heights[part] = part->height();
            }
        }
        QCOMPARE(editor->size(), QSize(600, 350));
        QVERIFY(fieldBeside(editor.get(), "&Mail list Name:")->height() < 25);
    }

    /// Here the screen is 800 pixels high.
    void lowScreen() {
        setFont(40);
        KControlDialog dialog;
        dialog.addPage(new MailSMTP(&dialog, "smtpserver"), "&SMTP", {});
        dialog.addPage(new MailIMAP(&dialog, "imapserver"), "&IMAP", {});
        dialog.addButtons();
        const Window editor = empty<EditList>();
        for (QWidget *window : {editor.get(), static_cast<QWidget *>(&dialog)}) {
            window->show();
            QVERIFY(window->height() <= window->screen()->availableGeometry().height());
            const QWidget *ok = captioned(window, &QAbstractButton::text, "OK");
            QVERIFY(window->rect().contains(placeOf(ok)));
            window->resize(1500, window->height());
            QVERIFY(window->findChild<QScrollArea *>() != nullptr);
            for (const auto *area : window->findChildren<QScrollArea *>()) {
                QVERIFY(!area->isVisible() || area->widget()->width() >= area->viewport()->width());
            }
            for (const QWidget *part : partsOf(window)) {
                const auto &[room, text] = roomAndText(part);
                QVERIFY2(text.expandedTo(room) == room, qPrintable(described(part)));
            }
            QVERIFY(QTest::qWaitForWindowActive(window));
            QWidget *low = captioned(window, &QAbstractButton::text, "Remove");
            low->setFocus();
            QCOMPARE(low->visibleRegion().boundingRect(), low->rect());
        }
        QCOMPARE(dialog.findChild<QTabWidget *>()->currentIndex(), 0);
        QCOMPARE(dialog.findChild<QTabWidget *>()->tabText(1), "&IMAP");
    }

    /// Neither after a character that is not taken, nor under the pointer.
    void tipCoversNoField() {
        for (const auto make : {empty<EditFetch>, empty<EditAlias>, empty<EditAliasEntry>}) {
            const Window window = make();
            auto *field = window->findChild<QLineEdit *>();
            QHelpEvent pointed{QEvent::ToolTip, {}, {}};
            for (const QPoint at : {QPoint{10, 40}, QPoint{500, 40}, QPoint{500, 580}}) {
                window->move(at);
                window->show();
                QTest::keyClicks(field, at.x() == 10 ? "" : ",");
                QVERIFY(at.x() != 10 || QApplication::sendEvent(field, &pointed));
                QPointer<QWidget> tip;
                for (QWidget *widget : QApplication::topLevelWidgets()) {
                    tip = widget->inherits("QTipLabel") && widget->isVisible() ? widget : tip.get();
                }
                QVERIFY(tip != nullptr);
                QVERIFY(!tip->geometry().intersects(window->geometry()));
                QToolTip::hideText();
                QVERIFY(QTest::qWaitFor([&] { return tip == nullptr || !tip->isVisible(); }));
            }
        }
    }

private:
    static void setFont(int pixels) {
        QFont font = QApplication::font();
        font.setPixelSize(pixels);
        QApplication::setFont(font);
    }
};

QTEST_MAIN(TestWindows)
#include "test_windows.moc"
