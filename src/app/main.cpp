#include "app/ktarvexapplication.h"
#include "platform/process.h"

#include <algorithm>
#include <cstdio>
#include <new>
#include <string_view>

namespace {

int run(int argc, char **argv) {
    KTarvexApplication application{argc, argv, "kcmtarvex_mail"};
    application.setTitle(KApplication::getLocale()->translate(translatable("Tarvex Mail Config")));
    return application.isInitOnly() ? 0 : application.exec();
}

} // namespace

int main(int argc, char **argv) {
    prepareProcess();
    try {
        return run(argc, argv);
    } catch (const std::bad_alloc &) { // Before there was a window: nothing can be lost.
        std::fputs("kcmtarvex_mail: out of memory\n", stderr);
        const auto isInit = [](std::string_view argument) {
            return argument == "-init" || argument == "--init";
        };
        return std::any_of(argv, argv + argc, isInit) ? 0 : 1;
    }
}
