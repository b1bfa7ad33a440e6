#include "platform/knumericspinbox.h"

#include "dialogdriver.h"

#include <limits>

class TestKNumericSpinBox : public QObject {
    Q_OBJECT

private slots:
    void initTestCase() {
        box.setRange(0, 999);
        box.setStep(1);
        box.setEditable(true);
        box.show();
        QVERIFY(QTest::qWaitForWindowActive(&box));
    }

    void storedNumberIsKept() {
        for (const int stored : {3600, 999, -1, 0, 7000, std::numeric_limits<int>::min(), 5}) {
            box.setValue(stored);
            box.setFocus();
            QTest::keyClick(&box, Qt::Key_Return);
            box.clearFocus();
            QCOMPARE(box.text(), QString::number(stored));
            QCOMPARE(box.getValue(), stored);
        }
    }

    void userEndsInRange() {
        using Case = std::tuple<int, Qt::Key, const char *, int>;
        for (const auto &[stored, key, pasted, expected] :
             std::initializer_list<Case>{{999, Qt::Key_Up, "", 999},
                                         {3600, Qt::Key_Down, "", 999},
                                         {-5, Qt::Key_Up, "", 0},
                                         {3600, Qt::Key_Backspace, "", 360},
                                         {3600, Qt::Key_Delete, "42", 42},
                                         {3600, Qt::Key_Delete, "1500", 999},
                                         {-500, Qt::Key_Delete, "-20", 0}}) {
            box.setValue(stored);
            QTest::keyClick(&box, Qt::Key_End);
            QTest::keyClick(&box, key);
            if (*pasted != '\0') {
                box.selectAll();
                paste(&box, pasted);
            }
            QCOMPARE(box.getValue(), expected);
            type(&box, "1000");
            QCOMPARE(box.getValue(), 100);
        }
    }

private:
    KNumericSpinBox box;
};

QTEST_MAIN(TestKNumericSpinBox)
#include "test_knumericspinbox.moc"
