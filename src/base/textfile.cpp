#include "base/textfile.h"

#include "base/bulkmemory.h"

#include <cerrno>
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <unistd.h>

namespace {

class FileDescriptor {
public:
    FileDescriptor(const std::string &path, int flags, mode_t newFileMode = 0)
        : number_{opened(path.c_str(), flags | O_CLOEXEC | O_NOCTTY, newFileMode)} {}
    FileDescriptor(const FileDescriptor &) = delete;
    FileDescriptor &operator=(const FileDescriptor &) = delete;
    ~FileDescriptor() {
        if (isOpen()) {
            ::close(number_);
        }
    }

    [[nodiscard]] bool isOpen() const { return number_ >= 0; }
    [[nodiscard]] int number() const { return number_; }

private:
    static int opened(const char *path, int flags, mode_t newFileMode) {
        // A pipe must not make the program wait for its other end. A regular file that someone
        // holds a lease on would fail here as well; it is worth the wait until the lease is given
        // up.
        const int number = ::open(path, flags | O_NONBLOCK, newFileMode);
        struct stat status = {};
        if (number < 0 && errno == EWOULDBLOCK && ::stat(path, &status) == 0 &&
            S_ISREG(status.st_mode)) {
            return ::open(path, flags, newFileMode);
        }
        return number;
    }

    int number_;
};

/// Counts the bytes, and writes them once there is a file for them.
class FileSink : public ByteSink {
public:
    /// How many bytes there were since the beginning, or since there is a file.
    [[nodiscard]] std::size_t count() const { return count_; }
    void writeTo(int file) {
        file_ = file;
        count_ = 0;
    }
    [[nodiscard]] bool isWhole() const { return isWhole_; }

protected:
    void take(std::string_view bytes) override {
        count_ += bytes.size();
        while (file_ >= 0 && isWhole_ && !bytes.empty()) {
            const ssize_t count = ::write(file_, bytes.data(), bytes.size());
            if (count > 0) {
                bytes.remove_prefix(static_cast<std::size_t>(count));
            } else {
                isWhole_ = count < 0 && errno == EINTR;
            }
        }
    }

private:
    int file_ = -1;
    std::size_t count_ = 0;
    bool isWhole_ = true;
};

/// Whether the file system says that it has room for `size` bytes more; some say nothing.
bool hasFreeSpace(int file, std::size_t size) {
    struct statvfs system = {};
    return ::fstatvfs(file, &system) != 0 || system.f_blocks == 0 ||
           system.f_bavail * system.f_frsize >= size;
}

/// Gives back what room the file has behind its end.
void giveRoomBack(int file) {
    struct stat status = {};
    if (::fstat(file, &status) == 0) {
        [[maybe_unused]] const int result = ::ftruncate(file, status.st_size);
    }
}

/// Has room for `size` bytes set aside for the file; where the file system cannot do that, asks
/// whether there is as much. False when there is none.
bool takeRoom(int file, const struct stat &status, std::size_t size) {
    rlimit limit{};
    if (::getrlimit(RLIMIT_FSIZE, &limit) == 0 && limit.rlim_cur < size) {
        return false;
    }
    if (size == 0) {
        return true;
    }
    int result = 0;
    do {
        result = ::fallocate(file, FALLOC_FL_KEEP_SIZE, 0, static_cast<off_t>(size));
    } while (result != 0 && errno == EINTR);
    if (result == 0) {
        return true;
    }
    if (errno != ENOSPC && errno != EDQUOT && errno != EFBIG) {
        // What a file with holes has may lie behind them.
        const off_t had = status.st_blocks * 512;
        const auto usable = static_cast<std::size_t>(had < status.st_size ? 0 : had);
        return size <= usable || hasFreeSpace(file, size - usable);
    }
    giveRoomBack(file); // A call that fails keeps what it got by then.
    return false;
}

} // namespace

FileRead readWholeFile(const std::string &path) {
    const FileDescriptor file{path, O_RDONLY};
    if (!file.isOpen()) {
        return {std::nullopt, errno == ENOENT};
    }
    struct stat status = {};
    if (::fstat(file.number(), &status) != 0 || !S_ISREG(status.st_mode)) {
        return {};
    }
    // One byte more than the size, so that the end is found without growing; a file that says
    // nothing of its size, or grows meanwhile, is read to its end all the same.
    std::size_t size = static_cast<std::size_t>(status.st_size) + 1;
    FileBytes read{std::unique_ptr<char[]>{newBulk<char>(size)}};
    for (;;) {
        const ssize_t count =
            ::read(file.number(), read.bytes.get() + read.length, size - read.length);
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count < 0) {
            return {};
        }
        if (count == 0) {
            return {std::move(read)};
        }
        read.length += static_cast<std::size_t>(count);
        if (read.length == size) {
            size = 2 * size + 4096;
            std::unique_ptr<char[]> larger{newBulk<char>(size)};
            std::memcpy(larger.get(), read.bytes.get(), read.length);
            read.bytes = std::move(larger);
        }
    }
}

bool rewriteFile(const std::string &path, const std::function<void(ByteSink &)> &format,
                 mode_t newFileMode) {
    FileSink sink;
    format(sink);
    sink.flush();
    const FileDescriptor file{path, O_WRONLY | O_CREAT, newFileMode};
    struct stat status = {};
    if (!file.isOpen() || ::fstat(file.number(), &status) != 0) {
        return false;
    }
    const bool isRegular = S_ISREG(status.st_mode);
    if (isRegular && !takeRoom(file.number(), status, sink.count())) {
        return false;
    }
    sink.writeTo(file.number());
    format(sink);
    sink.flush();
    if (!sink.isWhole()) {
        giveRoomBack(file.number());
        return false;
    }
    // Only now, and only behind what was written: to cut it first would give the room away again.
    const bool isCut =
        !isRegular || ::ftruncate(file.number(), static_cast<off_t>(sink.count())) == 0;
    // Before the next file is touched. What is no file, or on no disk, cannot, and need not.
    return (::fdatasync(file.number()) == 0 || errno == EINVAL || errno == EROFS) && isCut;
}

bool rewriteFile(const std::string &path, std::string_view bytes) {
    return rewriteFile(path, [bytes](ByteSink &sink) { sink.put(bytes); });
}

void ProductFile::rewrite(const Path &path, const std::function<void(ByteSink &)> &format,
                          mode_t newFileMode) const {
    try {
        if (path && isWhole_) {
            rewriteFile(*path, format, newFileMode);
        }
    } catch (const std::bad_alloc &) { // Like every failed write: nothing is reported.
    }
}

bool mayRewrite(const std::string &path) {
    const auto isAllowed = [](const std::string &file, int rights) {
        return ::faccessat(AT_FDCWD, file.c_str(), rights, AT_EACCESS) == 0;
    };
    if (isAllowed(path, W_OK)) {
        return true;
    }
    const std::size_t folderEnd = path.rfind('/');
    return errno == ENOENT && folderEnd != std::string::npos &&
           isAllowed(path.substr(0, folderEnd + 1), W_OK | X_OK);
}
