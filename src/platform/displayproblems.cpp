#include "platform/displayproblems.h"

#include <QString>

#include <cstdio>
#include <cstdlib>
#include <utility>
#include <vector>

namespace {

const char *name = nullptr;
QtMessageHandler before = nullptr;
std::vector<std::pair<QtMsgType, QString>> held;

void hold(QtMsgType type, const QMessageLogContext & /*where*/, const QString &text) {
    held.emplace_back(type, text);
    if (type == QtFatalMsg) {
        std::fprintf(stderr, "%s: no display can be opened\n", name);
        for (const auto &[heldType, heldText] : held) {
            std::fprintf(stderr, "%s\n", qPrintable(heldText.trimmed()));
        }
        std::_Exit(1);
    }
}

} // namespace

DisplayProblems::DisplayProblems(const char *program) {
    name = program;
    before = qInstallMessageHandler(hold);
}

DisplayProblems::~DisplayProblems() {
    qInstallMessageHandler(before);
    for (const auto &[type, text] : std::exchange(held, {})) {
        qt_message_output(type, {}, text);
    }
}
