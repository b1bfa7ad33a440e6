#include "platform/kcontroldialog.h"

#include "platform/helpwindow.h"
#include "platform/kconfigwidget.h"

#include <QApplication>
#include <QHBoxLayout>
#include <QPushButton>
#include <QShortcut>
#include <QTabWidget>

KControlDialog::KControlDialog() : tabs_{new QTabWidget(this)} {
    // The window is wide enough for all tabs, rather than scrolling them.
    tabs_->setUsesScrollButtons(false);
    (new QVBoxLayout(this))->addWidget(tabs_);
    connect(new QShortcut(QKeySequence(Qt::Key_F1), this), &QShortcut::activated, this,
            &KControlDialog::helpWanted);
}

void KControlDialog::addPage(KConfigWidget *page, const QString &label, const QString &helpFile) {
    tabs_->addTab(page, label);
    helpFiles_.append(helpFile);
}

void KControlDialog::addButtons() {
    auto *help = new QPushButton(QStringLiteral("Help"), this);
    auto *ok = new QPushButton(QStringLiteral("OK"), this);
    auto *apply = new QPushButton(QStringLiteral("Apply"), this);
    auto *cancel = new QPushButton(QStringLiteral("Cancel"), this);
    ok->setDefault(true);

    auto *buttons = new QHBoxLayout;
    buttons->addWidget(help);
    buttons->addStretch();
    buttons->addWidget(ok);
    buttons->addWidget(apply);
    buttons->addWidget(cancel);
    static_cast<QVBoxLayout *>(layout())->addLayout(buttons);

    connect(help, &QPushButton::clicked, this, &KControlDialog::helpWanted);
    connect(apply, &QPushButton::clicked, this, &KControlDialog::apply);
    connect(ok, &QPushButton::clicked, this, [this] {
        this->apply();
        accept();
    });
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);
}

void KControlDialog::showHelp(const QString &folder) {
    if (helpFiles_.isEmpty()) {
        return;
    }
    if (helpWindow_ == nullptr) {
        helpWindow_ = new HelpWindow(this);
    }
    helpWindow_->showFile(folder, helpFiles_.at(tabs_->currentIndex()));
}

void KControlDialog::apply() {
    // The files and the command may take their time, and the dialog does not answer meanwhile.
    QApplication::setOverrideCursor(Qt::WaitCursor);
    emit applied();
    QApplication::restoreOverrideCursor();
}
