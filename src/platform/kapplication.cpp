#include "platform/kapplication.h"

#include <QApplication>
#include <QDir>
#include <QLibraryInfo>
#include <QTranslator>

#include <clocale>
#include <cstdio>
#include <cstdlib>
#include <utility>
#include <vector>

#include <libintl.h>

namespace {

/// Keeps the toolkit from filling the console, and from aborting, where there is no display: what
/// it reports is held back and, when there is one after all, handed on.
class DisplayProblems {
public:
    explicit DisplayProblems(const char *program) {
        program_ = program;
        before_ = qInstallMessageHandler(hold);
    }
    DisplayProblems(const DisplayProblems &) = delete;
    DisplayProblems &operator=(const DisplayProblems &) = delete;
    ~DisplayProblems() {
        qInstallMessageHandler(before_);
        for (const auto &[type, text] : std::exchange(held_, {})) {
            qt_message_output(type, {}, text);
        }
    }

private:
    static void hold(QtMsgType type, const QMessageLogContext & /*where*/, const QString &text) {
        if (type == QtFatalMsg) {
            std::fprintf(stderr, "%s: no display can be opened\n", program_);
            std::_Exit(1);
        }
        held_.emplace_back(type, text);
    }

    static inline const char *program_ = nullptr;
    static inline QtMessageHandler before_ = nullptr;
    static inline std::vector<std::pair<QtMsgType, QString>> held_;
};

/// The toolkit's own texts in the user's language; null where there are none or none are needed.
std::unique_ptr<QTranslator> toolkitTexts() {
    // In this locale the program's own messages are not translated either.
    const std::string_view messages = std::setlocale(LC_MESSAGES, nullptr);
    if (messages == "C" || messages == "POSIX") {
        return nullptr;
    }
    const QLocale locale = QLocale::system();
    const QString firstLanguage = locale.uiLanguages().value(0);
    if (firstLanguage.startsWith("en")) {
        return nullptr;
    }
    auto texts = std::make_unique<QTranslator>();
    return texts->load(locale, QStringLiteral("qtbase"), QStringLiteral("_"),
                       QLibraryInfo::path(QLibraryInfo::TranslationsPath))
               ? std::move(texts)
               : nullptr;
}

} // namespace

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
        const DisplayProblems problems{name};
        // What the program shows reads from left to right, whatever the toolkit's texts do.
        QGuiApplication::setLayoutDirection(Qt::LeftToRight);
        toolkit_ = std::make_unique<QApplication>(toolkitArgumentCount_, toolkitArguments_);
    } else {
        toolkit_ = std::make_unique<QCoreApplication>(toolkitArgumentCount_, toolkitArguments_);
    }
    QCoreApplication::setApplicationName(name);
    getLocale()->open(name, shared(QStringLiteral("locale")));
    if (hasDisplay) {
        toolkitTexts_ = toolkitTexts();
        QCoreApplication::installTranslator(toolkitTexts_.get());
        QGuiApplication::setDesktopFileName(name);
    }
}

KApplication::~KApplication() = default;

KLocale *KApplication::getLocale() {
    static KLocale locale;
    return &locale;
}

QString KApplication::shared(const QString &name) {
    return QDir::cleanPath(QCoreApplication::applicationDirPath() +
                           "/" TARVEX_SHARE_FROM_PROGRAM "/" + name);
}

QString KApplication::name() const { return QCoreApplication::applicationName(); }
