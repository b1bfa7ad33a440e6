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

    void noiseAndALineOf100MegabytesHideNothing() {
        std::mt19937 random{1};
        std::string bytes = randomText(random, "", 200'000) + "\n%admin.email:";
        bytes.resize(bytes.size() + 100'000'000, ',');
        rewriteFile(master, bytes + "\n" + portLine);
        QCOMPARE(readMasterConfig(), 0);
        QCOMPARE(settings().admin_email.value.value_or("").size(), 100'000'000U);
        QCOMPARE(settings().smtp_sock_port.value, 2525);
    }
};

QTEST_GUILESS_MAIN(TestMasterFile)
#include "test_masterfile.moc"
