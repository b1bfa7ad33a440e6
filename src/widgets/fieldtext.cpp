#include "widgets/fieldtext.h"

#include "platform/bytetext.h"
#include "widgets/fieldrule.h"
#include "widgets/fieldtip.h"

#include <QLineEdit>

#include <algorithm>

namespace {

constexpr std::size_t bytesShownOfLonger = 1'000;

} // namespace

QLineEdit *newField(QWidget *parent) {
    auto *field = new QLineEdit(parent);
    // The field cuts beyond this, which the rule then refuses: every character is a byte or more.
    field->setMaxLength(static_cast<int>(mostFieldBytes) + 1);
    applyRule(field, {});
    return field;
}

void showBytes(QLineEdit *field, std::string_view bytes) {
    const bool isTooLong = bytes.size() > mostFieldBytes;
    field->setText(textFromBytes(bytes.substr(0, isTooLong ? bytesShownOfLonger : bytes.size())));
    field->setCursorPosition(0);
    field->setReadOnly(isTooLong);
    if (isTooLong) {
        setFieldTip(field, QStringLiteral("Too long to be edited here: this is its beginning"));
    }
}

bool showsPartOnly(const QLineEdit *field) { return field->isReadOnly(); }

std::string fieldBytes(const QLineEdit *field) {
    std::string bytes = bytesFromText(field->text());
    std::ranges::replace_if(
        bytes, [](char byte) { return byte == '\r' || byte == '\n' || byte == '\0'; }, ' ');
    return bytes;
}

KeptText fieldText(const QLineEdit *field, KeptText before) {
    if (showsPartOnly(field)) {
        return before;
    }
    const std::string bytes = fieldBytes(field);
    return bytes == std::string_view{before} ? before : keep(bytes);
}
