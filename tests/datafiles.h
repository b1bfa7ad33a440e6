#pragma once

#include "base/kepttext.h"
#include "base/textfile.h"

#include <QTest>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <random>

template <>
inline char *QTest::toString(const std::string &text) {
    return QTest::toString(QByteArray::fromStdString(text));
}

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

/// Checks what `convert` makes of the bytes in a section of the list of formats.
template <class Convert>
void checkRows(Convert convert, const char *section) {
    std::ifstream list{TEST_DATA "/formats.txt"};
    std::string line;
    while (line != section) {
        QVERIFY2(std::getline(list, line), section);
    }
    while (std::getline(list, line) && line.ends_with('"')) {
        const std::size_t bytes = line.find(": \"") + 3;
        const std::size_t arrow = line.find("\" => \"", bytes);
        QVERIFY2(arrow != line.npos, line.c_str());
        const std::string seen = convert(decoded(line.substr(bytes, arrow - bytes)));
        const std::string expected = line.substr(arrow + 6, line.size() - arrow - 7);
        QVERIFY2(seen == decoded(expected), line.append(" but was ").append(seen).c_str());
    }
    QVERIFY2(line.empty(), line.c_str());
}

inline bool operator==(const KeptText &text, std::string_view other) {
    return std::string_view{text} == other;
}

inline std::string operator+(std::string before, const KeptText &text) {
    return before.append(std::string_view{text});
}

/// The bytes of a file; "none" where it cannot be read.
inline std::string bytesAt(const std::string &path) {
    return readWholeFile(path).bytes.value_or("none");
}

/// What a format makes of a list.
template <class List>
std::string whole(void (*format)(const List &, std::string &), const List &list) {
    std::string bytes;
    format(list, bytes);
    return bytes;
}

/// A path in the test's own product at which no file is yet.
inline std::string newPath() {
    std::filesystem::remove_all(TEST_PRODUCT);
    std::filesystem::create_directories(TEST_PRODUCT);
    return TEST_PRODUCT "/file";
}

/// The bytes of a file among the application's test data, with the product's path in it.
inline std::string given(const std::filesystem::path &name) {
    QByteArray bytes = QByteArray::fromStdString(bytesAt(TEST_DATA "/app" / name));
    return bytes.replace("@PRODUCT@", TEST_PRODUCT).toStdString();
}

/// A product tree in which every file has something that an apply changes in form.
inline void layProduct() {
    namespace fs = std::filesystem;
    newPath();
    const fs::path source = fs::path{TEST_DATA "/app/product"};
    fs::copy(source, TEST_PRODUCT, fs::copy_options::recursive);
    for (const auto &entry : fs::recursive_directory_iterator{source}) {
        const fs::path name = entry.path().lexically_relative(source);
        rewriteFile(fs::path{TEST_PRODUCT} / name, given("product" / name));
    }
}

/// Up to `longest` random bytes, high ones among them; no NUL and none of `excluded`.
inline std::string randomText(std::mt19937 &random, std::string_view excluded, size_t longest) {
    std::string text(random() % (longest + 1), 'x');
    std::ranges::generate(text, [&] { return static_cast<char>(1 + random() % 255); });
    std::erase_if(text, [&](char byte) { return excluded.find(byte) != excluded.npos; });
    return text;
}
