#include "platform/helpwindow.h"

#include <QFileInfo>
#include <QLocale>
#include <QPushButton>
#include <QTextBrowser>
#include <QVBoxLayout>

namespace {

QString firstInstalled(const QString &folder, const QString &file) {
    QStringList languages = QLocale::system().uiLanguages();
    languages.append(QStringLiteral("en"));
    for (QString language : languages) {
        QString path = folder + '/' + language.replace('-', '_') + '/' + file;
        if (QFileInfo(path).isReadable()) {
            return path;
        }
    }
    return {};
}

} // namespace

HelpWindow::HelpWindow(QWidget *parent) : QDialog(parent), browser_{new QTextBrowser(this)} {
    setWindowTitle(tr("Help"));
    resize(640, 560);
    auto *close = new QPushButton(tr("Close"), this);
    close->setDefault(true);
    auto *layout = new QVBoxLayout(this);
    layout->addWidget(browser_);
    layout->addWidget(close, 0, Qt::AlignRight);
    connect(close, &QPushButton::clicked, this, &QDialog::hide);
}

void HelpWindow::showFile(const QString &folder, const QString &file) {
    const QString path = firstInstalled(folder, file);
    if (path.isEmpty()) {
        browser_->setPlainText(QStringLiteral("The help file \"%1\" is not installed.\n\n"
                                              "It was looked for in the folders below %2.")
                                   .arg(file, folder));
    } else {
        browser_->setSource(QUrl::fromLocalFile(path));
    }
    show();
    raise();
    activateWindow();
}
