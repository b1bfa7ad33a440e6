#include "fuzz.h"

#include "config/settingvalues.h"
#include "platform/bytetext.h"

#include <QStringDecoder>

#include <algorithm>

namespace {

/// The text that a handler has for the value of a text. It must have the same for its own.
template <class Field, class Handler>
std::string settledText(Field &field, std::string_view text, Handler handler) {
    handler(field, text);
    std::string settled = handler(field, std::nullopt).value_or("none");
    Field again{};
    handler(again, settled);
    require(handler(again, std::nullopt) == settled, "a value's text comes back");
    return settled;
}

void checkAccessList(std::string_view bytes) {
    std::optional<AccessList> field;
    const std::string text = settledText(field, bytes, accessListSetting);
    AccessList list = field.value_or(AccessList{});
    const AccessList again = parseAccessList(text).value_or(AccessList{});
    require(again.entries.size() <= list.entries.size(), "an access list gains nothing");
    if (text.size() >= 255) { // As far as the text goes.
        list.entries.resize(again.entries.size());
    }
    require(again == list, "an access list comes back");
}

} // namespace

namespace targets {

void values(std::string_view bytes) {
    std::optional<std::string> text;
    require(settledText(text, bytes, textSetting) == bytes, "a text is any bytes");
    for (const int scale : {-1, 1, 3, 1024, INT32_MAX}) {
        std::int32_t number = 0;
        const std::string shown = settledText(number, bytes, [scale](auto &field, auto given) {
            return numberSetting(field, given, scale);
        });
        require(shown == std::to_string(number / std::max(scale, 1)), "a number has its unit");
    }
    std::int32_t flag = 2;
    const std::string word = settledText(flag, bytes, boolSetting);
    require(flag == (word == "yes" ? 1 : 0), "a boolean is 0 or 1");
    std::int32_t time = 0;
    std::int32_t again = 0;
    timeSetting(again, settledText(time, bytes, timeSetting));
    require(again == time && time >> 16 == 0, "a time is two bytes and comes back");
    checkAccessList(bytes);
}

void bytetext(std::string_view bytes) {
    const QString text = textFromBytes(bytes);
    require(bytesFromText(text) == bytes, "bytes come back");
    QStringDecoder utf8{QStringDecoder::Utf8,
                        QStringDecoder::Flag::ConvertInitialBom | QStringDecoder::Flag::Stateless};
    const QString decoded =
        utf8(QByteArrayView{bytes.data(), static_cast<qsizetype>(bytes.size())});
    require(utf8.hasError() ? !text.isValidUtf16() : text == decoded, "UTF-8 is UTF-8");

    const std::size_t cut =
        bytes.empty() ? 0 : static_cast<unsigned char>(bytes[0]) % (bytes.size() + 1);
    const QString pieces = textFromBytes(bytes.substr(0, cut)) + textFromBytes(bytes.substr(cut));
    require(bytesFromText(pieces) == bytes, "bytes in pieces come back");

    QString foreign(static_cast<qsizetype>(bytes.size() / 2), Qt::Uninitialized);
    bytes.copy(reinterpret_cast<char *>(foreign.data()), bytes.size() / 2 * 2);
    require(!foreign.isValidUtf16() || textFromBytes(bytesFromText(foreign)) == foreign,
            "text comes back");
}

} // namespace targets
