#include "server/mailpop3.h"

#include "server/serverform.h"

MailPOP3::MailPOP3(QWidget *parent, const char *name)
    : KConfigWidget(parent, name),
      form_{serverForm(this, "POP3 Server Settings",
                       {settings().pop_sock_enabled, settings().pop_sock_port,
                        settings().pop_sock_timeout, settings().pop_sock_max, settings().pop_allow,
                        nullptr, settings().pop_block})} {
    form_.pageLayout()->addStretch();
}
