#include "base/recordlist.h"

#include <QTest>

#include <memory>

class TestRecordList : public QObject {
    Q_OBJECT

    struct Record {
        std::shared_ptr<int> token; ///< Its use count tells how many records live.
        Record *next = nullptr;
    };

private slots:
    void aMillionRecordsAreFreedWithoutRecursion() {
        const auto token = std::make_shared<int>();
        RecordChain<Record> chain;
        for (int number = 0; number < 1'000'000; ++number) {
            prependRecord(&chain.head, {token});
        }
        QCOMPARE(token.use_count(), 1'000'001);
        chain.clear();
        QCOMPARE(token.use_count(), 1);
    }
};

QTEST_GUILESS_MAIN(TestRecordList)
#include "test_recordlist.moc"
