#include "platform/bytetext.h"

#include <QStringDecoder>

#include <algorithm>
#include <optional>

namespace {

constexpr char16_t escapeBase = 0xdc00;
constexpr std::size_t longestSequence = 4;

/// None where the bytes are no valid UTF-8.
std::optional<QString> decoded(std::string_view bytes) {
    QStringDecoder utf8{QStringDecoder::Utf8,
                        QStringDecoder::Flag::ConvertInitialBom | QStringDecoder::Flag::Stateless};
    QString text = utf8(QByteArrayView{bytes.data(), static_cast<qsizetype>(bytes.size())});
    return utf8.hasError() ? std::nullopt : std::optional{std::move(text)};
}

/// Takes the character, or the byte that is part of none, that `bytes` begins with.
QString takeFirst(std::string_view &bytes) {
    for (std::size_t length = 1; length <= std::min(bytes.size(), longestSequence); ++length) {
        if (std::optional<QString> character = decoded(bytes.substr(0, length))) {
            bytes.remove_prefix(length);
            return *std::move(character);
        }
    }
    const QChar escape{static_cast<char16_t>(escapeBase | static_cast<unsigned char>(bytes[0]))};
    bytes.remove_prefix(1);
    return escape;
}

/// What a surrogate without its other half stands for.
std::string bytesOfLone(QChar surrogate) {
    const char16_t unit = surrogate.unicode();
    const bool isByte = unit >= (escapeBase | 0x80) && unit <= (escapeBase | 0xff);
    return isByte ? std::string(1, static_cast<char>(unit & 0xff)) : "\xef\xbf\xbd"; // U+FFFD
}

} // namespace

QString textFromBytes(std::string_view bytes) {
    if (std::optional<QString> text = decoded(bytes)) {
        return *std::move(text);
    }
    QString text;
    while (!bytes.empty()) {
        text += takeFirst(bytes);
    }
    return text;
}

std::string bytesFromText(QStringView text) {
    std::string bytes;
    qsizetype done = 0;
    for (qsizetype at = 0; at < text.size(); ++at) {
        const bool isPair =
            text[at].isHighSurrogate() && at + 1 < text.size() && text[at + 1].isLowSurrogate();
        if (isPair) {
            ++at;
        } else if (text[at].isSurrogate()) {
            bytes += text.sliced(done, at - done).toUtf8().toStdString() + bytesOfLone(text[at]);
            done = at + 1;
        }
    }
    return bytes += text.sliced(done).toUtf8().toStdString();
}
