#include "platform/klocale.h"

#include <QFile>

#include <libintl.h>

QString KLocale::translate(const char *text) const {
    // An empty text would give the catalogue's header.
    return domain_.empty() || *text == '\0' ? QString::fromUtf8(text)
                                            : QString::fromUtf8(dgettext(domain_.c_str(), text));
}

void KLocale::open(const QString &name, const QString &directory) {
    domain_ = name.toStdString();
    bindtextdomain(domain_.c_str(), QFile::encodeName(directory).constData());
    bind_textdomain_codeset(domain_.c_str(), "UTF-8");
}
