#pragma once

#include <fstream>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

/// The rows of formats.txt, for the tests and for the first inputs of the fuzz targets.

struct FormatRow {
    std::string name;
    std::string bytes;
    std::string expected; ///< What is made of them.
};

/// The bytes that a text in the list of formats stands for.
inline std::string decoded(std::string text) {
    for (std::size_t at = 0; (at = text.find('\\', at)) != text.npos; ++at) {
        const bool isHex = text[at + 1] == 'x';
        const char byte = isHex ? static_cast<char>(std::stoi(text.substr(at + 2, 2), nullptr, 16))
                                : "\n\t\r\v\f\0"[std::string_view{"ntrvf0"}.find(text[at + 1])];
        text.replace(at, isHex ? 4 : 2, 1, byte);
    }
    for (std::size_t at = 0; (at = text.find("x{", at)) != text.npos;) {
        const std::size_t count = std::stoul(text.substr(at + 2));
        text.replace(at, text.find('}', at) + 1 - at, count, 'x');
    }
    return text;
}

/// The rows of a section, whose name is like "[aliases]"; throws where the list has none such, or a
/// line in it that is no row.
inline std::vector<FormatRow> formatRows(const std::string &path, std::string_view section) {
    std::ifstream list{path};
    std::string line;
    while (line != section) {
        if (!std::getline(list, line)) {
            throw std::runtime_error{"no such section: " + std::string{section}};
        }
    }
    std::vector<FormatRow> rows;
    while (std::getline(list, line) && !line.empty()) {
        const std::size_t bytes = line.find(": \"");
        const std::size_t arrow = line.find("\" => \"", bytes);
        if (arrow == line.npos || !line.ends_with('"')) {
            throw std::runtime_error{"no row: " + line};
        }
        rows.push_back({line.substr(0, bytes), decoded(line.substr(bytes + 3, arrow - bytes - 3)),
                        decoded(line.substr(arrow + 6, line.size() - arrow - 7))});
    }
    return rows;
}
