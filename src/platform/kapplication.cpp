#include "platform/kapplication.h"

#include "platform/displayproblems.h"
#include "platform/droppedinput.h"
#include "platform/localeletters.h"
#include "platform/toolkittexts.h"

#include <QApplication>
#include <QDir>

#include <new>

namespace {

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
};

} // namespace

KApplication::KApplication(const char *program, const char *name, bool hasDisplay) {
    toolkitArguments_[0] = const_cast<char *>(program);
    if (hasDisplay) {
        const DisplayProblems problems{name};
        // What the program shows reads from left to right, whatever the toolkit's texts do.
        QGuiApplication::setLayoutDirection(Qt::LeftToRight);
        toolkit_ = std::make_unique<Toolkit>(toolkitArgumentCount_, toolkitArguments_);
    } else {
        toolkit_ = std::make_unique<QCoreApplication>(toolkitArgumentCount_, toolkitArguments_);
    }
    usePlainLettersForKeys();
    QCoreApplication::setApplicationName(name);
    getLocale()->open(name, shared(QStringLiteral("locale")));
    if (hasDisplay) {
        installToolkitTexts();
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
