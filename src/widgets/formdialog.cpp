#include "widgets/formdialog.h"

#include "platform/kcontroldialog.h"
#include "platform/screensize.h"
#include "widgets/minimumsize.h"
#include "widgets/textfield.h"

#include <QFileDialog>
#include <QFrame>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>

#include <algorithm>

namespace {

constexpr QSize buttonSize{70, 30};
constexpr int minimumCharactersSeen = 16;

void browse(TextField *field, QFileDialog &chooser) {
    addHelpKey(&chooser);
    chooser.resize(chooser.sizeHint().boundedTo(availableSize(&chooser)));
    chooser.setWindowModality(Qt::WindowModal); // The help stays usable here as well.
    if (field->showsPartOnly()) {
        return field->showTip(field->toolTip());
    }
    if (chooser.exec() != QDialog::Accepted) {
        return;
    }
    const QString path = chooser.selectedFiles().value(0);
    // The toolkit replaces bytes of a name that are not UTF-8: such a path would lead elsewhere.
    if (path.contains(QChar::ReplacementCharacter)) {
        field->showTip(translated(translatable("The path is not UTF-8 and cannot be taken")));
    } else if (!path.isEmpty()) {
        field->replaceText(path);
    }
}

} // namespace

FormDialog::FormDialog(QWidget *parent, const char *name, const char *caption)
    : QDialog(parent),
      panel_{new QFrame(this)},
      layout_{new QVBoxLayout(this)},
      rows_{new QVBoxLayout},
      buttons_{new QHBoxLayout} {
    setObjectName(name);
    setWindowTitle(QString::fromUtf8(caption));
    setWindowModality(Qt::WindowModal);
    addHelpKey(this);
    panel_->setFrameStyle(static_cast<int>(QFrame::WinPanel) | static_cast<int>(QFrame::Raised));
    panel_->setLineWidth(1);
    layout_->setSpacing(0);
    rows_->setSpacing(groupSpacing);
    buttons_->setSpacing(groupSpacing);
}

TextField *FormDialog::addField(TranslatableText caption, QSize label, std::string_view bytes) {
    CaptionColumn captions{label};
    return addField(addRow(), caption, captions, bytes);
}

TextField *FormDialog::addField(QHBoxLayout *row, TranslatableText caption, CaptionColumn &captions,
                                std::string_view bytes) {
    TextField *field = new TextField(this);
    field->setMinimumWidth(minimumCharactersSeen * field->fontMetrics().averageCharWidth());
    field->showBytes(bytes);
    row->addWidget(captions.newCaption(translated(caption), field));
    addAsField(row, field);
    fields_.push_back(field);
    return field;
}

QPushButton *FormDialog::addBrowseButton(QHBoxLayout *row, int width, TranslatableText caption,
                                         const TextField *field) {
    auto *button = new QPushButton(QStringLiteral("Browse..."), this);
    button->setAccessibleName(plainName(translated(caption)) + ": " + button->text());
    button->setFixedWidth(minimumSizeFor(button, {width, fieldHeight}).width());
    fixHeight(button, field->maximumHeight());
    row->addWidget(button);
    return button;
}

void FormDialog::addAsField(QHBoxLayout *row, QWidget *widget) {
    fixHeight(widget, fieldHeight);
    row->addWidget(widget);
}

void FormDialog::addButtons(int aboveRows, int aboveButtons, int belowButtons) {
    layout_->setContentsMargins(pageBorder, aboveRows, pageBorder, belowButtons);
    layout_->addLayout(rows_);
    layout_->addSpacing(aboveButtons);
    layout_->addLayout(buttons_);
    buttons_->addStretch();
    for (const auto &[caption, slot] :
         {std::pair{"OK", &QDialog::accept}, std::pair{"Cancel", &QDialog::reject}}) {
        auto *button = new QPushButton(QString::fromUtf8(caption), this);
        button->setFixedSize(minimumSizeFor(button, buttonSize));
        button->setDefault(slot == &QDialog::accept);
        connect(button, &QPushButton::clicked, this, slot);
        buttons_->addWidget(button);
    }
}

void FormDialog::fixSize(QSize dialog, QSize panel) {
    besidePanel_ = dialog - panel;
    setFixedSize(dialog.expandedTo(layout_->totalMinimumSize()));
}

void FormDialog::accept() {
    if (std::ranges::none_of(fields_, &TextField::holdsRefusedText)) {
        QDialog::accept();
    }
}

void FormDialog::resizeEvent(QResizeEvent *event) {
    QDialog::resizeEvent(event);
    const QSize panel = size() - besidePanel_;
    panel_->setGeometry(0, 0, panel.width(), std::min(panel.height(), buttons_->geometry().top()));
}

void browseForFile(TextField *field, QWidget *parent) {
    QFileDialog chooser{parent, {}, field->text()};
    chooser.setFileMode(QFileDialog::ExistingFile);
    browse(field, chooser);
}

void browseForDirectory(TextField *field, QWidget *parent) {
    QFileDialog chooser{parent, {}, field->text()};
    chooser.setObjectName("browse");
    chooser.setFileMode(QFileDialog::Directory);
    chooser.setOption(QFileDialog::ShowDirsOnly);
    browse(field, chooser);
}
