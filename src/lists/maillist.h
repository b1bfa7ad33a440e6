#pragma once

#include "lists/maillistfile.h"
#include "platform/kconfigwidget.h"
#include "widgets/listgroup.h"
#include "widgets/recordrows.h"

class EditList;

/// The page of the mailing lists. They are edited in place.
class MailList : public KConfigWidget {
    Q_OBJECT

public:
    MailList(QWidget *parent, const char *name);

    void loadValues() override {}
    void storeValues() override {}

public slots:
    void MailListAdd();
    void MailListRemove();
    void MailListSelected(const char *name);
    void MailListModify();
    void MailListRead(maillist_entry *record, EditList *editor);

private:
    ListGroup *group_;
    RecordRows<MailList, maillist_entry, EditList> lists_;
};
