#include "platform/helpwindow.h"

#include "platform/kapplication.h"
#include "platform/screensize.h"

#include <QCoreApplication>
#include <QFileInfo>
#include <QLocale>
#include <QPushButton>
#include <QTextBrowser>
#include <QVBoxLayout>

namespace {

/// None for a path that no folder has, or that is no plain file name.
QString firstInstalled(const QString &folder, const QString &file) {
    QStringList languages = QLocale::system().uiLanguages();
    languages.append(QStringLiteral("en"));
    for (QString language : languages) {
        QString path = folder + '/' + language.replace('-', '_') + '/' + file;
        if (QFileInfo(path).isFile() && QFileInfo(path).isReadable()) {
            return path;
        }
    }
    return {};
}

} // namespace

HelpWindow::HelpWindow(QString folder)
    : folder_{std::move(folder)}, browser_{new QTextBrowser(this)} {
    const QString help = QCoreApplication::translate("QPlatformTheme", "Help");
    setWindowTitle(help);
    resize(QSize{640, 560}.boundedTo(availableSize(this)));
    browser_->setAccessibleName(help);
    browser_->setOpenLinks(false);
    browser_->setTextInteractionFlags(browser_->textInteractionFlags() |
                                      Qt::TextSelectableByKeyboard);
    auto *close = new QPushButton(QCoreApplication::translate("QPlatformTheme", "Close"), this);
    close->setDefault(true);
    auto *layout = new QVBoxLayout(this);
    layout->addWidget(browser_);
    layout->addWidget(close, 0, Qt::AlignRight);
    connect(close, &QPushButton::clicked, this, &QDialog::hide);
    connect(browser_, &QTextBrowser::anchorClicked, this, &HelpWindow::follow);
    connect(browser_, &QTextBrowser::sourceChanged, this,
            [this] { setWindowTitle(browser_->documentTitle()); });
}

void HelpWindow::showFile(const QString &file) {
    const QString path = firstInstalled(folder_, file);
    if (path.isEmpty()) {
        setWindowTitle(browser_->accessibleName());
        const QString text = KApplication::getLocale()->translate(
            translatable("The help file \"%1\" is not installed.\n\n"
                         "It was looked for in the folders below %2."));
        browser_->setPlainText(text.arg(file, folder_));
    } else {
        browser_->setSource(QUrl::fromLocalFile(path));
    }
    show();
    raise();
    activateWindow();
}

void HelpWindow::follow(const QUrl &link) {
    const QString file = link.fileName();
    const bool isBeside = link.adjusted(QUrl::RemoveFilename | QUrl::RemoveFragment) ==
                          browser_->source().adjusted(QUrl::RemoveFilename | QUrl::RemoveFragment);
    const QString path = firstInstalled(folder_, file);
    if (isBeside && !file.isEmpty() && !path.isEmpty()) {
        QUrl target = QUrl::fromLocalFile(path);
        target.setFragment(link.fragment());
        browser_->setSource(target);
        // The caret stays at the link otherwise, and the next key would lead back there.
        browser_->setTextCursor(browser_->cursorForPosition({}));
    }
}
