#include "widgets/formdialog.h"

#include "widgets/fieldtext.h"
#include "widgets/pagelayout.h"

#include <QFileDialog>
#include <QFrame>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include <algorithm>

namespace {

constexpr QSize buttonSize{70, 30};
/// The dialogs are low; what their borders leave over is shared out above and below the rows.
constexpr int leastBorder = 2;

} // namespace

FormDialog::FormDialog(QWidget *parent, const char *name, const char *caption)
    : QDialog(parent), panel_{new QFrame(this)}, rows_{new QVBoxLayout(panel_)} {
    setObjectName(name);
    setWindowTitle(QString::fromUtf8(caption));
    panel_->setFrameStyle(static_cast<int>(QFrame::WinPanel) | static_cast<int>(QFrame::Raised));
    panel_->setLineWidth(1);
    rows_->setContentsMargins(pageBorder, leastBorder, pageBorder, leastBorder);
    rows_->setSpacing(groupSpacing);
    auto *layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    layout->addWidget(panel_);
}

void FormDialog::fixSize(QSize dialog, QSize panel) {
    setFixedSize(dialog);
    panel_->setFixedSize(panel.width(),
                         std::min(panel.height(), dialog.height() - buttonSize.height()));
}

QHBoxLayout *FormDialog::addRow() {
    auto *row = new QHBoxLayout;
    row->setSpacing(groupSpacing);
    rows_->addLayout(row);
    return row;
}

QLineEdit *FormDialog::addField(const char *caption, QSize label, std::string_view bytes) {
    return addField(addRow(), caption, label, bytes);
}

QLineEdit *FormDialog::addField(QHBoxLayout *row, const char *caption, QSize label,
                                std::string_view bytes) {
    QLineEdit *field = newField(panel_);
    field->setFixedHeight(fieldHeight);
    showBytes(field, bytes);
    QLabel *captionLabel = newLabel(translated(caption), label, panel_);
    captionLabel->setBuddy(field);
    row->addWidget(captionLabel);
    row->addWidget(field);
    return field;
}

void FormDialog::addButtonRow() {
    auto *row = new QHBoxLayout;
    row->setContentsMargins(pageBorder, 0, pageBorder, 0);
    row->setSpacing(groupSpacing);
    row->addStretch();
    for (const auto &[caption, slot] :
         {std::pair{"OK", &QDialog::accept}, std::pair{"Cancel", &QDialog::reject}}) {
        auto *button = new QPushButton(QString::fromUtf8(caption), this);
        button->setFixedSize(buttonSize);
        button->setDefault(slot == &QDialog::accept);
        connect(button, &QPushButton::clicked, this, slot);
        row->addWidget(button);
    }
    static_cast<QVBoxLayout *>(layout())->addLayout(row);
}

QPushButton *addBrowseButton(QHBoxLayout *row, int width, QWidget *parent) {
    auto *button = new QPushButton(QStringLiteral("Browse..."), parent);
    button->setFixedSize(width, FormDialog::fieldHeight);
    row->addWidget(button);
    return button;
}

bool isWholePath(const QString &path) {
    return !path.isEmpty() && !path.contains(QChar::ReplacementCharacter);
}

void browseForFile(QLineEdit *field, QWidget *parent) {
    if (field->isReadOnly()) {
        return;
    }
    const QString path = QFileDialog::getOpenFileName(parent, {}, field->text());
    if (isWholePath(path)) {
        field->setText(path);
    }
}
