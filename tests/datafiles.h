#pragma once

#include "base/textfile.h"

#include <QTest>

#include <algorithm>
#include <filesystem>
#include <random>
#include <tuple>

template <>
inline char *QTest::toString(const std::string &text) {
    return QTest::toString(QByteArray::fromStdString(text));
}

/// Rows of a case's name, bytes, and what `convert` makes of them.
template <class Convert>
void checkRows(Convert convert,
               const std::vector<std::tuple<const char *, std::string, std::string>> &rows) {
    for (const auto &[name, bytes, expected] : rows) {
        const std::string seen = convert(bytes);
        QVERIFY2(seen == expected, (std::string{name} + ": " + seen).c_str());
    }
}

/// A path in the test's own product at which no file is yet.
inline std::string newPath() {
    std::filesystem::remove_all(TEST_PRODUCT);
    std::filesystem::create_directories(TEST_PRODUCT);
    return TEST_PRODUCT "/file";
}

/// Up to `longest` random bytes, high ones among them; no NUL and none of `excluded`.
inline std::string randomText(std::mt19937 &random, std::string_view excluded, size_t longest) {
    std::string text(random() % (longest + 1), 'x');
    std::ranges::generate(text, [&] { return static_cast<char>(1 + random() % 255); });
    std::erase_if(text, [&](char byte) { return excluded.find(byte) != excluded.npos; });
    return text;
}
