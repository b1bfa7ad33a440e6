#include "app/ktarvexapplication.h"

int main(int argc, char **argv) {
    KTarvexApplication application{argc, argv, "kcmtarvex_mail"};
    application.setTitle(KApplication::getLocale()->translate(translatable("Tarvex Mail Config")));
    return application.isInitOnly() ? 0 : application.exec();
}
