#include "platform/droppedinput.h"

#include <QAbstractButton>
#include <QGuiApplication>
#include <QKeyEvent>

namespace {

/// Every press. No release, which does nothing alone: no press must lack its own.
class AllPresses : public QObject {
public:
    bool eventFilter(QObject * /*receiver*/, QEvent *event) override {
        switch (event->type()) {
        case QEvent::KeyPress:
        case QEvent::Shortcut:
        case QEvent::MouseButtonPress:
        case QEvent::MouseButtonDblClick:
        case QEvent::Wheel:
            return true;
        default:
            return false;
        }
    }
};

/// The presses of a key that is held down which would press a button once more.
class RepeatedPresses : public QObject {
public:
    using QObject::QObject;

    bool eventFilter(QObject *receiver, QEvent *event) override {
        if (event->type() == QEvent::KeyRelease) {
            releasedKey_ = static_cast<QKeyEvent *>(event)->key();
            releasedAt_ = static_cast<QKeyEvent *>(event)->timestamp();
        }
        return event->type() == QEvent::KeyPress &&
               pressesButtonAgain(receiver, *static_cast<QKeyEvent *>(event));
    }

private:
    /// A repetition that reaches a window just opened is not marked as one: it is a press at the
    /// time of the release before.
    [[nodiscard]] bool pressesButtonAgain(QObject *receiver, const QKeyEvent &press) const {
        const bool isAnyButtons = press.key() == Qt::Key_Return || press.key() == Qt::Key_Enter ||
                                  press.key() == Qt::Key_Escape;
        const bool isSpaceOnButton =
            press.key() == Qt::Key_Space && qobject_cast<QAbstractButton *>(receiver) != nullptr;
        const bool isRepeated =
            press.isAutoRepeat() || (press.key() == releasedKey_ && press.timestamp() != 0 &&
                                     press.timestamp() == releasedAt_);
        return isRepeated && (isAnyButtons || isSpaceOnButton);
    }

    int releasedKey_ = 0;
    quint64 releasedAt_ = 0; ///< In the display's milliseconds.
};

} // namespace

void dropPendingInput() {
    AllPresses presses;
    qApp->installEventFilter(&presses);
    QGuiApplication::sync();
}

void dropRepeatedPresses() { qApp->installEventFilter(new RepeatedPresses(qApp)); }
