#include "platform/qlistbox.h"

#include "dialogdriver.h"

#include <QDialog>
#include <QHelpEvent>
#include <QPushButton>
#include <QToolTip>

namespace {

/// A list in a dialog with a default button.
struct Window : QObject {
    explicit Window(int current,
                    const std::vector<std::string_view> &rows = {"a", "b", "c", "d", "e"}) {
        box->resize(200, 300);
        std::vector<KeptText> texts;
        texts.reserve(rows.size());
        for (const std::string_view row : rows) {
            texts.push_back(keep(std::string{row}));
        }
        box->append(texts);
        ok->setDefault(true);
        QObject::connect(ok, &QPushButton::clicked, &dialog, &QDialog::accept);
        QObject::connect(box, &QListBox::selected,
                         [this](const char *text) { selected.emplace_back(text); });
        dialog.show();
        if (current >= 0) {
            box->setCurrentRow(current);
        }
    }

    bool eventFilter(QObject *watched, QEvent *event) override {
        isPainted = isPainted || event->type() == QEvent::Paint;
        return QObject::eventFilter(watched, event);
    }

    /// The row that buttons act on, or -1; several when another one is highlighted or focused.
    [[nodiscard]] QString current() const {
        QStringList rows{QString::number(box->currentRow().value_or(-1))};
        QModelIndexList indexes = box->selectionModel()->selectedIndexes();
        indexes << box->currentIndex();
        for (const QModelIndex &index : indexes) {
            rows << QString::number(index.row());
        }
        rows.removeDuplicates();
        return rows.join(" and ");
    }

    QDialog dialog;
    QPushButton *ok = new QPushButton("OK", &dialog);
    QListBox *box = new QListBox(&dialog);
    std::vector<std::string> selected;
    bool isPainted = false;
};

} // namespace

class TestQListBox : public QObject {
    Q_OBJECT

private slots:
    void rowIsChosen() {
        const std::string text = "b\xff\xc3";
        const Window window{1, {"a", text}};
        QTest::keyClick(window.box, Qt::Key_Return);
        QTest::keyClick(window.box, Qt::Key_Enter);
        doubleClickRow(window.box, 1);
        QCOMPARE(window.selected, (std::vector{text, text, text}));
        QVERIFY(window.dialog.isVisible());
    }

    void focusChoosesNoRow() {
        Window window{-1};
        QVERIFY(QTest::qWaitForWindowActive(&window.dialog));
        QTest::keyClick(window.ok, Qt::Key_Tab);
        QVERIFY(window.box->hasFocus());
        QTest::keyClick(window.box, Qt::Key_Return);
        QVERIFY(window.selected.empty());
        QVERIFY(window.dialog.isVisible());
        QCOMPARE(window.current(), "-1");
        QTest::keyClick(window.box, Qt::Key_End);
        QCOMPARE(window.current(), "4");
    }

    void focusIsSeen() {
        for (const std::vector<std::string_view> &rows :
             {std::vector<std::string_view>{}, {"a", "b"}}) {
            Window window{-1, rows};
            QVERIFY(QTest::qWaitForWindowActive(&window.dialog));
            window.ok->setFocus();
            const QImage without = window.box->viewport()->grab().toImage();
            window.box->setFocus();
            QVERIFY(window.box->viewport()->grab().toImage() != without);
        }
    }

    void addedRowIsSeenButNotChosen() {
        Window window{0, std::vector<std::string_view>(100, "x")};
        window.box->append(keep("new"));
        QVERIFY(window.box->viewport()->rect().contains(centreOfRow(window.box, 100)));
        QCOMPARE(window.current(), "0");
    }

    void changedTextIsPainted() {
        Window window{-1};
        QVERIFY(QTest::qWaitForWindowExposed(&window.dialog));
        QCoreApplication::processEvents();
        window.box->viewport()->installEventFilter(&window);
        window.isPainted = false;
        window.box->changeText(2, keep("changed"));
        QVERIFY(QTest::qWaitFor([&] { return window.isPainted; }));
    }

    void onlyALongRowHasAToolTip() {
        Window window{-1, {"a", std::string(200, 'x'), "a<b>" + std::string(200, 'x')}};
        using Case = std::pair<int, QString>;
        for (const auto &[row, tip] :
             {Case{1, QString(200, 'x')}, Case{0, ""}, Case{2, "a&lt;b&gt;" + QString(200, 'x')}}) {
            const QPoint at = centreOfRow(window.box, row);
            QHelpEvent event{QEvent::ToolTip, at, window.box->viewport()->mapToGlobal(at)};
            QApplication::sendEvent(window.box->viewport(), &event);
            QVERIFY(QTest::qWaitFor([&, shown = tip] { return QToolTip::text() == shown; }));
        }
    }

    void removal() {
        using Case = std::tuple<int, int, const char *, const char *>;
        for (const auto &[from, removed, current, left] :
             std::initializer_list<Case>{{0, 0, "0", "b|c|d|e"},
                                         {4, 4, "3", "a|b|c|d"},
                                         {3, 1, "2", "a|c|d|e"},
                                         {1, 3, "1", "a|b|c|e"},
                                         {-1, 0, "-1", "b|c|d|e"}}) {
            const Window window{from};
            window.box->remove(removed);
            QCOMPARE(window.current(), current);
            QCOMPARE(rowsOf(window.box), left);
        }
    }
};

QTEST_MAIN(TestQListBox)
#include "test_qlistbox.moc"
