#include "datafiles.h"

#include "config/masterfile.h"
#include "config/productpaths.h"
#include "config/settings.h"

using namespace std::filesystem;

namespace {

const std::string master = productPaths().master;
const std::string masterTemplate = productPaths().masterTemplate;
const std::string portLine = "%smtp.sock.port: 2525\n";

std::string filled(const std::string &lines) {
    std::string bytes;
    formatMasterConfig(lines, bytes);
    return bytes;
}

} // namespace

class TestMasterFile : public QObject {
    Q_OBJECT

private slots:
    void init() {
        newPath();
        create_directories(path{masterTemplate}.parent_path());
        settings().admin_email.value.reset();
        settings().smtp_sock_port.value = 25;
    }

    void reading() {
        checkRows(
            [this](const std::string &bytes) {
                init();
                parseMasterConfig(bytes);
                return settings().admin_email.value.value_or("none");
            },
            "[reading the master file]");
    }

    void writing() {
        settings().admin_email.value = "a, b,,|c";
        settings().smtp_hosts.value.reset();
        settings().smtp_direct.value = "";
        checkRows(filled, "[writing the master file]");
    }

    void randomTextsSurviveWritingAndReading() {
        std::mt19937 random{1};
        for (int round = 0; round < 500; ++round) {
            const std::string text = randomText(random, ",\r\n \t", 300) + "x,|,%:,#";
            settings().admin_email.value = text;
            const std::string bytes = filled("%smtp.hosts:\n%admin.email:");
            settings().admin_email.value.reset();
            parseMasterConfig(bytes);
            QCOMPARE(settings().admin_email.value.value_or("none"), text);
        }
    }

    void noiseAndALineOf100MegabytesHideNothing() {
        std::mt19937 random{1};
        std::string bytes = randomText(random, "", 200'000) + "\n%admin.email:";
        bytes.resize(bytes.size() + 100'000'000, ',');
        rewriteFile(master, bytes + "\n" + portLine);
        QCOMPARE(readMasterConfig(), 0);
        QCOMPARE(settings().admin_email.value.value_or("").size(), 100'000'000U);
        QCOMPARE(settings().smtp_sock_port.value, 2525);
    }

    void theTemplateReplacesTheMasterFile() {
        settings().smtp_sock_port.value = 2525;
        for (const char *lines : {"%smtp.sock.port:\n", "", "\n%smtp.sock.port:1\n"}) {
            rewriteFile(masterTemplate, lines);
            writeMasterConfig(); // The first time there is no master file.
            QVERIFY(bytesAt(master) == (*lines == '\0' ? "" : portLine));
        }
        remove(masterTemplate);
        writeMasterConfig();
        QVERIFY(bytesAt(master) == portLine);
    }

    void aMasterFileThatIsNoFileIsPassedOver() {
        QCOMPARE(readMasterConfig(), 1);
        rewriteFile(masterTemplate, portLine);
        create_directory(master);
        writeMasterConfig();
        QCOMPARE(readMasterConfig(), 1);
        QCOMPARE(settings().smtp_sock_port.value, 25);
    }
};

QTEST_GUILESS_MAIN(TestMasterFile)
#include "test_masterfile.moc"
