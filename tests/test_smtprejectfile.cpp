#include "datafiles.h"

#include "config/settings.h"
#include "server/smtprejectfile.h"

namespace {

std::string rewritten(const std::string &bytes) {
    RecordChain<smtpreject_entry> list;
    parseSmtpRejects(bytes, list);
    return formatSmtpRejects(list);
}

} // namespace

class TestSmtpRejectFile : public QObject {
    Q_OBJECT

private slots:
    void reading_data() {
        const std::string x248(248, 'x');
        addRows({
            {"newest first, no final line feed", "a#b|\nb\nc", "c\nb\na#b|\n"},
            {"CR-LF and lone CR", "a\r\n\r\nb\rc\n", "b\na\n"},
            {"words behind white space", "a b\nc\td\ne\vf\ng\fh\n", "g\ne\nc\na\n"},
            {"comments and white space first", "#a\n|b\n \n\n c\n\td\n\ve\n\ff\n\rg\n", ""},
            {"unprintable first", "\001a\n\033b\n\177c\n\303\244d\n\240e\n\377f\n", ""},
            {"NUL and high bytes", {"a\240b\303\244 d\ne\0f\n\0g\n", 15}, "e\na\240b\303\244\n"},
            {"249", x248 + "1\nb\n", "b\n" + x248 + "1\n"},
            {"500", x248 + "1" + x248 + "234", "34\n" + x248 + "2\n" + x248 + "1\n"},
            {"rest that is a comment", x248 + "1#b\n", x248 + "1\n"},
        });
    }
    void reading() {
        QFETCH(const std::string, bytes);
        QTEST(rewritten(bytes), "expected");
    }

    void randomListsComeBack() {
        std::mt19937 random{1};
        for (int round = 0; round < 200; ++round) {
            std::string bytes;
            for (auto count = random() % 20; count > 0; --count) {
                bytes += 'a' + randomText(random, " \t\n\r\v\f", 248) + '\n';
            }
            QCOMPARE(rewritten(rewritten(bytes)), bytes);
        }
    }

    void filesAreReadAnewAndRewritten() {
        const std::string path = newPath();
        settings().mail_file_smtpreject.value = path;
        rewriteFile(path, "# comment\na and more\nb\n");
        readSmtpRejectFile();
        readSmtpRejectFile();
        writeSmtpRejectFile();
        QCOMPARE(readWholeFile(path).value_or("none"), std::string{"b\na\n"});
        forUnusablePaths(settings().mail_file_smtpreject.value, [] {
            prependRecord(&smtpreject_list.head, {"a"});
            writeSmtpRejectFile();
            readSmtpRejectFile();
            QVERIFY(smtpreject_list.head == nullptr);
        });
    }
};

QTEST_GUILESS_MAIN(TestSmtpRejectFile)
#include "test_smtprejectfile.moc"
