// Writes the bytes of each row in sections of the tests' list of formats to a file of a folder:
//     fuzz_rows FORMATS FOLDER SECTION...

#include "formats.h"

#include <cstdio>
#include <exception>
#include <filesystem>

static void writeRows(const std::vector<std::string> &arguments) {
    const std::filesystem::path folder = arguments.at(1);
    std::filesystem::remove_all(folder);
    std::filesystem::create_directories(folder);
    for (std::size_t at = 2; at < arguments.size(); ++at) {
        for (const FormatRow &row : formatRows(arguments[0], arguments[at])) {
            std::ofstream file{folder / (arguments[at] + ' ' + row.name)};
            if (!(file << row.bytes).flush()) {
                throw std::runtime_error{"no file can be made of the row: " + row.name};
            }
        }
    }
}

int main(int argc, char **argv) {
    try {
        writeRows({argv + 1, argv + argc});
        return 0;
    } catch (const std::exception &problem) {
        std::fprintf(stderr, "fuzz_rows: %s\n", problem.what());
        return 1;
    }
}
