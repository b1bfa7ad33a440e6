#include "platform/bytetext.h"

#include <array>
#include <cstdint>

namespace {

constexpr char16_t escapeBase = 0xdc00;
constexpr char32_t replacement = 0xfffd;

struct SequenceForm {
    unsigned char leadMask;
    unsigned char lead;
    std::size_t length;
    char32_t minimum; ///< A smaller code point in this form is an overlong one: not valid.
};

constexpr std::array<SequenceForm, 4> sequenceForms{
    {{.leadMask = 0x80, .lead = 0x00, .length = 1, .minimum = 0},
     {.leadMask = 0xe0, .lead = 0xc0, .length = 2, .minimum = 0x80},
     {.leadMask = 0xf0, .lead = 0xe0, .length = 3, .minimum = 0x800},
     {.leadMask = 0xf8, .lead = 0xf0, .length = 4, .minimum = 0x10000}}};

struct Decoded {
    char32_t codePoint = 0;
    std::size_t length = 0; ///< 0 when the bytes begin with no valid sequence.
};

Decoded decodeFirst(std::string_view bytes) {
    const auto byteAt = [bytes](std::size_t index) {
        return static_cast<unsigned char>(bytes[index]);
    };
    for (const SequenceForm &form : sequenceForms) {
        if ((byteAt(0) & form.leadMask) != form.lead || bytes.size() < form.length) {
            continue;
        }
        char32_t codePoint = byteAt(0) & static_cast<unsigned char>(~form.leadMask);
        for (std::size_t index = 1; index < form.length; ++index) {
            if ((byteAt(index) & 0xc0) != 0x80) {
                return {};
            }
            codePoint = (codePoint << 6) | (byteAt(index) & 0x3f);
        }
        if (codePoint < form.minimum || codePoint > 0x10ffff || QChar::isSurrogate(codePoint)) {
            return {};
        }
        return {codePoint, form.length};
    }
    return {};
}

void appendEncoded(std::string &bytes, char32_t codePoint) {
    if (codePoint < 0x80) {
        bytes += static_cast<char>(codePoint);
        return;
    }
    const int continuationBytes = codePoint < 0x800 ? 1 : codePoint < 0x10000 ? 2 : 3;
    const SequenceForm &form = sequenceForms.at(static_cast<std::size_t>(continuationBytes));
    bytes += static_cast<char>(form.lead | (codePoint >> (6 * continuationBytes)));
    for (int left = continuationBytes - 1; left >= 0; --left) {
        bytes += static_cast<char>(0x80 | ((codePoint >> (6 * left)) & 0x3f));
    }
}

} // namespace

QString textFromBytes(std::string_view bytes) {
    QString text;
    text.reserve(static_cast<qsizetype>(bytes.size()));
    while (!bytes.empty()) {
        const Decoded first = decodeFirst(bytes);
        if (first.length == 0) {
            text += QChar(static_cast<char16_t>(escapeBase | static_cast<unsigned char>(bytes[0])));
            bytes.remove_prefix(1);
            continue;
        }
        if (QChar::requiresSurrogates(first.codePoint)) {
            text += QChar(QChar::highSurrogate(first.codePoint));
            text += QChar(QChar::lowSurrogate(first.codePoint));
        } else {
            text += QChar(static_cast<char16_t>(first.codePoint));
        }
        bytes.remove_prefix(first.length);
    }
    return text;
}

std::string bytesFromText(QStringView text) {
    std::string bytes;
    bytes.reserve(static_cast<std::size_t>(text.size()));
    for (qsizetype index = 0; index < text.size(); ++index) {
        const char16_t unit = text[index].unicode();
        if (QChar::isHighSurrogate(unit) && index + 1 < text.size() &&
            text[index + 1].isLowSurrogate()) {
            appendEncoded(bytes, QChar::surrogateToUcs4(unit, text[++index].unicode()));
        } else if (unit >= (escapeBase | 0x80) && unit <= (escapeBase | 0xff)) {
            bytes += static_cast<char>(unit & 0xff);
        } else {
            appendEncoded(bytes, QChar::isSurrogate(unit) ? replacement : char32_t{unit});
        }
    }
    return bytes;
}
