#include "widgets/settingsform.h"

#include "platform/knumericspinbox.h"
#include "widgets/pagelayout.h"
#include "widgets/textfield.h"

#include <QCheckBox>
#include <QHBoxLayout>
#include <QLabel>

SettingsForm::SettingsForm(QWidget *page, int labelWidth)
    : pageLayout_{newPageLayout(page)}, captions_{{labelWidth, 0}} {}

void SettingsForm::group(const char *caption) {
    group_ = new QGroupBox(QString::fromUtf8(caption), pageLayout_->parentWidget());
    groupRows_ = newGroupRows(group_);
    pageLayout_->addWidget(group_);
}

void SettingsForm::checkBox(const char *caption, BoolSetting &setting) {
    auto *box = new QCheckBox(QString::fromUtf8(caption), group_);
    box->setChecked(setting.value != 0);
    QHBoxLayout *row = newRow(groupRows_);
    row->addWidget(box);
    row->addStretch();
    stores_.emplace_back([box, &setting] { setting.value = box->isChecked() ? 1 : 0; });
}

void SettingsForm::number(const char *caption, int minimum, int maximum, NumberSetting &setting,
                          const char *note) {
    KNumericSpinBox *box = newNumberField(group_, minimum, maximum, setting.value);
    QHBoxLayout *row = addField(caption, box);
    if (note != nullptr) {
        auto *label = new QLabel(QString::fromUtf8(note), group_);
        label->setBuddy(box);
        box->setAccessibleDescription(label->text());
        row->addWidget(label);
    }
    row->addStretch();
    stores_.emplace_back([box, &setting] { setting.value = box->getValue(); });
}

void SettingsForm::text(const char *caption, TextSetting &setting) {
    TextField *field = newTextField(caption, setting.value.value_or(std::string{}));
    stores_.emplace_back([field, &setting] {
        if (field->showsPartOnly()) {
            return;
        }
        const std::string bytes = field->bytes();
        if (setting.value || !bytes.empty()) {
            textSetting(setting.value, bytes);
        }
    });
}

void SettingsForm::accessList(const char *caption, AccessListSetting &setting) {
    TextField *field = newTextField(
        caption, accessListSetting(setting.value, std::nullopt).value_or(std::string{}));
    const QString syntax = translated(
        translatable("\"all\", \"none\" or IPv4 addresses, with commas between them.\n"
                     "Behind an address: /0 (every address), /8, /16, /24 or /32, or a blank and a "
                     "mask.\n"
                     "Any other size is stored as one of these: 172.16.0.0/12 as 172.16.0.0/16."));
    field->setToolTip(syntax);
    field->setAccessibleDescription(syntax);
    stores_.emplace_back([field, &setting] { accessListSetting(setting.value, field->bytes()); });
}

void SettingsForm::store() const {
    for (const auto &storeRow : stores_) {
        storeRow();
    }
}

QHBoxLayout *SettingsForm::addField(const char *caption, QWidget *field) {
    QHBoxLayout *row = newRow(groupRows_);
    row->addWidget(captions_.newCaption(QString::fromUtf8(caption), field));
    row->addWidget(field);
    return row;
}

TextField *SettingsForm::newTextField(const char *caption, std::string_view bytes) {
    TextField *field = new TextField(group_);
    field->showBytes(bytes);
    addField(caption, field);
    return field;
}
