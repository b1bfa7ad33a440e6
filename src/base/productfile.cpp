#include "base/productfile.h"

#include "base/textfile.h"

#include <cerrno>
#include <new>
#include <unistd.h>
#include <utility>

int ProductFile::read(const Path &path, const std::function<void(std::string bytes)> &take) {
    path_ = path;
    isWhole_ = false;
    try {
        FileRead file = path ? readWholeFile(*path) : FileRead{std::nullopt, true};
        if (file.bytes) {
            sizeRead_ = file.bytes->size();
            take(*std::move(file.bytes));
        }
        isMissing_ = file.isMissing;
        isWhole_ = file.bytes || isMissing_;
        return file.bytes ? 0 : 1;
    } catch (const std::bad_alloc &) {
        return 2;
    }
}

bool ProductFile::rewrite(const std::function<void(std::string &bytes)> &format,
                          mode_t newFileMode) {
    const auto isThere = [this] { return path_ && ::access(path_->c_str(), F_OK) == 0; };
    try {
        hasAppeared_ = hasAppeared_ || (isMissing_ && isThere());
        if (!path_ || !isWhole_ || hasAppeared_) {
            return false;
        }
        std::string bytes;
        bytes.reserve(sizeRead_ + sizeRead_ / 8); // Edits seldom lengthen it by more.
        format(bytes);
        const bool isDone = rewriteFile(*path_, bytes, newFileMode);
        isMissing_ = isMissing_ && !isThere(); // What is there now was made by this.
        lostLines = isDone ? 0 : lostLines;
        return isDone;
    } catch (const std::bad_alloc &) { // Like every failed write: nothing is reported.
        return false;
    }
}

std::optional<TranslatableText> ProductFile::obstacle() const {
    if (!path_ || path_->empty()) {
        return translatable("no file is set");
    }
    if (!isWhole_) {
        return translatable("the file could not be read");
    }
    switch (rewritingError(*path_)) {
    case 0:
        return hasAppeared_ ? std::optional{translatable("the file appeared meanwhile")}
                            : std::nullopt;
    case ENOENT:
    case ENOTDIR:
        return translatable("there is no such folder");
    default:
        return translatable("the file may not be written");
    }
}
