#include "fetch/mailfetch.h"

#include "config/settings.h"
#include "fetch/editfetch.h"
#include "fetch/pophosts.h"
#include "platform/knumericspinbox.h"
#include "widgets/listgroup.h"
#include "widgets/numberfield.h"
#include "widgets/pagelayout.h"
#include "widgets/recordrows.h"

#include <QLabel>

namespace {

constexpr int columnWidth = 80;
constexpr int spaceAbovePollTime = 40;

std::string_view shown(const pop_host &host) { return popHostText(host.user); }

} // namespace

MailFetch::MailFetch(QWidget *parent, const char *name)
    : KConfigWidget(parent, name),
      pollTime_{newNumberField(nullptr, 0, 999, settings().pop_time.value)} {
    auto *group = new ListGroup("POP3 Mail Fetchers", {600, columnWidth}, this);
    fetchers_ = group->box();
    appendRows(fetchers_, pop_host_list, shown);
    group->addEditButtons(this, &MailFetch::MailFetchAdd, &MailFetch::MailFetchModify,
                          &MailFetch::MailFetchRemove, &MailFetch::MailFetchSelected);

    auto *label = new QLabel(QStringLiteral("Poll time (s):"));
    label->setBuddy(pollTime_);
    QVBoxLayout *column = group->column();
    column->addSpacing(spaceAbovePollTime);
    column->addWidget(label);
    column->addWidget(pollTime_);
    column->addStretch();
    group->fixColumnWidth(columnWidth);
    newPageLayout(this)->addWidget(group);
}

void MailFetch::loadValues() {}

void MailFetch::storeValues() {
    settings().pop_time.value = pollTime_->getValue();
    if (popHostsAreWhole()) {
        textSetting(settings().pop_hosts.value, formatPopHosts());
    }
}

void MailFetch::MailFetchAdd() {
    addByDialog<EditFetch>(this, fetchers_, &pop_host_list.head, &MailFetch::MailFetchRead, shown);
}

void MailFetch::MailFetchRemove() { removeCurrent(fetchers_, &pop_host_list.head, shown); }

void MailFetch::MailFetchSelected(const char *user) {
    changeByDialog<EditFetch>(this, fetchers_, &pop_host_list.head, user, &MailFetch::MailFetchRead,
                              shown);
}

void MailFetch::MailFetchModify() { MailFetchSelected(currentText(fetchers_)); }

void MailFetch::MailFetchRead(pop_host *host, EditFetch *dialog) {
    if (host != nullptr && dialog != nullptr) {
        // All three are there before one is changed, should memory run out.
        const std::string server = dialog->server();
        const std::string user = dialog->user();
        const std::string password = dialog->password();
        setPopHostText(host->server, server);
        setPopHostText(host->user, user);
        setPopHostText(host->password, password);
    }
}
