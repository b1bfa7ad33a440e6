#include "base/textfile.h"

#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <new>
#include <sys/stat.h>
#include <unistd.h>

namespace {

class FileDescriptor {
public:
    FileDescriptor(const std::string &path, int flags)
        : number_{opened(path.c_str(), flags | O_CLOEXEC | O_NOCTTY)} {}
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
    static int opened(const char *path, int flags) {
        // A pipe must not make the program wait for its other end. A regular file that someone
        // holds a lease on would fail here as well; it is worth the wait until the lease is given
        // up.
        const int number = ::open(path, flags | O_NONBLOCK, 0666);
        struct stat status {};
        if (number < 0 && errno == EWOULDBLOCK && ::stat(path, &status) == 0 &&
            S_ISREG(status.st_mode)) {
            return ::open(path, flags, 0666);
        }
        return number;
    }

    int number_;
};

/// Keeps a write past the file size limit, or into a pipe that nobody reads, from ending the
/// process: the write then fails like any other. What stood before is put back, for the commands
/// that the program runs inherit it.
class WriteSignalsIgnored {
public:
    WriteSignalsIgnored()
        : sizeLimit_{std::signal(SIGXFSZ, SIG_IGN)}, pipe_{std::signal(SIGPIPE, SIG_IGN)} {}
    WriteSignalsIgnored(const WriteSignalsIgnored &) = delete;
    WriteSignalsIgnored &operator=(const WriteSignalsIgnored &) = delete;
    ~WriteSignalsIgnored() {
        std::signal(SIGXFSZ, sizeLimit_);
        std::signal(SIGPIPE, pipe_);
    }

private:
    void (*sizeLimit_)(int);
    void (*pipe_)(int);
};

} // namespace

std::optional<std::string> readWholeFile(const std::string &path) {
    const FileDescriptor file{path, O_RDONLY};
    struct stat status {};
    if (!file.isOpen() || ::fstat(file.number(), &status) != 0 || !S_ISREG(status.st_mode)) {
        return std::nullopt;
    }
    if (static_cast<std::size_t>(status.st_size) >= std::string{}.max_size()) {
        throw std::bad_alloc{}; // The string would throw something else.
    }
    // One byte more than the size, so that the end is found without growing; a file that says
    // nothing of its size, or grows meanwhile, is read to its end all the same.
    std::string bytes(static_cast<std::size_t>(status.st_size) + 1, '\0');
    std::size_t length = 0;
    for (;;) {
        const ssize_t count = ::read(file.number(), bytes.data() + length, bytes.size() - length);
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count < 0) {
            return std::nullopt;
        }
        if (count == 0) {
            bytes.resize(length);
            return bytes;
        }
        length += static_cast<std::size_t>(count);
        if (length == bytes.size()) {
            bytes.resize(2 * length + 4096);
        }
    }
}

bool rewriteFile(const std::string &path, std::string_view bytes) {
    const FileDescriptor file{path, O_WRONLY | O_CREAT | O_TRUNC};
    if (!file.isOpen()) {
        return false;
    }
    const WriteSignalsIgnored ignored;
    while (!bytes.empty()) {
        const ssize_t count = ::write(file.number(), bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count <= 0) {
            return false;
        }
        bytes.remove_prefix(static_cast<std::size_t>(count));
    }
    return true;
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

std::optional<std::string_view> LinePieces::next() {
    if (rest_.empty()) {
        return std::nullopt;
    }
    // The search stays within the piece: short pieces of one endless line are cut in linear time.
    const std::string_view reach = rest_.substr(0, longest_);
    const std::size_t lineFeed = reach.find('\n');
    const std::string_view piece =
        lineFeed == std::string_view::npos ? reach : reach.substr(0, lineFeed + 1);
    rest_.remove_prefix(piece.size());
    return piece;
}

std::string_view beforeNul(std::string_view piece) { return piece.substr(0, piece.find('\0')); }

std::string_view lineText(std::string_view piece) {
    using namespace std::string_view_literals;
    return piece.substr(0, piece.find_first_of("\r\n\0"sv));
}
