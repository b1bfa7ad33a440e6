#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <sys/types.h>

/// What keeps a file from being rewritten, as far as that is known beforehand.
enum class Obstacle : std::uint8_t {
    None,
    NoPath,
    NotRead,
    NoFolder,
    NotAllowed,
    NoTemplate,
    Appeared, ///< It was missing when it was read, and somebody else has made it since.
};

/// One of the product's files: read at the start, rewritten on every apply. What could not be read
/// whole is never rewritten: that would take away what the file alone holds. What was missing is
/// made, but left alone when somebody else has made it meanwhile.
class ProductFile {
public:
    using Path = std::optional<std::string>; ///< None where the product has no such file.

    /// Reads the file and has `take` make what is kept in memory of it. 0; 1 when there is none or
    /// it cannot be read; 2 when memory ran out, in `take` as well.
    int read(const Path &path, const std::function<void(std::string bytes)> &take);

    /// Rewrites the file with what `format` appends, all of which is in memory before the file is
    /// touched. Whether that was done: nothing happens when there is an obstacle, or memory runs
    /// out.
    bool rewrite(const Path &path, const std::function<void(std::string &bytes)> &format,
                 mode_t newFileMode = 0666);

    [[nodiscard]] Obstacle obstacle(const Path &path) const;

    /// How many lines the next rewriting takes away although nobody edited them. Who reads the file
    /// counts them.
    std::size_t lostLines = 0;

private:
    Obstacle found_ = Obstacle::None; ///< When it was read or rewritten last.
    bool isMissing_ = false;
    std::size_t sizeRead_ = 0;
};
