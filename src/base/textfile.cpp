#include "base/textfile.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <fcntl.h>
#include <filesystem>
#include <limits>
#include <sys/file.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <unistd.h>
#include <utility>

namespace fs = std::filesystem;

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
        // holds a lease on, such as a file server, would fail here as well; it is worth the wait
        // until the lease is given up.
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

constexpr std::size_t unlimited = std::numeric_limits<off_t>::max();

/// Whether the file system says that it has `size` bytes left; some say nothing.
bool hasSpaceLeft(int file, std::size_t size) {
    struct statvfs system = {};
    return ::fstatvfs(file, &system) != 0 || system.f_blocks == 0 ||
           system.f_bavail * system.f_frsize >= size;
}

/// Cuts the file to at most `longest` bytes, and gives back the space that it has behind its end.
/// Never makes it longer: another process may have cut it meanwhile.
bool cut(int file, std::size_t longest) {
    struct stat status = {};
    if (::fstat(file, &status) != 0) {
        return false;
    }
    const off_t size = std::min(status.st_size, static_cast<off_t>(longest));
    while (::ftruncate(file, size) != 0) {
        if (errno != EINTR) {
            return false;
        }
    }
    return true;
}

/// Sets space for `size` bytes aside for the file; where the file system cannot do that, asks
/// whether there is as much beside what the file has. False when there is not.
bool setSpaceAside(int file, off_t oldSize, std::size_t size) {
    rlimit limit{};
    if (::getrlimit(RLIMIT_FSIZE, &limit) == 0 && limit.rlim_cur < size) {
        return false;
    }
    if (size == 0 || ::fallocate(file, FALLOC_FL_KEEP_SIZE, 0, static_cast<off_t>(size)) == 0) {
        return true;
    }
    if (errno != ENOSPC && errno != EDQUOT && errno != EFBIG) {
        const auto had = static_cast<std::size_t>(oldSize);
        return size <= had || hasSpaceLeft(file, size - had);
    }
    cut(file, unlimited); // A call that fails keeps what it got by then.
    return false;
}

/// The folder that the file at the path, or at the end of the link there, stands in.
fs::path folderOf(fs::path path) {
    constexpr int mostLinks = 40; // As many as the system follows.
    std::error_code unknown;
    for (int links = 0; links < mostLinks && fs::is_symlink(path, unknown); ++links) {
        path = path.parent_path() / fs::read_symlink(path, unknown);
    }
    return path.has_parent_path() ? path.parent_path() : ".";
}

bool writeAll(int file, std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t count = ::write(file, bytes.data(), bytes.size());
        if (count > 0) {
            bytes.remove_prefix(static_cast<std::size_t>(count));
        } else if (count == 0 || errno != EINTR) {
            return false;
        }
    }
    return true;
}

} // namespace

FileRead readWholeFile(const std::string &path) {
    const FileDescriptor file{path, O_RDONLY};
    if (!file.isOpen()) {
        return {std::nullopt, errno == ENOENT || errno == ENOTDIR};
    }
    struct stat status = {};
    if (::fstat(file.number(), &status) != 0 || !S_ISREG(status.st_mode)) {
        return {};
    }
    // A file that says nothing of its size, or grows meanwhile, is read to its end all the same.
    std::string bytes;
    bytes.reserve(static_cast<std::size_t>(status.st_size));
    std::array<char, 65'536> piece{};
    for (;;) {
        const ssize_t count = ::read(file.number(), piece.data(), piece.size());
        if (count == 0) {
            return {std::move(bytes)};
        }
        if (count > 0) {
            bytes.append(piece.data(), static_cast<std::size_t>(count));
        } else if (errno != EINTR) {
            return {};
        }
    }
}

bool rewriteFile(const std::string &path, std::string_view bytes, mode_t newFileMode) {
    const FileDescriptor file{path, O_WRONLY | O_CREAT, newFileMode};
    struct stat status = {};
    if (!file.isOpen() || ::fstat(file.number(), &status) != 0) {
        return false;
    }
    const bool isRegular = S_ISREG(status.st_mode);
    if (isRegular && !setSpaceAside(file.number(), status.st_size, bytes.size())) {
        return false;
    }
    if (!writeAll(file.number(), bytes)) {
        cut(file.number(), unlimited);
        return false;
    }
    // Only now, and only behind what was written: to cut it first would give the space away again.
    const bool isCut = !isRegular || cut(file.number(), bytes.size());
    // Before the next file is touched. What is no file, or on no disk, cannot, and need not.
    return (::fdatasync(file.number()) == 0 || errno == EINVAL || errno == EROFS) && isCut;
}

int rewritingError(const std::string &path) {
    const auto error = [](int result) { return result == 0 ? 0 : errno; };
    const int ofFile = error(::access(path.c_str(), W_OK));
    return ofFile == ENOENT ? error(::access(folderOf(path).c_str(), W_OK | X_OK)) : ofFile;
}

std::shared_ptr<void> lockFolderOf(const std::string &path) {
    auto folder = std::make_shared<FileDescriptor>(folderOf(path), O_RDONLY | O_DIRECTORY);
    while (::flock(folder->number(), LOCK_EX) != 0 && errno == EINTR) {
    }
    return folder;
}
