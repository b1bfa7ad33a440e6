#include "config/settings.h"

#include <QTest>

#include <map>

/// The first case sees the store as the process starts with it.
class TestSettings : public QObject {
    Q_OBJECT

    static std::string shown(Setting *setting) {
        return setting->exchange(std::nullopt).value_or("absent");
    }

private slots:
    void settingsStartWithTheirDefaults() {
        for (const char *unknown : {"", "smtp.sock.por", "smtp.sock.ports", " smtp.sock.port"}) {
            QVERIFY2(!settingByKey(unknown, "1") && !settingByKey(unknown, std::nullopt), unknown);
        }
        const std::map<std::string, int> common{{"absent", 89}, {"", 31},   {" 0: 0", 2},
                                                {"yes", 12},    {"no", 20}, {"0", 35},
                                                {"120", 9},     {"20", 10}};
        std::map<std::string, int> counts;
        std::string special;
        for (Setting *setting : settings().all()) {
            const std::string text = shown(setting);
            ++counts[text];
            special += common.contains(text) ? "" : setting->key() + ('=' + text + ' ');
        }
        QCOMPARE(special.c_str(),
                 "poll.time=5 low.disc=5 low.mem=512 con.data.size=15 con.con.size=15 log.state=1 "
                 "store.state=1 log.buffer=8192 fetch.buffer=8192 smtp.sock.port=25 "
                 "imap.sock.port=143 pop.sock.port=110 proxy.external.sock.port=8080 "
                 "proxy.ftp.sock.port=8021 proxy.http.sock.port=8080 proxy.telnet.sock.port=8023 "
                 "proxy.socks.sock.port=1080 proxy.raudio.sock.port=7070 proxy.icp.sock.port=3130 "
                 "web.sock.port=80 nntp.sock.port=119 dialler.linktime=60 dialler.dialtime=30 "
                 "dialler.retrytime=5 ");
        for (const auto &[text, count] : common) {
            QVERIFY2(counts[text] == count, text.c_str());
        }
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
};

QTEST_GUILESS_MAIN(TestSettings)
#include "test_settings.moc"
