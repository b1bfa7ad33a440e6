#pragma once

#include "platform/kconfigwidget.h"

class EditList;
class QListBox;
struct maillist_entry;

/// The page of the mailing lists. They are edited in place.
class MailList : public KConfigWidget {
    Q_OBJECT

public:
    MailList(QWidget *parent, const char *name);

    void loadValues() override;
    void storeValues() override;

public slots:
    void MailListAdd();
    void MailListRemove();
    void MailListSelected(const char *name);
    void MailListModify();
    void MailListRead(maillist_entry *record, EditList *editor);

private:
    QListBox *lists_;
};
