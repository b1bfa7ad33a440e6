#include "platform/toolkittexts.h"

#include <QCoreApplication>
#include <QLibraryInfo>
#include <QLocale>
#include <QTranslator>

#include <clocale>
#include <memory>
#include <string_view>

void installToolkitTexts() {
    // In this locale the program's own messages are not translated either.
    const std::string_view messages = std::setlocale(LC_MESSAGES, nullptr);
    const QLocale locale = QLocale::system();
    if (messages == "C" || messages == "POSIX" ||
        locale.uiLanguages().value(0).startsWith(QStringLiteral("en"))) {
        return;
    }
    auto texts = std::make_unique<QTranslator>(qApp);
    if (texts->load(locale, QStringLiteral("qtbase"), QStringLiteral("_"),
                    QLibraryInfo::path(QLibraryInfo::TranslationsPath))) {
        QCoreApplication::installTranslator(texts.release()); // The application owns it.
    }
}
