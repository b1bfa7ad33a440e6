#pragma once

#include "base/kepttext.h"
#include "base/textfile.h"
#include "formats.h"

#include <QTest>

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <random>

template <>
inline char *QTest::toString(const std::string &text) {
    return QTest::toString(QByteArray::fromStdString(text));
}

/// Checks what `convert` makes of the bytes in a section of the list of formats.
template <class Convert>
void checkRows(Convert convert, const char *section) {
    for (const FormatRow &row : formatRows(TEST_DATA "/formats.txt", section)) {
        const std::string seen = convert(row.bytes);
        const std::string both = row.name + ": wanted " + row.expected + ", but was " + seen;
        QVERIFY2(seen == row.expected, both.c_str());
    }
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
std::string whole(auto format, const List &list) {
    std::string bytes;
    format(list, bytes);
    return bytes;
}

/// The bytes of a file among the application's test data, with the product's path in it.
inline std::string given(const std::filesystem::path &name) {
    QByteArray bytes = QByteArray::fromStdString(bytesAt(TEST_DATA "/app" / name));
    return bytes.replace("@PREFIX@", TEST_PRODUCT).toStdString();
}

/// A product tree in which every file has something that an apply changes in form.
inline void layProduct() {
    if (std::system(LAY_PRODUCT) != 0) {
        std::abort();
    }
}
