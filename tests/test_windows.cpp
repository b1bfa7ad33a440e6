#include "platform/kcontroldialog.h"

#include "dialogdriver.h"
#include "windows.h"

#include <QAccessible>
#include <QHelpEvent>
#include <QPointer>
#include <QScreen>
#include <QScrollArea>
#include <QSpinBox>
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

/// The size of the longest text that the part shows, with the frame that it has at the least.
QSize neededFor(const QWidget *part) {
    const auto *box = qobject_cast<const QSpinBox *>(part);
    const bool isEdit = box == nullptr && qobject_cast<const QLineEdit *>(part) != nullptr;
    const QString text = box != nullptr ? QString::number(box->maximum())
                         : isEdit       ? QString{}
                                        : part->property("text").toString();
    const int frame = box != nullptr || part->inherits("QCheckBox") ? 20
                      : part->inherits("QPushButton")               ? 2
                                                                    : 0;
    const QFontMetrics metrics = part->fontMetrics();
    return {metrics.size(Qt::TextShowMnemonic, text).width() + frame, metrics.height()};
}

bool isCut(const QWidget *part) { return neededFor(part).expandedTo(part->size()) != part->size(); }

/// The first fault of the window's layout; empty when there is none.
QString layoutFault(const QWidget *window) {
    const QList<QWidget *> parts = partsOf(window);
    for (const QWidget *part : parts) {
        if (isCut(part)) {
            return described(part) + " is cut";
        }
        if (part->visibleRegion().boundingRect() != part->rect()) {
            return described(part) + " is not seen";
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
        for (const int pixels : {7, 10, 12, 15, 19}) {
            setFont(pixels);
            for (const auto make : makers) {
                const Window window = make();
                window->show();
                QCoreApplication::processEvents();
                const QString name = QString::number(pixels) + window->metaObject()->className();
                QVERIFY2(layoutFault(window.get()).isEmpty(),
                         qPrintable(name + layoutFault(window.get())));
                QSet<int> left;
                for (const QLabel *label : window->findChildren<QLabel *>()) {
                    left << (label->text().contains('&') ? placeOf(label->buddy()).left() : 0);
                }
                left.remove(0);
                QVERIFY2(left.size() <= (window->inherits("EditList") ? 2 : 1), qPrintable(name));
            }
        }
    }

    /// To a screen reader every part has a name of its own.
    void namesDiffer() {
        for (const auto make : makers) {
            const Window window = make();
            window->show();
            QStringList names;
            for (QWidget *part : partsOf(window.get())) {
                if (!part->inherits("QLabel")) {
                    names << QAccessible::queryAccessibleInterface(part)->text(QAccessible::Name);
                }
            }
            QVERIFY2(!names.contains("") && names.removeDuplicates() == 0,
                     qPrintable(window->metaObject()->className() + names.join(", ")));
        }
    }

    /// In a window too low for its rows they scroll and keep their heights.
    void editorScrolls() {
        for (const int pixels : {19, 10}) {
            setFont(pixels);
            const Window editor = empty<EditList>();
            const auto *area = editor->findChild<QScrollArea *>();
            editor->show();
            editor->resize(1, 1);
            QTRY_COMPARE(area->viewport()->width(), area->widget()->width());
            QVERIFY(fieldBeside(editor.get(), "&Mail list Name:")->height() >= 25);
            QCOMPARE(editor->size(), QSize(std::max(editor->width(), 600), 350));
        }
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
            QVERIFY2(window->height() <= window->screen()->availableGeometry().height(),
                     qPrintable(described(window)));
            const QWidget *ok = captioned(window, &QAbstractButton::text, "OK");
            QVERIFY2(window->rect().contains(placeOf(ok)), qPrintable(described(window)));
            window->resize(1500, window->height());
            QVERIFY2(window->findChild<QScrollArea *>() != nullptr, qPrintable(described(window)));
            for (const auto *area : window->findChildren<QScrollArea *>()) {
                QVERIFY2(!area->isVisible() || area->widget()->width() >= area->viewport()->width(),
                         qPrintable(described(area)));
            }
            for (const QWidget *part : partsOf(window)) {
                QVERIFY2(!isCut(part), qPrintable(described(part)));
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
            const char *name = window->metaObject()->className();
            auto *field = window->findChild<QLineEdit *>();
            QHelpEvent pointed{QEvent::ToolTip, {}, {}};
            for (const QPoint at : {QPoint{10, 40}, QPoint{500, 40}, QPoint{500, 580}}) {
                window->move(at);
                window->show();
                QTest::keyClicks(field, at.x() == 10 ? "" : ",");
                QVERIFY2(at.x() != 10 || QApplication::sendEvent(field, &pointed), name);
                QPointer<QWidget> tip;
                for (QWidget *widget : QApplication::topLevelWidgets()) {
                    tip = widget->inherits("QTipLabel") && widget->isVisible() ? widget : tip.get();
                }
                QVERIFY2(tip != nullptr, name);
                QVERIFY2(!tip->geometry().intersects(window->geometry()), name);
                QToolTip::hideText();
                QVERIFY2(QTest::qWaitFor([&] { return tip == nullptr || !tip->isVisible(); }),
                         name);
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
