#include "fetch/mailfetch.h"

#include "config/settings.h"
#include "fetch/editfetch.h"
#include "platform/knumericspinbox.h"
#include "widgets/pagelayout.h"

#include <QLabel>

namespace {

constexpr int columnWidth = 80;
constexpr int spaceAbovePollTime = 40;

std::string_view shown(const pop_host &host) { return popHostText(host.user); }

} // namespace

MailFetch::MailFetch(QWidget *parent, const char *name)
    : KConfigWidget(parent, name),
      group_{new ListGroup("POP3 Mail Fetchers", {.box = 600, .column = columnWidth}, this)},
      fetchers_{this, group_->box(), &pop_host_list.head, shown, &MailFetch::MailFetchRead},
      pollTime_{newNumberField(nullptr, 0, 999, settings().pop_time.value)} {
    fetchers_.fill();
    group_->addEditButtons(this, &MailFetch::MailFetchAdd, &MailFetch::MailFetchModify,
                           &MailFetch::MailFetchRemove, &MailFetch::MailFetchSelected);

    auto *label = new QLabel(QStringLiteral("Poll time (s):"));
    label->setBuddy(pollTime_);
    QVBoxLayout *column = group_->column();
    column->addSpacing(spaceAbovePollTime);
    column->addWidget(label);
    column->addWidget(pollTime_);
    column->addStretch();
    group_->fixColumnWidth(columnWidth);
    newPageLayout(this)->addWidget(group_);
}

void MailFetch::storeValues() {
    settings().pop_time.value = pollTime_->getValue();
    if (popHostsAreWhole()) {
        textSetting(settings().pop_hosts.value, formatPopHosts());
    }
}

void MailFetch::MailFetchAdd() { fetchers_.add(); }

void MailFetch::MailFetchRemove() { fetchers_.removeCurrent(); }

void MailFetch::MailFetchSelected(const char *user) { fetchers_.change(user); }

void MailFetch::MailFetchModify() { fetchers_.changeCurrent(); }

void MailFetch::MailFetchRead(pop_host *host, EditFetch *dialog) {
    if (host != nullptr && dialog != nullptr) {
        dialog->store(*host);
    }
}
