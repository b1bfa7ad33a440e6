#include "server/mailimap.h"

#include "server/serverform.h"

MailIMAP::MailIMAP(QWidget *parent, const char *name)
    : KConfigWidget(parent, name),
      form_{serverForm(this, "IMAP Server Settings",
                       {settings().imap_sock_enabled, settings().imap_sock_port,
                        settings().imap_sock_timeout, settings().imap_sock_max,
                        settings().imap_allow, nullptr, settings().imap_block})} {
    form_.pageLayout()->addStretch();
}
