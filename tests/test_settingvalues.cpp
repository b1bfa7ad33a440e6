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
            {{"white space and sign before, junk behind", " \t\n+042abc", "42"},
             {"minus sign", "-1", "-1"},
             {"two signs", "-+5", "0"},
             {"one above the largest wraps", "2147483648", "-2147483648"},
             {"too large for 64 bits, as atoi", "99999999999999999999", "-1"}});
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
        std::int32_t field = 0;
        for (const char *yes : {"yes", "tRUE", "On", "1", "", "n", "00", " 0", "-0", "no "}) {
            QVERIFY2(!boolSetting(field = 0, yes) && field == 1, yes);
        }
        QVERIFY(boolSetting(field, std::nullopt) == "yes");
        for (const char *no : {"0", "no", "NO", "false", "False", "off", "OFF"}) {
            QVERIFY2(!boolSetting(field = 1, no) && field == 0, no);
        }
        QVERIFY(boolSetting(field, std::nullopt) == "no");
    }

    void times() {
        checkRows(shownBy(timeSetting, -1),
                  {{"first colon before all others", "9 1,2;3:5:7", " 9: 5"},
                   {"comma before semicolon and blank", "9 1;2,5", " 9: 5"},
                   {"a blank in front separates", " 9 5", " 9: 9"},
                   {"not checked, kept to bytes", "256:-2", " 0:254"},
                   {"no separator", "9", " 9: 0"}});
    }

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
        checkRows(
            shownBy(accessListSetting, std::optional{AccessList{{{1, 2}, {3, 4}}}}),
            {{"blanks and nothing", "   ", ""},
             {"the first character behind the slash decides",
              "1.0.0.0/0, 2.0.0.0/8, 3.0.0.0/1x, 4.0.0.0/, 5.0.0.0/9",
              "1.0.0.0/0, 2.0.0.0/8, 3.0.0.0/16, 4.0.0.0/32, 5.0.0.0/32"},
             {"mask behind blanks", "1.0.0.0   255.255.128.0", "1.0.0.0 255.255.128.0"},
             {"mask that cannot be read", "1.1.1.1 1.300.0.0, 2.2.2.2 /8",
              "1.1.1.1/32, 2.2.2.2/32"},
             {"words of 17 characters", "1.1.1.00000000001/8, 2.2.2.2 255.0.0.0000000001",
              "1.1.1.1/8, 2.2.2.2/8"},
             {"word of 18 characters", "10.0.0.00000000011/8", "10.0.0.1/32"},
             {"keywords in any case, without a mask", "NONE, All/8, * 255.0.0.0", "none, all, all"},
             {"zero addresses", "0.0.0.0/0, 0.0.0.0, 0.0.0.0/8", "all, none, 0.0.0.0/8"},
             {"unreadable and odd", "1.0.0.300, nones, **,, 012.0x1, \t1.1.1.1,", "10.0.0.1/32"},
             {"junk up to the comma", "1.0.0.1 x/1 all, 1.0.0.0/8x", "1.0.0.1/32, 1.0.0.0/8"},
             {"carriage return ends it", "1.0.0.1\r, 1.1.1.1", "1.0.0.1/32"},
             {"line feed ends it", "1.0.0.1 \n255.0.0.0, 1.1.1.1", "1.0.0.1/32"}});
    }

    void accessListsAreInTheOrderOfTheNetwork() {
        QVERIFY(!parseAccessList("") && parseAccessList(" "));
        const AccessListEntry expected{htonl(0x0a000201), htonl(0xffffff00)};
        QVERIFY(parseAccessList("10.0.2.1/24")->entries == std::vector{expected});
    }

    void accessListTextsEndWithTheEntryThatFillsThem() {
        const std::string first =
            QByteArray{"255.255.255.255 255.255.255.254, "}.repeated(7).toStdString();
        const std::string almostFull = first + "1.1.1.1/32, 11.1.1.1/32"; // 254 characters.
        const std::string full = first + "1.1.1.1/32, 11.11.1.1/32";
        const std::string one = ", 1.1.1.1/32";
        QCOMPARE(formatAccessList(*parseAccessList(almostFull + one + one)), almostFull + one);
        QCOMPARE(formatAccessList(*parseAccessList(full + one)), full);
    }
};

QTEST_GUILESS_MAIN(TestSettingValues)
#include "test_settingvalues.moc"
