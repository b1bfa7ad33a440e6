#include "base/productfile.h"

#include "datafiles.h"

#include "platform/process.h"

#include <QDir>

#include <csignal>
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

const std::string folder = TEST_PRODUCT;
const std::string file = folder + "/file";
const std::string fifo = folder + "/fifo";

constexpr std::size_t writtenAtOnce = 65'536;

/// What the file system does not do.
struct Fault {
    int fallocateError = 0; ///< None.
    int writesLeft = -1;    ///< No end.
    fsblkcnt_t blocks = 0;  ///< Of a thousand bytes; 0 where it does not say.
    fsblkcnt_t blocksLeft = 0;
    rlim_t longestFile = RLIM_INFINITY;
    int interruptions = 0;       ///< Of cutting the file.
    bool isCutMeanwhile = false; ///< By another process, when it has been written.
} present;

std::string done; ///< "w" for each write, "s" for each time that a file is put on the disk.

} // namespace

// Of these the program finds the test's rather than the C library's.

int fallocate(int fd, int mode, off_t offset, off_t len) {
    const int error = present.fallocateError;
    // A full disk gives what it has, and says then that it was not enough.
    const long result =
        error == 0 || error == ENOSPC ? syscall(SYS_fallocate, fd, mode, offset, len) : -1;
    errno = error == 0 ? errno : error;
    return error == 0 ? static_cast<int>(result) : -1;
}

int fstatvfs(int /*fd*/, struct statvfs *buf) {
    buf->f_blocks = present.blocks;
    buf->f_bavail = present.blocksLeft;
    buf->f_frsize = 1000;
    return 0;
}

ssize_t write(int fd, const void *buf, std::size_t n) {
    if (present.writesLeft == 0) {
        errno = EIO;
        return -1;
    }
    present.writesLeft -= present.writesLeft > 0 ? 1 : 0;
    done += 'w';
    const long count = syscall(SYS_write, fd, buf, std::min(n, writtenAtOnce));
    if (present.isCutMeanwhile) {
        syscall(SYS_ftruncate, fd, 0L);
    }
    return count;
}

int ftruncate(int fd, off_t length) {
    errno = EINTR;
    return present.interruptions-- > 0 ? -1 : static_cast<int>(syscall(SYS_ftruncate, fd, length));
}

int fdatasync(int /*fildes*/) {
    done += 's';
    return 0;
}

class TestTextFile : public QObject {
    Q_OBJECT

private slots:
    void initTestCase() { prepareProcess(); }

    void init() {
        QDir{TEST_PRODUCT}.removeRecursively();
        QVERIFY(QDir{}.mkpath(TEST_PRODUCT) && mkfifo(fifo.c_str(), 0600) == 0);
    }

    /// Around the sizes in which they are read and written.
    void filesComeBackByteForByte() {
        std::mt19937 random{1};
        for (const std::size_t size : {0, 5, 65'535, 65'536, 65'537, 200'000}) {
            std::string bytes(size, '\0');
            std::ranges::generate(bytes, [&] { return static_cast<char>(random()); });
            QVERIFY2(rewriteFile(file, bytes) && bytesAt(file) == bytes,
                     std::to_string(size).c_str());
        }
        // Says that it is empty, but is not.
        QVERIFY(bytesAt("/proc/self/status").starts_with("Name:"));
    }

    void aFileIsOnTheDiskBeforeTheNextIsTouched() {
        done.clear();
        QVERIFY(rewriteFile(file, "a") && rewriteFile(file, "b"));
        QCOMPARE(done, "wsws");
    }

