#include "base/productfile.h"

#include "base/textfile.h"

#include <filesystem>
#include <new>
#include <utility>

namespace {

bool isThere(const std::string &path) {
    std::error_code unknown;
    return std::filesystem::exists(path, unknown);
}

} // namespace

int ProductFile::read(const Path &path, const std::function<void(std::string bytes)> &take) {
    found_ = Obstacle::NotRead;
    try {
        FileRead file = path ? readWholeFile(*path) : FileRead{std::nullopt, true};
        if (file.bytes) {
            sizeRead_ = file.bytes->size();
            take(*std::move(file.bytes));
        }
        isMissing_ = file.isMissing;
        found_ = file.bytes || isMissing_ ? Obstacle::None : Obstacle::NotRead;
        return file.bytes ? 0 : 1;
    } catch (const std::bad_alloc &) {
        return 2;
    }
}

bool ProductFile::rewrite(const Path &path, const std::function<void(std::string &bytes)> &format,
                          mode_t newFileMode) {
    if (path && isMissing_ && isThere(*path)) {
        found_ = Obstacle::Appeared;
    }
    try {
        if (!path || found_ != Obstacle::None) {
            return false;
        }
        std::string bytes;
        bytes.reserve(sizeRead_ + sizeRead_ / 8); // Edits seldom lengthen it by more.
        format(bytes);
        const bool isDone = rewriteFile(*path, bytes, newFileMode);
        isMissing_ = isMissing_ && !isThere(*path); // A file that is there now was made by this.
        lostLines = isDone ? 0 : lostLines;
        return isDone;
    } catch (const std::bad_alloc &) { // Like every failed write: nothing is reported.
        return false;
    }
}

Obstacle ProductFile::obstacle(const Path &path) const {
    if (!path || path->empty()) {
        return Obstacle::NoPath;
    }
    if (found_ == Obstacle::NotRead) {
        return found_;
    }
    if (!hasFolder(*path)) {
        return Obstacle::NoFolder;
    }
    return mayRewrite(*path) ? found_ : Obstacle::NotAllowed;
}
