#include <QAbstractButton>
#include <QApplication>
#include <QLabel>
#include <QSocketNotifier>
#include <QTabBar>
#include <QTextBrowser>
#include <QTimer>

#include <fcntl.h>
#include <fstream>
#include <sys/socket.h>

// Linked into the program so that a test in another process presses its main dialog's buttons. A
// letter that comes in stands for the button whose caption begins with it, and goes back when the
// press is over; "t" for putting all texts that are seen into the file "texts". Before that goes
// "r", when the dialog is shown.

static void say(char letter) { send(DRIVER_LINE, &letter, 1, MSG_NOSIGNAL); }

static void writeTexts() {
    std::ofstream texts{"texts"};
    texts << "bus " << qgetenv("DBUS_SESSION_BUS_ADDRESS").constData() << '\n';
    for (const QWidget *widget : QApplication::allWidgets()) {
        const auto *tabs = qobject_cast<const QTabBar *>(widget);
        for (int tab = 0; tabs != nullptr && tab < tabs->count(); ++tab) {
            texts << "tab " << qPrintable(tabs->tabText(tab)) << '\n';
        }
        const auto *help = qobject_cast<const QTextBrowser *>(widget);
        const QString text =
            help != nullptr ? help->toPlainText() : widget->property("text").toString();
        const bool isNote = widget->inherits("QLabel") && widget->parentWidget()->isWindow();
        texts << (isNote ? "note " : "");
        texts << (widget->isVisible() ? text.toStdString() + '\n' : "\n");
        texts << (isNote ? "note tip " + widget->toolTip().toStdString() + '\n' : "");
    }
}

static void doNext() {
    char letter = 0;
    if (recv(DRIVER_LINE, &letter, 1, 0) != 1) {
        return QCoreApplication::quit(); // The test is gone.
    }
    if (letter == 't') {
        writeTexts();
        return say(letter);
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
    auto *line = new QSocketNotifier(DRIVER_LINE, QSocketNotifier::Read, application);
    QObject::connect(line, &QSocketNotifier::activated, application, doNext);
    QTimer::singleShot(0, application, [] { say('r'); });
}
Q_COREAPP_STARTUP_FUNCTION(listen)
