#include "datafiles.h"

#include "config/settingvalues.h"

#include <arpa/inet.h>

namespace {

/// Takes texts through the handler and back; what it shows stores the same again.
template <class Field, class Handler>
auto shownBy(Handler handler, Field field) {
    return [handler, field](const std::string &bytes) mutable {
        handler(field, bytes);
        const Field stored = field;
        const std::string text = handler(field, std::nullopt).value_or("none");
        handler(field, text);
        return field == stored || text.empty() ? text : text + " is stored as something else";
    };
}

} // namespace

class TestSettingValues : public QObject {
    Q_OBJECT

private slots:
    void numbers() {
        checkRows(
            shownBy([](auto &field, auto text) { return numberSetting(field, text, 1); }, 12345),
            "[numbers]");
    }

    void numbersInUnits() {
        std::int32_t field = 0;
        numberSetting(field, "2097153", 1024);
        QCOMPARE(field, INT32_MIN + 1024);
        for (std::int32_t stored : {2049, 3071, -2049, -3071}) {
            QVERIFY(numberSetting(stored, std::nullopt, 1024) == (stored < 0 ? "-2" : "2"));
            QVERIFY(numberSetting(stored, std::nullopt, -3) == std::to_string(stored));
        }
    }

    void booleans() {
        checkRows(shownBy(boolSetting, 5), "[booleans]");
        std::int32_t field = 5;
        boolSetting(field, "yes");
        QCOMPARE(field, 1);
    }

    void times() { checkRows(shownBy(timeSetting, -1), "[times]"); }

    void smallFunctions() {
        std::int32_t time = 0;
        timeSetting(time, "9:05");
        QCOMPARE(time, 9 * 256 + 5);
        QVERIFY(formatUnsigned(0) == "0" && formatUnsigned(0xffffffffU) == "4294967295");
        QCOMPARE(compareNoCase("Pop.HOSTS", "pop.hosts"), 0);
        QCOMPARE(compareNoCase("_", "A"), -1); // In capitals it would be the other way round.
        QCOMPARE(compareNoCase("\xff", "A"), 1);
        QCOMPARE(compareNoCase(nullptr, "a") + compareNoCase("a", nullptr), -2);
    }

    void accessLists() {
        QVERIFY(!parseAccessList("") && parseAccessList(" "));
        checkRows(shownBy(accessListSetting, std::optional{AccessList{{{1, 2}, {3, 4}}}}),
                  "[access lists]");
        checkRows([](const std::string &text) { return formatAccessList(*parseAccessList(text)); },
                  "[long access lists]");
    }

    void accessListsAreInTheOrderOfTheNetwork() {
        const AccessListEntry expected{htonl(0x0a000201), htonl(0xffffff00)};
        QVERIFY(parseAccessList("10.0.2.1/24")->entries == std::vector{expected});
    }
};

QTEST_GUILESS_MAIN(TestSettingValues)
#include "test_settingvalues.moc"
