#include <QAbstractButton>
#include <QApplication>
#include <QSocketNotifier>
#include <QTimer>

#include <fcntl.h>
#include <sys/socket.h>

// Linked into the program so that a test in another process presses the main dialog's buttons. A
// letter that comes in stands for the button whose caption begins with it, and goes back when the
// press is over. Before that go "h", when the toolkit stands, and "r", when the dialog is shown.

static void say(char letter) { send(DRIVER_LINE, &letter, 1, MSG_NOSIGNAL); }

static void pressNext() {
    char letter = 0;
    if (recv(DRIVER_LINE, &letter, 1, 0) != 1) {
        QCoreApplication::quit(); // The test is gone.
    }
    for (QWidget *widget : QApplication::allWidgets()) {
        auto *button = qobject_cast<QAbstractButton *>(widget);
        if (button != nullptr && button->parentWidget()->isWindow() &&
            button->text().startsWith(QLatin1Char(letter))) {
            button->click();
            return say(letter);
        }
    }
}

static void listen() {
    auto *application = QCoreApplication::instance();
    fcntl(DRIVER_LINE, F_SETFD, FD_CLOEXEC);
    say('h');
    auto *line = new QSocketNotifier(DRIVER_LINE, QSocketNotifier::Read, application);
    QObject::connect(line, &QSocketNotifier::activated, application, pressNext);
    QTimer::singleShot(0, application, [] { say('r'); });
}
Q_COREAPP_STARTUP_FUNCTION(listen)
