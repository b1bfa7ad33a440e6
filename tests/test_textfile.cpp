#include "datafiles.h"

#include <QDir>

#include <csignal>
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

const std::string folder = TEST_PRODUCT;
const std::string file = folder + "/file";
const std::string fifo = folder + "/fifo";

/// The pieces, each with a semicolon behind it.
std::string cut(std::string_view bytes, std::size_t longest) {
    std::string text;
    LinePieces pieces{bytes, longest};
    while (const auto piece = pieces.next()) {
        text += std::string{*piece} + ';';
    }
    return text;
}

} // namespace

class TestTextFile : public QObject {
    Q_OBJECT

private slots:
    void init() {
        QDir{TEST_PRODUCT}.removeRecursively();
        QVERIFY(QDir{}.mkpath(TEST_PRODUCT) && mkfifo(fifo.c_str(), 0600) == 0);
    }

    void filesComeBackByteForByte() {
        for (const std::string &bytes : {std::string{"a\r\n\0\xff", 5}, std::string{}}) {
            QVERIFY(rewriteFile(file, bytes) && bytesAt(file) == bytes);
        }
        // Says that it is empty, but is not.
        QVERIFY(bytesAt("/proc/self/status").starts_with("Name:"));
    }

    void whatIsNoFileIsNeitherReadNorWritten() {
        for (const std::string &path : {folder, fifo, fifo + "/x", std::string{"/dev/full"}}) {
            QVERIFY2(!readWholeFile(path) && !rewriteFile(path, "bytes"), path.c_str());
        }
        // A pipe takes what it has room for; the rest must not be waited for.
        const int reader = open(fifo.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
        QVERIFY(!rewriteFile(fifo, std::string(2'000'000, 'x')));
        close(reader);
    }

    /// Rights are not what stops the tests' user; a folder that is not there is.
    void foretellsWhetherAFileCanBeWritten() {
        QVERIFY(mayRewrite(folder + "/new") &&
                !QFile::exists(QString::fromStdString(folder + "/new")));
        QVERIFY(rewriteFile(file, "x") && mayRewrite(file) && bytesAt(file) == "x");
        QVERIFY(!mayRewrite(folder + "/no/new") && !mayRewrite(file + "/new") && !mayRewrite(""));
    }

    void linksAndModeStay() {
        const std::string link = folder + "/link";
        QVERIFY(rewriteFile(file, "a longer text") && chmod(file.c_str(), 0640) == 0);
        QCOMPARE(symlink("file", link.c_str()), 0);
        struct stat before {};
        QCOMPARE(stat(file.c_str(), &before), 0);
        QVERIFY(rewriteFile(link, "short") && bytesAt(file) == "short");
        struct stat after {};
        QCOMPARE(stat(file.c_str(), &after), 0);
        QVERIFY(after.st_ino == before.st_ino && after.st_mode == before.st_mode);
    }

    void withoutRoomTheOldFileStays() {
        QVERIFY(rewriteFile(file, "old"));
        rlimit before{};
        getrlimit(RLIMIT_FSIZE, &before);
        const rlimit limit{10, before.rlim_max};
        setrlimit(RLIMIT_FSIZE, &limit);
        const bool isWritten = rewriteFile(file, "more than ten bytes");
        setrlimit(RLIMIT_FSIZE, &before);
        QVERIFY(!isWritten && bytesAt(file) == "old");
        int calls = 0;
        QVERIFY_EXCEPTION_THROWN(rewriteFile(file,
                                             [&](ByteSink &) {
                                                 ++calls;
                                                 throw std::bad_alloc{};
                                             }),
                                 std::bad_alloc);
        QVERIFY(calls == 1 && bytesAt(file) == "old");
    }

    /// Around the size of the buffer, in pieces and in one.
    void longContentsArriveInTheirOrder() {
        std::mt19937 random{1};
        for (const std::size_t size : {65'535, 65'536, 65'537, 200'000}) {
            std::string bytes(size, '\0');
            std::ranges::generate(bytes, [&] { return static_cast<char>(random()); });
            for (const std::size_t piece : {size, std::size_t{1}, std::size_t{4099}}) {
                QVERIFY(rewriteFile(file, [&](ByteSink &sink) {
                    sink.put('<');
                    for (std::size_t at = 0; at < size; at += piece) {
                        sink.put(std::string_view{bytes}.substr(at, piece));
                    }
                }));
                QVERIFY(bytesAt(file) == '<' + bytes);
            }
        }
    }

    void linesAreCutAtTheirEndAndAtTheLimit() {
        checkRows([](const std::string &bytes) { return cut(bytes, 4); }, "[pieces of 4]");
        QCOMPARE(cut("abcdefg\nh\n", LinePieces<std::string_view>::unlimited),
                 std::string{"abcdefg\n;h\n;"});
    }
};

QTEST_GUILESS_MAIN(TestTextFile)
#include "test_textfile.moc"
