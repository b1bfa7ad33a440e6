#include "widgets/settingsform.h"

#include "platform/knumericspinbox.h"
#include "widgets/captions.h"
#include "widgets/fieldtext.h"
#include "widgets/numberfield.h"
#include "widgets/pagelayout.h"

#include <QCheckBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>

SettingsForm::SettingsForm(QWidget *page, int labelWidth)
    : pageLayout_{newPageLayout(page)}, labelWidth_{labelWidth} {}

void SettingsForm::group(const char *caption) {
    group_ = new QGroupBox(QString::fromUtf8(caption), pageLayout_->parentWidget());
    groupLayout_ = newGroupLayout(group_);
    pageLayout_->addWidget(group_);
}

void SettingsForm::checkBox(const char *caption, BoolSetting &setting) {
    auto *box = new QCheckBox(QString::fromUtf8(caption), group_);
    box->setChecked(setting.value != 0);
    QHBoxLayout *row = newRow();
    row->addWidget(box);
    row->addStretch();
    stores_.emplace_back([box, &setting] { setting.value = box->isChecked() ? 1 : 0; });
}

void SettingsForm::number(const char *caption, int lowest, int highest, NumberSetting &setting,
                          const char *note) {
    KNumericSpinBox *box = newNumberField(group_, lowest, highest, setting.value);
    QHBoxLayout *row = newRow(caption, box);
    if (note != nullptr) {
        row->addWidget(new QLabel(QString::fromUtf8(note), group_));
    }
    row->addStretch();
    stores_.emplace_back([box, &setting] { setting.value = box->getValue(); });
}

void SettingsForm::text(const char *caption, TextSetting &setting) {
    QLineEdit *field = newField(group_);
    showBytes(field, setting.value.value_or(std::string{}));
    newRow(caption, field);
    stores_.emplace_back([field, &setting] {
        const std::string bytes = fieldBytes(field);
        if (setting.value || !bytes.empty()) {
            textSetting(setting.value, bytes);
        }
    });
}

void SettingsForm::accessList(const char *caption, AccessListSetting &setting) {
    QLineEdit *field = newField(group_);
    showBytes(field, accessListSetting(setting.value, std::nullopt).value_or(std::string{}));
    newRow(caption, field);
    stores_.emplace_back(
        [field, &setting] { accessListSetting(setting.value, fieldBytes(field)); });
}

void SettingsForm::store() const {
    for (const auto &storeRow : stores_) {
        storeRow();
    }
}

QHBoxLayout *SettingsForm::newRow() {
    auto *row = new QHBoxLayout;
    row->setSpacing(groupSpacing);
    groupLayout_->addLayout(row);
    return row;
}

QHBoxLayout *SettingsForm::newRow(const char *caption, QWidget *field) {
    const QString text = QString::fromUtf8(caption);
    auto *label = new QLabel(text, group_);
    label->setFixedWidth(widened({labelWidth_, 0}, {text}).width());
    label->setBuddy(field);
    QHBoxLayout *row = newRow();
    row->addWidget(label);
    row->addWidget(field);
    return row;
}
