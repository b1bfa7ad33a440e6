#include "platform/displayproblems.h"

#include <QByteArray>
#include <QString>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <utility>
#include <vector>

namespace {

struct Message {
    QtMsgType type;
    QByteArray category;
    QString text;
};

const char *name = nullptr;
QtMessageHandler before = nullptr;
std::vector<Message> held;

[[noreturn]] void end() {
    std::fprintf(stderr, "%s: no display can be opened\n", name);
    // A platform that was found has said what is wrong before its loader does, which knows no more
    // and advises to install the program again.
    const auto loader = std::ranges::find(held, "qt.qpa.plugin", &Message::category);
    const auto last = loader == held.begin() ? held.end() : loader;
    for (auto message = held.begin(); message != last; ++message) {
        std::fprintf(stderr, "%s\n", qPrintable(message->text.trimmed()));
    }
    std::_Exit(1);
}

void hold(QtMsgType type, const QMessageLogContext &where, const QString &text) {
    held.push_back({.type = type, .category = where.category, .text = text});
    if (type == QtFatalMsg) {
        end();
    }
}

} // namespace

DisplayProblems::DisplayProblems(const char *program) {
    name = program;
    before = qInstallMessageHandler(hold);
}

DisplayProblems::~DisplayProblems() {
    qInstallMessageHandler(before);
    for (const Message &message : std::exchange(held, {})) {
        qt_message_output(message.type, {}, message.text);
    }
}
