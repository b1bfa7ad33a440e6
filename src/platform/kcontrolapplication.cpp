#include "platform/kcontrolapplication.h"

#include "platform/kconfigwidget.h"
#include "platform/kcontroldialog.h"

#include <QApplication>

#include <algorithm>
#include <cstdio>
#include <cstdlib>

namespace {

std::string joined(const std::vector<const char *> &names) {
    std::string text;
    for (const char *name : names) {
        text += (text.empty() ? "" : ", ") + std::string{name};
    }
    return text;
}

bool isOption(const std::string &argument, const char *option) {
    return argument == std::string{"-"} + option || argument == std::string{"--"} + option;
}

[[noreturn]] void printHelp(const char *name, const std::vector<const char *> &pageNames) {
    std::printf("Usage: %s [-init] [PAGE]...\n\n"
                "  -init      read the files, show nothing, end\n"
                "  --help     print this text\n"
                "  --version  print the version\n\n"
                "Without PAGE all pages are shown. Pages: %s\n",
                name, joined(pageNames).c_str());
    std::exit(0);
}

[[noreturn]] void printVersion(const char *name) {
    std::printf("%s %s\n", name, TARVEX_VERSION);
    std::exit(0);
}

[[noreturn]] void refusePage(const char *name, const std::string &page,
                             const std::vector<const char *> &pageNames) {
    std::fprintf(stderr, "%s: unknown page \"%s\"; the pages are %s\n", name, page.c_str(),
                 joined(pageNames).c_str());
    std::exit(2);
}

} // namespace

KControlApplication::CommandLine
KControlApplication::parseCommandLine(int argc, char **argv, const char *name,
                                      const std::vector<const char *> &pageNames) {
    CommandLine commandLine;
    for (int index = 1; index < argc; ++index) {
        const std::string argument = argv[index];
        if (isOption(argument, "init")) {
            commandLine.initOnly = true;
        } else if (argument == "--help") {
            printHelp(name, pageNames);
        } else if (argument == "--version") {
            printVersion(name);
        } else if (std::ranges::find(pageNames, argument) == pageNames.end()) {
            refusePage(name, argument, pageNames);
        } else {
            commandLine.pages.push_back(argument);
        }
    }
    return commandLine;
}

KControlApplication::KControlApplication(int &argc, char **argv, const char *name,
                                         const std::vector<const char *> &pageNames)
    : KControlApplication{argc > 0 ? argv[0] : name, name,
                          parseCommandLine(argc, argv, name, pageNames)} {}

KControlApplication::KControlApplication(const char *program, const char *name,
                                         CommandLine commandLine)
    : KApplication{program, name, !commandLine.initOnly},
      requestedPages_{std::move(commandLine.pages)} {
    if (commandLine.initOnly) {
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

void KControlApplication::init() {}

void KControlApplication::applyChanges() {}

void KControlApplication::help() {
    if (dialog_) {
        dialog_->showHelp(sharedFolder(name() + "/help"));
    }
}

void KControlApplication::defaultValues() {}

bool KControlApplication::isPageRequested(const char *name) const {
    return requestedPages_.empty() ||
           std::ranges::find(requestedPages_, name) != requestedPages_.end();
}

QWidget *KControlApplication::dialog() const { return dialog_.get(); }

void KControlApplication::addPage(KConfigWidget *page, const char *label, const char *helpFile) {
    dialog_->addPage(page, QString::fromUtf8(label), QString::fromUtf8(helpFile));
}

void KControlApplication::showDialog() {
    dialog_->addButtons();
    dialog_->show();
}
