#include "app/ktarvexapplication.h"
#include "platform/process.h"

#include <cstdio>
#include <new>

int main(int argc, char **argv) {
    prepareProcess();
    try {
        KTarvexApplication application{argc, argv, "kcmtarvex_mail"};
        application.setTitle(
            KApplication::getLocale()->translate(translatable("Tarvex Mail Config")));
        return application.isInitOnly() ? 0 : application.exec();
    } catch (const std::bad_alloc &) { // Before there was a window: nothing can be lost.
        std::fputs("kcmtarvex_mail: out of memory\n", stderr);
        return 1;
    }
}