    void aPipeTakesWhatFitsIntoIt() {
        const int reader = open(fifo.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
        QVERIFY(!rewriteFile(fifo, std::string(2'000'000, 'x')));
        close(reader);
    }

    /// A file server that holds a lease on a file gives it up when asked.
    void aLeaseIsWaitedFor() {
        for (const bool isRead : {true, false}) {
            QVERIFY(rewriteFile(file, "old"));
            std::array<int, 2> ends{};
            QCOMPARE(pipe(ends.data()), 0);
            const pid_t holder = fork();
            if (holder == 0) {
                const int leased = open(file.c_str(), O_RDWR | O_CLOEXEC);
                if (fcntl(leased, F_SETLEASE, F_WRLCK) == 0 && write(ends[1], "x", 1) == 1) {
                    pause(); // The signal that asks ends it.
                }
                _exit(0);
            }
            close(ends[1]);
            char ready = 0;
            const bool isLeased = read(ends[0], &ready, 1) == 1;
            close(ends[0]);
            const bool isDone = isRead ? bytesAt(file) == "old" : rewriteFile(file, "new");
            kill(holder, SIGKILL);
            waitpid(holder, nullptr, 0);
            QVERIFY2(isDone, isRead ? "read" : "written");
            if (!isLeased) {
                QWARN("left out, cannot be had here: a lease");
            }
        }
    }

    void withoutSpaceTheOldFileStays() {
        constexpr std::size_t whole = 200'000;
        struct Case {
            const char *name;
            Fault fault;
            std::size_t newBytes;
            std::size_t oldBytes = 150'000;
        };
        const Case cases[]{
            {"full", {.fallocateError = ENOSPC}, 0},
            {"enough", {.fallocateError = EOPNOTSUPP, .blocks = 1, .blocksLeft = 50}, whole},
            {"too little", {.fallocateError = EOPNOTSUPP, .blocks = 1, .blocksLeft = 49}, 0},
            {"no more than there was", {.fallocateError = EOPNOTSUPP, .blocks = 1}, whole, whole},
            {"space not known", {.fallocateError = EOPNOTSUPP}, whole},
            {"limit", {.longestFile = whole - 1}, 0},
            {"no write", {.writesLeft = 0}, 0},
            {"two writes", {.writesLeft = 2}, 2 * writtenAtOnce}};
        for (const auto &[name, fault, newBytes, oldBytes] : cases) {
            const std::string old(oldBytes, 'o');
            QVERIFY2(rewriteFile(file, old), name);
            struct stat before = {};
            stat(file.c_str(), &before);
            rlimit unlimited{};
            getrlimit(RLIMIT_FSIZE, &unlimited);
            const rlimit limit{.rlim_cur = fault.longestFile, .rlim_max = unlimited.rlim_max};
            setrlimit(RLIMIT_FSIZE, &limit);
            present = fault;
            const bool isWritten = rewriteFile(file, std::string(whole, 'n'));
            present = {};
            setrlimit(RLIMIT_FSIZE, &unlimited);
            QVERIFY2(isWritten == (newBytes == whole), name);
            const std::string kept = old.substr(std::min(newBytes, old.size()));
            QVERIFY2(bytesAt(file) == std::string(newBytes, 'n') + kept, name);
            struct stat after = {};
            stat(file.c_str(), &after);
            QVERIFY2(isWritten || after.st_blocks <= before.st_blocks, name);
        }
    }

    void theCutOnlyShortens() {
        QVERIFY(rewriteFile(file, std::string(1000, 'o')));
        present = {.interruptions = 1};
        QVERIFY(rewriteFile(file, "n") && bytesAt(file) == "n");
        present = {.isCutMeanwhile = true};
        QVERIFY(rewriteFile(file, "new") && bytesAt(file).empty());
        present = {};
    }

    void whatWasNotReadWholeIsNeverRewritten() {
        const std::string broken = "/proc/self/mem"; // Opens, but cannot be read from its start.
        const std::string loop = folder + "/loop";
        QVERIFY(symlink("loop", loop.c_str()) == 0 && rewriteFile(file, "old"));
        const auto take = [](const std::string &bytes) {
            if (bytes == "much") {
                throw std::bad_alloc{};
            }
        };
        const auto format = [](std::string &bytes) { bytes += "new"; };
        ProductFile product;
        for (const auto &[path, bytes, result, expected] : {std::tuple{file, "old", 0, "new"},
                                                            {file, "much", 2, "much"},
                                                            {folder + "/none", "", 1, "new"}}) {
            if (*bytes != '\0') {
                rewriteFile(path, bytes);
            }
            QVERIFY2(product.read(path, take) == result, bytes);
            product.rewrite(format);
            QVERIFY2(bytesAt(path) == expected, bytes);
        }
        const auto formatMuch = [](std::string & /*bytes*/) { throw std::bad_alloc{}; };
        product.rewrite(formatMuch);
        QVERIFY(bytesAt(folder + "/none") == "new");
        for (const std::string &path : {broken, loop, folder}) {
            QVERIFY2(product.read(path, take) == 1, path.c_str());
            QVERIFY2(!product.rewrite(format) && product.obstacle(), path.c_str());
        }
    }
};

QTEST_GUILESS_MAIN(TestTextFile)
#include "test_textfile.moc"
