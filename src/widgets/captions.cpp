#include "widgets/captions.h"

#include "widgets/minimumsize.h"

#include <QLabel>

QString translated(TranslatableText caption) {
    return KApplication::getLocale()->translate(caption);
}

QString plainName(QString caption) {
    caption.remove('&');
    while (caption.endsWith(':') || caption.endsWith('.') || caption.endsWith(QChar::Nbsp)) {
        caption.chop(1);
    }
    return caption.trimmed();
}

QLabel *CaptionColumn::newCaption(const QString &caption, QWidget *field) {
    auto *label = new QLabel(caption, field->parentWidget());
    label->setBuddy(field);
    const QSize size = minimumSizeFor(label, minimum_);
    if (size.height() > 0) {
        label->setFixedHeight(size.height());
    }
    label->setFixedWidth(size.width());
    labels_.push_back(label);
    if (size.width() > minimum_.width()) {
        minimum_.setWidth(size.width());
        for (QLabel *above : labels_) {
            above->setFixedWidth(size.width());
        }
    }
    return label;
}
