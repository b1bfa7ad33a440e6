#include "widgets/fieldtext.h"

#include "platform/bytetext.h"
#include "widgets/fieldtip.h"

#include <QLineEdit>
#include <QVariant>

#include <algorithm>
#include <limits>

namespace {

constexpr std::size_t mostBytesEdited = 1'000'000;
constexpr std::size_t bytesShownOfLonger = 1'000;
/// The property of a field in which a text that it does not show whole is kept.
constexpr const char *wholeText = "wholeText";

} // namespace

QLineEdit *newField(QWidget *parent) {
    auto *field = new QLineEdit(parent);
    field->setMaxLength(std::numeric_limits<int>::max());
    return field;
}

void showBytes(QLineEdit *field, std::string_view bytes) {
    const bool isTooLong = bytes.size() > mostBytesEdited;
    field->setText(textFromBytes(bytes.substr(0, isTooLong ? bytesShownOfLonger : bytes.size())));
    field->setCursorPosition(0);
    field->setReadOnly(isTooLong);
    field->setProperty(wholeText, {}); // Of a longer text that was shown before.
    if (isTooLong) {
        field->setProperty(wholeText,
                           QByteArray(bytes.data(), static_cast<qsizetype>(bytes.size())));
        setFieldTip(field, QStringLiteral("Too long to be edited here: this is its beginning"));
    }
}

std::string fieldBytes(const QLineEdit *field) {
    if (const QVariant whole = field->property(wholeText); whole.isValid()) {
        return whole.toByteArray().toStdString();
    }
    std::string bytes = bytesFromText(field->text());
    std::ranges::replace_if(
        bytes, [](char byte) { return byte == '\r' || byte == '\n' || byte == '\0'; }, ' ');
    return bytes;
}
