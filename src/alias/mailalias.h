#pragma once

#include "alias/aliasfile.h"
#include "platform/kconfigwidget.h"
#include "widgets/listgroup.h"
#include "widgets/recordrows.h"

class EditAlias;

/// The page of the aliases. They are edited in place.
class MailAlias : public KConfigWidget {
    Q_OBJECT

public:
    MailAlias(QWidget *parent, const char *name);

    void loadValues() override {}
    void storeValues() override {}

public slots:
    void MailAliasAdd();
    void MailAliasRemove();
    void MailAliasSelected(const char *address);
    void MailAliasModify();
    void MailAliasRead(alias_entry *alias, EditAlias *dialog);

private:
    ListGroup *group_;
    RecordRows<MailAlias, alias_entry, EditAlias> aliases_;
};
