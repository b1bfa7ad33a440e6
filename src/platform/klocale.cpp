#include "platform/klocale.h"

#include <QFile>

#include <libintl.h>

QString KLocale::translate(TranslatableText text) const {
    return QString::fromUtf8(domain_.empty() ? text.literal()
                                             : dgettext(domain_.c_str(), text.literal()));
}

void KLocale::open(const QString &name, const QString &directory) {
    domain_ = name.toStdString();
    bindtextdomain(domain_.c_str(), QFile::encodeName(directory).constData());
    bind_textdomain_codeset(domain_.c_str(), "UTF-8");
}
