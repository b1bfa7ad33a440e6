#include "datafiles.h"

#include "fetch/pophosts.h"

class TestPopHosts : public QObject {
    Q_OBJECT

private slots:
    void parsing_data() {
        const std::string x31(31, 'x');
        const std::string full = x31 + ":" + x31 + "@" + x31 + x31 + "x";
        addRows({
            {"separators in runs", "\r\n,a:b@c\r\n,,d:e@h,\r", "*a:b@c\n*d:e@h\n"},
            {"prefixes of one entry", "**--a:b@c,d:e@h", "-*a:b@c\n*d:e@h\n"},
            {"prefix characters inside", "a-:*b@-c*", "*a-:*b@-c*\n"},
            {"blanks and high bytes", " -a\t: b @c d ,\t:f\344@h",
             "* -a\t: b @c d \n*\t:f\344@h\n"},
            {"separator missing", "a@c,a:b:c,d:e@h", "*d:e@h\n"},
            {"line break in the password", "a:b\nc@d", ""},
            {"rest of a dropped entry", "a@b:c@d", "*b:c@d\n"},
            {"ends behind the user", "a:b@c,d", "*a:b@c\n"},
            {"ends behind the colon", "a:b@c,d:", "*a:b@c\n"},
            {"ends behind the password", "a:b@c,d:e", "*a:b@c\n"},
            {"empty fields", ":@", "*:@\n"},
            {"server ends at a colon", "a:b@c:d@e", "*a:b@c\n*:d@e\n"},
            {"user of 32", x31 + "y:b@c", "*:b@c\n"},
            {"user of 33", x31 + "yz:b@c", "*z:b@c\n"},
            {"password of 32", "a:" + x31 + "y@c,d:e@h", "*d:e@h\n"},
            {"server of 63 and of 64", full + "\n" + full + "y,", "*" + full + "\n*" + full + "\n"},
            {"entry right behind a full server", full + "-d:e@h", "*" + full + "\n-*d:e@h\n"},
        });
    }
    void parsing() {
        QFETCH(const std::string, bytes);
        parsePopHosts("old:old@old");
        parsePopHosts(bytes);
        QTEST(formatPopHosts(), "expected");
    }

    void records() {
        parsePopHosts("-a:b@c");
        pop_host &host = *pop_host_list.head;
        QVERIFY(popHostText(host.user) == "a" && popHostText(host.password) == "b");
        QVERIFY(popHostText(host.server) == "c" && host.flags == 6);
        host.flags = 0;
        QCOMPARE(formatPopHosts(), std::string{"a:b@c\n"});
        parsePopHosts(std::nullopt);
        QVERIFY(pop_host_list.head == nullptr);
    }

    /// Up to 100 records: far more than 4095 bytes.
    void randomListsComeBack() {
        std::mt19937 random{1};
        for (int round = 0; round < 100; ++round) {
            std::string text;
            for (auto count = random() % 100; count > 0; --count) {
                text += random() % 2 == 0 ? "*x" : "-*x";
                text += randomText(random, ":@,\r\n", 30) + ':';
                text += randomText(random, ":@,\r\n", 31) + '@';
                text += randomText(random, ":@,\r\n", 62) + '\n';
            }
            parsePopHosts(text);
            QCOMPARE(formatPopHosts(), text);
        }
    }
};

QTEST_GUILESS_MAIN(TestPopHosts)
#include "test_pophosts.moc"
