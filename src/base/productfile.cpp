#include "base/productfile.h"

#include "base/textfile.h"

#include <new>
#include <utility>

int ProductFile::read(const Path &path, const std::function<void(std::string bytes)> &take) {
    isWhole_ = false;
    try {
        FileRead file = path ? readWholeFile(*path) : FileRead{std::nullopt, true};
        if (file.bytes) {
            sizeRead_ = file.bytes->size();
            take(*std::move(file.bytes));
        }
        isWhole_ = file.bytes || file.isMissing;
        return file.bytes ? 0 : 1;
    } catch (const std::bad_alloc &) {
        return 2;
    }
}

void ProductFile::rewrite(const Path &path, const std::function<void(std::string &bytes)> &format,
                          mode_t newFileMode) const {
    try {
        if (path && isWhole_) {
            std::string bytes;
            bytes.reserve(sizeRead_ + sizeRead_ / 8); // Edits seldom lengthen it by more.
            format(bytes);
            rewriteFile(*path, bytes, newFileMode);
        }
    } catch (const std::bad_alloc &) { // Like every failed write: nothing is reported.
    }
}
