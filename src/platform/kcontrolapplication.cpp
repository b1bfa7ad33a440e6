#include "platform/kcontrolapplication.h"

#include "platform/kconfigwidget.h"
#include "platform/kcontroldialog.h"

#include <QApplication>
#include <QIcon>
#include <QWindow>

KControlApplication::KControlApplication(int &argc, char **argv, const char *name,
                                         const QStringList &pageNames)
    : KControlApplication{argc > 0 ? argv[0] : name, name,
                          parseCommandLine(argc, argv, name, pageNames)} {}

KControlApplication::KControlApplication(const char *program, const char *name,
                                         CommandLine commandLine)
    : KApplication{program, name, !commandLine.isInitOnly},
      requestedPages_{std::move(commandLine.pages)} {
    if (commandLine.isInitOnly) {
        return;
    }
    dialog_ = std::make_unique<KControlDialog>();
    QObject::connect(dialog_.get(), &KControlDialog::applied, [this] { applyChanges(); });
    QObject::connect(dialog_.get(), &KControlDialog::helpWanted, [this] { help(); });
    // A window that is left open, such as the help, must not keep the program alive.
    QObject::connect(dialog_.get(), &QDialog::finished, qApp, &QCoreApplication::quit);
}

KControlApplication::~KControlApplication() = default;

int KControlApplication::exec() { return QCoreApplication::exec(); }

void KControlApplication::setTitle(const QString &title) {
    if (dialog_) {
        dialog_->setWindowTitle(title);
    }
}

void KControlApplication::help() {
    if (dialog_) {
        dialog_->showHelp(shared(name() + "/help"));
    }
}

bool KControlApplication::isPageRequested(const char *name) const {
    return requestedPages_.isEmpty() || requestedPages_.contains(QLatin1String{name});
}

void KControlApplication::addPage(KConfigWidget *page, const char *label, const char *helpFile) {
    dialog_->addPage(page, QString::fromUtf8(label), QString::fromUtf8(helpFile));
}

void KControlApplication::showDialog() {
    dialog_->addButtons();
    dialog_->show();
    // To read a picture the toolkit looks through its plugins: time that the window need not wait
    // for. It has been mapped when it gets the focus.
    QObject::connect(
        qGuiApp, &QGuiApplication::focusWindowChanged, dialog_.get(),
        [folder = shared("icons/hicolor/%1x%1/apps/" + name() + ".png")] {
            QIcon icon;
            icon.addFile(folder.arg(48));
            icon.addFile(folder.arg(128));
            QGuiApplication::setWindowIcon(icon);
        },
        Qt::SingleShotConnection);
}
