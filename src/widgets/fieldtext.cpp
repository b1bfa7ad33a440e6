#include "widgets/fieldtext.h"

#include "platform/bytetext.h"
#include "platform/kapplication.h"

#include <QLineEdit>

#include <algorithm>
#include <limits>

QLineEdit *newField(QWidget *parent) {
    auto *field = new QLineEdit(parent);
    field->setMaxLength(std::numeric_limits<int>::max());
    return field;
}

void showBytes(QLineEdit *field, std::string_view bytes) {
    field->setText(textFromBytes(bytes));
    field->setCursorPosition(0);
}

std::string fieldBytes(const QLineEdit *field) {
    std::string bytes = bytesFromText(field->text());
    std::ranges::replace_if(
        bytes, [](char byte) { return byte == '\r' || byte == '\n' || byte == '\0'; }, ' ');
    return bytes;
}

QString translated(const char *caption) { return KApplication::getLocale()->translate(caption); }
