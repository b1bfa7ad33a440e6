#pragma once

#include "platform/kconfigwidget.h"

class EditAlias;
class QListBox;
struct alias_entry;

/// The page of the aliases. They are edited in place.
class MailAlias : public KConfigWidget {
    Q_OBJECT

public:
    MailAlias(QWidget *parent, const char *name);

    void loadValues() override;
    void storeValues() override;

public slots:
    void MailAliasAdd();
    void MailAliasRemove();
    void MailAliasSelected(const char *address);
    void MailAliasModify();
    void MailAliasRead(alias_entry *alias, EditAlias *dialog);

private:
    QListBox *aliases_;
};
