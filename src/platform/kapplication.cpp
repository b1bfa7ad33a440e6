#include "platform/kapplication.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDir>
#include <QKeyEvent>
#include <QLibraryInfo>
#include <QScopedValueRollback>
#include <QThreadPool>
#include <QTranslator>

#include <algorithm>
#include <cctype>
#include <clocale>
#include <cstdio>
#include <cstdlib>
#include <latch>
#include <memory>
#include <new>
#include <system_error>
#include <thread>
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

/// The toolkit's application, which lets an event through or not.
class Toolkit : public QApplication {
public:
    using QApplication::QApplication;

    /// An event that runs out of memory is over; the program is not, nor is a dialog that is open.
    bool notify(QObject *receiver, QEvent *event) override {
        if (isDropped(receiver, event)) {
            return true;
        }
        try {
            return QApplication::notify(receiver, event);
        } catch (const std::bad_alloc &) {
            return false;
        }
    }

    void dropPendingInput() {
        const QScopedValueRollback dropping{isDropping_, true};
        QGuiApplication::sync();
    }

private:
    bool isDropped(QObject *receiver, QEvent *event) {
        switch (event->type()) {
        case QEvent::KeyRelease:
            releasedKey_ = static_cast<QKeyEvent *>(event)->key();
            releasedAt_ = static_cast<QKeyEvent *>(event)->timestamp();
            return false;
        case QEvent::KeyPress:
            return isDropping_ || pressesButtonAgain(receiver, *static_cast<QKeyEvent *>(event));
        case QEvent::Shortcut:
        case QEvent::MouseButtonPress:
        case QEvent::MouseButtonDblClick:
        case QEvent::Wheel:
            return isDropping_;
        default: // Releases among them: alone they do nothing, but no press must lack its own.
            return false;
        }
    }

    /// Whether a key that is held down would press a button once more. A repetition that reaches a
    /// window just opened is not marked as one: it is a press at the time of the release before.
    bool pressesButtonAgain(QObject *receiver, const QKeyEvent &press) const {
        const bool isAnyButtons = press.key() == Qt::Key_Return || press.key() == Qt::Key_Enter ||
                                  press.key() == Qt::Key_Escape;
        const bool isSpaceOnButton =
            press.key() == Qt::Key_Space && qobject_cast<QAbstractButton *>(receiver) != nullptr;
        const bool isRepeated =
            press.isAutoRepeat() || (press.key() == releasedKey_ && press.timestamp() != 0 &&
                                     press.timestamp() == releasedAt_);
        return isRepeated && (isAnyButtons || isSpaceOnButton);
    }

    bool isDropping_ = false;
    int releasedKey_ = 0;
    quint64 releasedAt_ = 0; ///< In the display's milliseconds.
};

/// The toolkit paints large areas in threads of its pool, and would wait for ever for one that
/// could not be started: they are started here, and stay. Throws std::bad_alloc where that
/// cannot be done.
void startPaintingThreads() {
    constexpr int count = 2; // One alone would make the start longer by some milliseconds.
    try {
        std::thread{[] {}}.join(); // The pool itself does not survive a thread that does not start.
    } catch (const std::system_error &) {
        throw std::bad_alloc{};
    }
    QThreadPool *pool = QThreadPool::globalInstance();
    pool->setMaxThreadCount(count);
    pool->setExpiryTimeout(-1);
    // Each waits for the other, so that each takes a thread of its own.
    const auto running = std::make_shared<std::latch>(count);
    for (int index = 0; index < count; ++index) {
        pool->start([running] { running->arrive_and_wait(); });
    }
}

/// Where the locale lower-cases a letter of the keys in a way of its own, as the Turkish ones do
/// with I, this thread compares and classifies characters by the C locale's table.
void useTableForKeys() {
    const auto isLowered = [](char letter) { return std::tolower(letter) == letter - 'A' + 'a'; };
    const std::string_view letters = "ABCDEFGHIJKLMNOPQRSTUVWXYZ";
    if (std::ranges::all_of(letters, isLowered)) {
        return;
    }
    // Messages and typing go by the rest of the locale, and by that of the process. In use until
    // the end, hence never freed.
    const locale_t own = newlocale(LC_CTYPE_MASK, "C", duplocale(LC_GLOBAL_LOCALE));
    if (own != nullptr) {
        uselocale(own);
    }
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

KApplication::KApplication(const char *program, const char *name, bool hasDisplay) {
    toolkitArguments_[0] = const_cast<char *>(program);
    if (hasDisplay) {
        const DisplayProblems problems{name};
        // What the program shows reads from left to right, whatever the toolkit's texts do.
        QGuiApplication::setLayoutDirection(Qt::LeftToRight);
        toolkit_ = std::make_unique<Toolkit>(toolkitArgumentCount_, toolkitArguments_);
        startPaintingThreads();
    } else {
        toolkit_ = std::make_unique<QCoreApplication>(toolkitArgumentCount_, toolkitArguments_);
    }
    useTableForKeys();
    QCoreApplication::setApplicationName(name);
    getLocale()->open(name, shared(QStringLiteral("locale")));
    if (hasDisplay) {
        toolkitTexts_ = toolkitTexts();
        QCoreApplication::installTranslator(toolkitTexts_.get());
        QGuiApplication::setDesktopFileName(name);
    }
}

KApplication::~KApplication() = default;

void KApplication::dropPendingInput() {
    if (auto *toolkit = dynamic_cast<Toolkit *>(qApp)) {
        toolkit->dropPendingInput();
    }
}

KLocale *KApplication::getLocale() {
    static KLocale locale;
    return &locale;
}

QString KApplication::shared(const QString &name) {
    return QDir::cleanPath(QCoreApplication::applicationDirPath() +
                           "/" TARVEX_SHARE_FROM_PROGRAM "/" + name);
}

QString KApplication::name() const { return QCoreApplication::applicationName(); }
