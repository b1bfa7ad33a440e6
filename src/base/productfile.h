#pragma once

#include "base/translatable.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <sys/types.h>

/// One of the product's files: read at the start, rewritten on every apply. What could not be read
/// whole is never rewritten: that would take away what the file alone holds. What was missing is
/// made, but left alone when somebody else has made it meanwhile.
class ProductFile {
public:
    using Path = std::optional<std::string>; ///< None where the product has no such file.

    /// Reads the file and has `take` make what is kept in memory of it. 0; 1 when there is none or
    /// it cannot be read; 2 when memory ran out, in `take` as well.
    int read(const Path &path, const std::function<void(std::string bytes)> &take);

    /// Rewrites the file that was read with what `format` appends, all of which is in memory before
    /// the file is touched. Whether it was written whole; it is not touched where there is no path
    /// or the file is not this program's to write, or when memory runs out.
    bool rewrite(const std::function<void(std::string &bytes)> &format, mode_t newFileMode = 0666);

    /// Why the file will not be rewritten, as far as that is known; none where it will be.
    [[nodiscard]] std::optional<TranslatableText> obstacle() const;

    /// How many lines the next rewriting takes away although nobody edited them. Who reads the file
    /// counts them.
    std::size_t lostLines = 0;

private:
    Path path_;
    bool isWhole_ = true;
    bool isMissing_ = false;
    bool hasAppeared_ = false;
    std::size_t sizeRead_ = 0;
};
