#include "platform/droppedinput.h"

#include <QAbstractButton>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QScopedValueRollback>

namespace {

bool isDropping = false;
int releasedKey = 0;
quint64 releasedAt = 0; ///< In the display's milliseconds.

/// Whether a key that is held down would press a button once more. A repetition that reaches a
/// window just opened is not marked as one: it is a press at the time of the release before.
bool pressesButtonAgain(const QObject *receiver, const QKeyEvent &press) {
    const bool isAnyButtons = press.key() == Qt::Key_Return || press.key() == Qt::Key_Enter ||
                              press.key() == Qt::Key_Escape;
    const bool isSpaceOnButton =
        press.key() == Qt::Key_Space && qobject_cast<const QAbstractButton *>(receiver) != nullptr;
    const bool isRepeated =
        press.isAutoRepeat() ||
        (press.key() == releasedKey && press.timestamp() != 0 && press.timestamp() == releasedAt);
    return isRepeated && (isAnyButtons || isSpaceOnButton);
}

} // namespace

bool isDropped(const QObject *receiver, const QEvent *event) {
    switch (event->type()) {
    case QEvent::KeyRelease:
        releasedKey = static_cast<const QKeyEvent *>(event)->key();
        releasedAt = static_cast<const QKeyEvent *>(event)->timestamp();
        return false;
    case QEvent::KeyPress:
        return isDropping || pressesButtonAgain(receiver, *static_cast<const QKeyEvent *>(event));
    case QEvent::Shortcut:
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonDblClick:
    case QEvent::Wheel:
        return isDropping;
    default: // Releases among them: alone they do nothing, but no press must lack its own.
        return false;
    }
}

void dropPendingInput() {
    const QScopedValueRollback dropping{isDropping, true};
    QGuiApplication::sync();
}
