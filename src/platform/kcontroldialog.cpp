#include "platform/kcontroldialog.h"

#include "platform/droppedinput.h"
#include "platform/helpwindow.h"
#include "platform/kconfigwidget.h"
#include "platform/screensize.h"

#include <QApplication>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QScrollArea>
#include <QShortcut>
#include <QShortcutEvent>
#include <QTabBar>
#include <QTabWidget>
#include <QVBoxLayout>

namespace {

/// A caption that the toolkit's own catalogue translates, as it does for its message boxes.
QString toolkitCaption(const char *caption) {
    return QCoreApplication::translate("QPlatformTheme", caption);
}

} // namespace

KControlDialog::KControlDialog()
    : tabs_{new QTabWidget(this)}, layout_{new QVBoxLayout(this)}, note_{new QLabel(this)} {
    note_->setTextFormat(Qt::PlainText);
    note_->setWordWrap(true);
    note_->hide();
    // The window is wide enough for all tabs, rather than scrolling them.
    tabs_->setUsesScrollButtons(false);
    tabs_->tabBar()->installEventFilter(this);
    layout_->addWidget(tabs_);
    addHelpKey(this);
}

KControlDialog::~KControlDialog() = default;

void KControlDialog::addPage(KConfigWidget *page, const QString &label, const QString &helpFile) {
    tabs_->addTab(page, label);
    helpFiles_.append(helpFile);
}

void KControlDialog::setNote(const QString &text, const QString &tip) {
    note_->setText(text);
    // What could be taken for markup is none, and so the tip has lines of its own.
    note_->setToolTip(tip == text ? QString{} : "<qt>" + tip.toHtmlEscaped() + "</qt>");
    note_->setAccessibleDescription(tip == text ? QString{} : tip);
    note_->setVisible(!text.isEmpty());
    if (isVisible()) {
        fitToScreen();
    }
}

void KControlDialog::addButtons() {
    layout_->addWidget(note_);
    auto *help = new QPushButton(toolkitCaption("Help"), this);
    auto *ok = new QPushButton(toolkitCaption("OK"), this);
    auto *apply = new QPushButton(toolkitCaption("Apply"), this);
    auto *cancel = new QPushButton(toolkitCaption("Cancel"), this);
    ok->setDefault(true);

    auto *buttons = new QHBoxLayout;
    buttons->addWidget(help);
    buttons->addStretch();
    buttons->addWidget(ok);
    buttons->addWidget(apply);
    buttons->addWidget(cancel);
    layout_->addLayout(buttons);

    connect(help, &QPushButton::clicked, this, &KControlDialog::helpWanted);
    connect(apply, &QPushButton::clicked, this, &KControlDialog::apply);
    connect(ok, &QPushButton::clicked, this, [this] {
        this->apply();
        accept();
    });
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);
    fitToScreen();
}

void KControlDialog::showHelp(const QString &folder) {
    if (helpFiles_.isEmpty()) {
        return;
    }
    if (helpWindow_ == nullptr) {
        helpWindow_ = std::make_unique<HelpWindow>(folder);
    }
    helpWindow_->showFile(helpFiles_.at(tabs_->currentIndex()));
}

bool KControlDialog::eventFilter(QObject *watched, QEvent *event) {
    if (event->type() == QEvent::Shortcut) {
        if (QWidget *field = fieldOf(static_cast<QShortcutEvent *>(event)->key())) {
            field->setFocus(Qt::ShortcutFocusReason);
            return true;
        }
    }
    return QDialog::eventFilter(watched, event);
}

QWidget *KControlDialog::fieldOf(const QKeySequence &shortcut) const {
    for (const QLabel *label : tabs_->currentWidget()->findChildren<QLabel *>()) {
        if (label->buddy() != nullptr && QKeySequence::mnemonic(label->text()) == shortcut) {
            return label->buddy();
        }
    }
    return nullptr;
}

void KControlDialog::fitToScreen() {
    // The layout would take the note's height from the pages'.
    const QMargins margins = layout_->contentsMargins();
    const int width = layout_->totalMinimumSize().width() - margins.left() - margins.right();
    note_->setMinimumHeight(note_->isHidden() ? 0 : note_->heightForWidth(width));
    const QSize available = availableSize(this);
    const QSize needed = layout_->totalMinimumSize();
    if (tabs_->usesScrollButtons() || needed.boundedTo(available) == needed) {
        return;
    }
    tabs_->setUsesScrollButtons(true);
    const QSize wanted = layout_->totalSizeHint();
    const int current = tabs_->currentIndex();
    for (int index = 0; index < tabs_->count(); ++index) {
        const QString label = tabs_->tabText(index);
        tabs_->insertTab(index, scrolling(tabs_->widget(index)), label);
    }
    tabs_->setCurrentIndex(current);
    tabs_->updateGeometry(); // It forgets to, as long as it is not shown.
    resize(wanted.boundedTo(available));
}

void KControlDialog::apply() {
    // The files and the command may take their time, and the dialog does not answer meanwhile.
    QApplication::setOverrideCursor(Qt::WaitCursor);
    emit applied();
    QApplication::restoreOverrideCursor();
    dropPendingInput();
}

void addHelpKey(QDialog *dialog) {
    QWidget *ancestor = dialog;
    while (ancestor != nullptr && qobject_cast<KControlDialog *>(ancestor) == nullptr) {
        ancestor = ancestor->parentWidget();
    }
    if (auto *module = qobject_cast<KControlDialog *>(ancestor)) {
        QObject::connect(new QShortcut(QKeySequence(Qt::Key_F1), dialog), &QShortcut::activated,
                         module, &KControlDialog::helpWanted);
    }
}
