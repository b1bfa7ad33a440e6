#include "platform/kapplication.h"

#include <QApplication>
#include <QDir>

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

KApplication::KApplication(const char *program, const char *name, bool hasDisplay)
    : toolkitArguments_{const_cast<char *>(program), nullptr} {
    if (hasDisplay) {
        toolkit_ = std::make_unique<QApplication>(toolkitArgumentCount_, toolkitArguments_);
    } else {
        toolkit_ = std::make_unique<QCoreApplication>(toolkitArgumentCount_, toolkitArguments_);
    }
    QCoreApplication::setApplicationName(name);
    getLocale()->open(name, sharedFolder(QStringLiteral("locale")));
}

KApplication::~KApplication() = default;

KLocale *KApplication::getLocale() {
    static KLocale locale;
    return &locale;
}

QString KApplication::sharedFolder(const QString &name) {
    return QDir::cleanPath(QCoreApplication::applicationDirPath() + "/../share/" + name);
}

QString KApplication::name() const { return QCoreApplication::applicationName(); }
