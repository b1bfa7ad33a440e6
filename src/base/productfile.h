#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <sys/types.h>

/// One of the product's files: read at the start, rewritten on every apply. What could not be read
/// whole is never rewritten, unless it was missing: that would take away what the file alone holds.
class ProductFile {
public:
    using Path = std::optional<std::string>; ///< None where the product has no such file.

    /// Reads the file and has `take` make what is kept in memory of it. 0; 1 when there is none or
    /// it cannot be read; 2 when memory ran out, in `take` as well.
    int read(const Path &path, const std::function<void(std::string bytes)> &take);

    /// Rewrites the file with what `format` appends, all of which is in memory before the file is
    /// touched. Nothing happens when there is no path, or memory runs out.
    void rewrite(const Path &path, const std::function<void(std::string &bytes)> &format,
                 mode_t newFileMode = 0666) const;

private:
    bool isWhole_ = true;
    std::size_t sizeRead_ = 0;
};
