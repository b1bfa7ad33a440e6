#include "widgets/captions.h"

#include "platform/kapplication.h"

#include <QApplication>
#include <QFontMetrics>
#include <QLabel>

namespace {

int captionWidth(const QString &caption) {
    return QFontMetrics{QApplication::font("QLabel")}.size(Qt::TextShowMnemonic, caption).width();
}

} // namespace

QString translated(const char *caption) { return KApplication::getLocale()->translate(caption); }

QSize widened(QSize label, std::initializer_list<QString> captions) {
    for (const QString &caption : captions) {
        label = label.expandedTo({captionWidth(caption), 0});
    }
    return label;
}

QLabel *newLabel(const QString &caption, QSize size, QWidget *parent) {
    auto *label = new QLabel(caption, parent);
    label->setFixedSize(size.expandedTo({captionWidth(caption), 0}));
    return label;
}
