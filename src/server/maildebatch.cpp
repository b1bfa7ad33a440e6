#include "server/maildebatch.h"

namespace {

constexpr int labelWidth = 160;
constexpr int highest = 999;
constexpr const char *zeroDisables = "(Set to 0 to disable)";

} // namespace

MailDebatch::MailDebatch(QWidget *parent, const char *name)
    : KConfigWidget(parent, name), form_{this, labelWidth} {
    form_.group("Mail Debatching");
    form_.text("&Local Domains:", settings().mail_domains);
    form_.text("&Direct Send:", settings().smtp_direct);
    form_.number("&Idle time (secs):", 0, highest, settings().mail_debatch_time, zeroDisables);
    form_.group("SMTP Client");
    form_.text("&Remote SMTP Server:", settings().smtp_hosts);
    form_.number("&Poll Time (mins):", 0, highest, settings().smtp_time, zeroDisables);
    form_.number("&Auto connect queue size:", 0, highest, settings().mail_auto_send, zeroDisables);
    form_.text("&From Header force:", settings().mail_from_force);
    form_.pageLayout()->addStretch();
}
