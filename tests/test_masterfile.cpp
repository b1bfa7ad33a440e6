#include "datafiles.h"

#include "config/masterfile.h"
#include "config/productpaths.h"
#include "config/settings.h"

#include <QElapsedTimer>

using namespace std::filesystem;

namespace {

const std::string master = productPaths().master;
const std::string masterTemplate = productPaths().masterTemplate;
const std::string portLine = "%smtp.sock.port: 2525\n";

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
            {{"blanks and tabs around", "%Admin.EMAIL: \t a:b \t\n", "a:b \t"},
             {"blank in the key", "%admin.email :a\n% admin.email:b\n", "none"},
             {"continuation lines", "%admin.email:a\n\tb\n \t c \nd\n#e\n %f:g",
              "a,b,c ,d,#e,%f:g"},
             {"empty and comment lines", "%admin.email:\n\ta\n \t \n|x\n\r\n\n\t|c\n", "a,|c"},
             {"CR-LF and lone CR", "%admin.email:a\r\n\tb\rx\n\rc\n", "a,b"},
             {"NUL", {"%admin.email:a\0x\n\0c\n\tb", 22}, "a,b"},
             {"later of two", "%admin.email:a\n%smtp.hosts:x\n%admin.email\r:b\n", ""},
             {"keys that are none", "x\n\tx\n%admin.email:a\n%no.such:x\n\tx\n%:x\n\tx\n", "a"}});
    }

    void writing() {
        settings().admin_email.value = "a, b,,|c";
        settings().smtp_hosts.value.reset();
        settings().smtp_direct.value = "";
        checkRows(
            formatMasterConfig,
            {{"comments", "|x\r\n| ,\n|", "|x\r\n| ,\n|"},
             {"empty and continuation lines", "\n\r\n\tx\n#y\n z\n", ""},
             {"commas", "%admin.email:x\n\ty\n", "%admin.email: a\n\t b\n\t\n\t|c\n"},
             {"absent list, empty text", "%pop.allow:all\n|\n%SMTP.direct:x",
              "%pop.allow: \n|\n%SMTP.direct: \n"},
             {"absent text", "%smtp.hosts:  x,y \r\n\tz\n", "%smtp.hosts:  x,y \r\n"},
             {"unknown keys", "%no.such:x\n%smtp.sock.port :x", "%no.such:x\n%smtp.sock.port :x"},
             {"no colon", "%smtp.sock.port\n%pop.sock.port", "%smtp.sock.port\n%pop.sock.port"}});
    }

    void randomTextsSurviveWritingAndReading() {
        std::mt19937 random{1};
        for (int round = 0; round < 500; ++round) {
            const std::string text = randomText(random, ",\r\n \t", 300) + "x,|,%:,#";
            settings().admin_email.value = text;
            const std::string bytes = formatMasterConfig("%smtp.hosts:\n%admin.email:");
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
        QElapsedTimer timer;
        timer.start();
        QCOMPARE(readMasterConfig(), 0);
        QVERIFY(timer.elapsed() < 60000);
        QCOMPARE(settings().admin_email.value.value_or("").size(), 100'000'000U);
        QCOMPARE(settings().smtp_sock_port.value, 2525);
    }

    void theTemplateReplacesTheMasterFile() {
        settings().smtp_sock_port.value = 2525;
        for (const char *lines : {"%smtp.sock.port:\n", "", "\n%smtp.sock.port:1\n"}) {
            rewriteFile(masterTemplate, lines);
            writeMasterConfig(); // The first time there is no master file.
            QVERIFY(readWholeFile(master) == (*lines == '\0' ? "" : portLine));
        }
        remove(masterTemplate);
        writeMasterConfig();
        QVERIFY(readWholeFile(master) == portLine);
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
