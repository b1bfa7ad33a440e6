#include "fetch/editfetch.h"

#include "fetch/pophosts.h"
#include "widgets/textfield.h"

namespace {

/// `toolTip` has the number at its "%1".
FieldRule ruleFor(std::size_t size, TranslatableText toolTip) {
    const std::size_t maximum = size - 1;
    return {.refused = QStringLiteral(":@,"),
            .toolTip = translated(toolTip).arg(maximum),
            .maximumBytes = maximum};
}

} // namespace

EditFetch::EditFetch(QWidget *parent, const char *name, const pop_host *host)
    : FormDialog(parent, name, "POP Fetcher Settings") {
    CaptionColumn captions{{70, 18}};
    const pop_host shown = host != nullptr ? *host : pop_host{};
    server_ = addField(addRow(), translatable("&Server:"), captions, popHostText(shown.server));
    user_ = addField(addRow(), translatable("&Username:"), captions, popHostText(shown.user));
    password_ =
        addField(addRow(), translatable("&Password:"), captions, popHostText(shown.password));
    addButtons(pageBorder, 15);
    fixSize({250, 140}, {247, 110});

    const TranslatableText rule = translatable("At most %1 bytes, without \":\", \"@\" and \",\"");
    server_->setRule(ruleFor(shown.server.size(), rule));
    password_->setRule(ruleFor(shown.password.size(), rule));
    FieldRule userRule =
        ruleFor(shown.user.size(),
                translatable("At most %1 bytes, without \":\", \"@\" and \",\";\n"
                             "not beginning with \"-\", \"*\", \"%\", \"|\" or a blank"));
    // A new entry stands without a prefix at the beginning of a line, where these have a meaning of
    // their own or, like white space, are dropped.
    userRule.refusedFirst = QStringLiteral("-*%| \t\r\n") + QChar(u'\0');
    user_->setRule(userRule);
}

void EditFetch::store(pop_host &host) const {
    setPopHostText(host.server, server_->bytes());
    setPopHostText(host.user, user_->bytes());
    setPopHostText(host.password, password_->bytes());
}
