#include "datafiles.h"

#include "config/settings.h"

namespace {

/// Takes texts through the handler and back; what it shows stores the same again.
template <class Field, class Handler>
auto shownBy(Handler handler, const Field &given) {
    return [handler, field = given](const std::string &bytes) mutable {
        handler(field, bytes);
        const Field stored = field;
        const std::string text = handler(field, std::nullopt).value_or("none");
        handler(field, text);
        return field == stored || text.empty() ? text : text + " is stored as something else";
    };
}

std::string shown(Setting *setting) { return setting->exchange(std::nullopt).value_or("absent"); }

} // namespace

class TestSettings : public QObject {
    Q_OBJECT

private slots:
    void unknownKeys() {
        for (const char *unknown : {"", "smtp.sock.por", "smtp.sock.ports", " smtp.sock.port"}) {
            QVERIFY2(!settingByKey(unknown, "1") && !settingByKey(unknown, std::nullopt), unknown);
        }
    }

    void ofTwoKeysThatDifferInCaseTheFirstCounts() {
        SettingTable table;
        const TextSetting first{table, "a.Key"};
        const TextSetting second{table, "A.key"};
        QVERIFY(table.find("a.key") == &first && table.find("A.KEY") == &first);
    }

    void everyKeyInCapitalsReachesItsSetting() {
        for (Setting *setting : settings().all()) {
            const std::string before = shown(setting);
            const QByteArray key = QByteArray{setting->key()}.toUpper();
            settingByKey(key.toStdString(), before == "yes" ? "no" : "77");
            QVERIFY2(shown(setting) != before, key);
            const auto *number = dynamic_cast<NumberSetting *>(setting);
            const int unit = key.startsWith("CACHE.") ? 1024 : 1;
            QVERIFY2(number == nullptr || number->value == 77 * unit, key);
        }
    }

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

    void booleans() { checkRows(shownBy(boolSetting, 5), "[booleans]"); }

    void times() { checkRows(shownBy(timeSetting, -1), "[times]"); }

    void smallFunctions() {
        std::int32_t time = 0;
        timeSetting(time, "9:05");
        QCOMPARE(time, 9 * 256 + 5);
        QVERIFY(formatUnsigned(0) == "0" && formatUnsigned(0xffffffffU) == "4294967295");
        QCOMPARE(compareNoCase("_", "A"), -1); // In capitals it would be the other way round.
        QCOMPARE(compareNoCase(nullptr, "a") + compareNoCase("a", nullptr), -2);
    }

    void accessLists() {
        QVERIFY(!parseAccessList("") && parseAccessList(" "));
        checkRows(shownBy(accessListSetting, std::optional{AccessList{{{1, 2}, {3, 4}}}}),
                  "[access lists]");
        checkRows([](const std::string &text) { return formatAccessList(*parseAccessList(text)); },
                  "[long access lists]");
    }
};

QTEST_GUILESS_MAIN(TestSettings)
#include "test_settings.moc"
