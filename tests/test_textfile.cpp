#include "datafiles.h"

#include "platform/process.h"

#include <QDir>

#include <csignal>
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace {

const std::string folder = TEST_PRODUCT;
const std::string file = folder + "/file";
const std::string fifo = folder + "/fifo";

struct Failing {
    int fallocateError = 0; ///< None.
    int writesLeft = -1;    ///< No end.
} failing;

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

// Of these two the program finds the test's rather than the C library's.

int fallocate(int fd, int mode, off_t offset, off_t len) {
    errno = failing.fallocateError;
    return errno != 0 ? -1 : static_cast<int>(syscall(SYS_fallocate, fd, mode, offset, len));
}

ssize_t write(int fd, const void *buf, std::size_t n) {
    if (failing.writesLeft == 0) {
        errno = EIO;
        return -1;
    }
    failing.writesLeft -= failing.writesLeft > 0 ? 1 : 0;
    return syscall(SYS_write, fd, buf, n);
}

class TestTextFile : public QObject {
    Q_OBJECT

private slots:
    void initTestCase() { prepareProcess(); }

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
            QVERIFY2(!readWholeFile(path).bytes && !rewriteFile(path, "bytes"), path.c_str());
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
        struct stat before = {};
        QCOMPARE(stat(file.c_str(), &before), 0);
        QVERIFY(rewriteFile(link, "short") && bytesAt(file) == "short");
        struct stat after = {};
        QCOMPARE(stat(file.c_str(), &after), 0);
        QVERIFY(after.st_ino == before.st_ino && after.st_mode == before.st_mode);
    }

    void withoutRoomTheOldFileStays() {
        const std::string contents(200'000, 'n');
        using Case = std::tuple<int, int, rlim_t, std::size_t>;
        for (const auto &[fallocateError, writesLeft, sizeLimit, newBytes] :
             {Case{0, -1, RLIM_INFINITY, 200'000}, Case{EOPNOTSUPP, -1, RLIM_INFINITY, 200'000},
              Case{ENOSPC, -1, RLIM_INFINITY, 0}, Case{0, -1, 199'999, 0},
              Case{0, 0, RLIM_INFINITY, 0}, Case{0, 2, RLIM_INFINITY, 128'000}}) {
            QVERIFY(rewriteFile(file, std::string(150'000, 'o')));
            rlimit before{};
            getrlimit(RLIMIT_FSIZE, &before);
            const rlimit limit{sizeLimit, before.rlim_max};
            setrlimit(RLIMIT_FSIZE, &limit);
            failing = {fallocateError, writesLeft};
            const bool isWritten = rewriteFile(file, [&](ByteSink &sink) {
                for (int piece = 0; piece < 50; ++piece) {
                    sink.put(std::string_view{contents}.substr(0, 4000));
                }
            });
            failing = {};
            setrlimit(RLIMIT_FSIZE, &before);
            QCOMPARE(isWritten, newBytes == contents.size());
            const std::size_t oldBytes = newBytes < 150'000 ? 150'000 - newBytes : 0;
            QVERIFY(bytesAt(file) == std::string(newBytes, 'n') + std::string(oldBytes, 'o'));
        }
        const auto failingFormat = [](ByteSink & /*sink*/) { throw std::bad_alloc{}; };
        QVERIFY_EXCEPTION_THROWN(rewriteFile(file, failingFormat), std::bad_alloc);
        QVERIFY(bytesAt(file).starts_with('n'));
    }

    void whatWasNotReadWholeIsNeverRewritten() {
        const std::string broken = "/proc/self/mem"; // Opens, but cannot be read from its start.
        const std::string loop = folder + "/loop";
        QVERIFY(symlink("loop", loop.c_str()) == 0 && rewriteFile(file, "old"));
        const auto take = [](const FileBytes &bytes) {
            if (std::string_view{bytes} == "much") {
                throw std::bad_alloc{};
            }
        };
        const auto format = [](ByteSink &sink) { sink.put("new"); };
        ProductFile product;
        for (const auto &[path, bytes, result, expected] : {std::tuple{file, "old", 0, "new"},
                                                            {file, "much", 2, "much"},
                                                            {folder + "/none", "", 1, "new"}}) {
            if (*bytes != '\0') {
                rewriteFile(path, bytes);
            }
            QCOMPARE(product.read(path, take), result);
            product.rewrite(path, format);
            QVERIFY(bytesAt(path) == expected);
        }
        for (const std::string &path : {broken, loop, folder}) {
            QCOMPARE(product.read(path, take), 1);
            product.rewrite(file, format);
            QVERIFY(bytesAt(file) == "much");
        }
    }

    /// Around the size of the buffer, in pieces and in one.
    void longContentsArriveInTheirOrder() {
        std::mt19937 random{1};
        for (const std::size_t size : {65'535, 65'536, 65'537, 200'000}) {
            std::string bytes(size, '\0');
            std::ranges::generate(bytes, [&] { return static_cast<char>(random()); });
            for (const std::size_t piece : {size, std::size_t{4099}}) {
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
