// What 10,000, 100,000 and 1,000,000 entries cost: read from the file, shown, one added, written.
// Beside it stands the time that plainly reading and writing the same bytes takes.

#include "alias/aliasfile.h"
#include "alias/mailalias.h"
#include "base/textfile.h"
#include "config/settings.h"
#include "lists/editlist.h"
#include "lists/maillistfile.h"
#include "server/mailsmtp.h"
#include "server/smtprejectfile.h"

#include <QApplication>
#include <QElapsedTimer>

#include <array>
#include <cstdio>
#include <filesystem>
#include <functional>
#include <string>

namespace {

const std::string file = std::string{BENCH_PRODUCT} + "/entries";

double milliseconds(const std::function<void()> &work) {
    QElapsedTimer timer;
    timer.start();
    work();
    return static_cast<double>(timer.nsecsElapsed()) / 1e6;
}

void show(QWidget &widget) {
    widget.show();
    QApplication::processEvents();
}

std::string numbered(const char *before, int number, const char *behind) {
    return before + std::to_string(number) + behind;
}

std::string rejectFile(int count) {
    std::string bytes;
    for (int entry = 0; entry < count; ++entry) {
        bytes += numbered("spam", entry, ".example.com\n");
    }
    return bytes;
}

void rejects() {
    readSmtpRejectFile();
    MailSMTP page{nullptr, "smtpserver"};
    show(page);
    prependRecord(&smtpreject_list.head, {"added.example.com"});
    writeSmtpRejectFile();
}

std::string aliasFile(int count) {
    std::string bytes;
    for (int entry = 0; entry < count; ++entry) {
        bytes += numbered("user", entry, "@example.com,ann,#staff,bob@example.net\n");
    }
    return bytes;
}

void aliases() {
    alias_list.clear();
    readAliasFile();
    MailAlias page{nullptr, "alias"};
    show(page);
    prependRecord(&alias_list.head, {"added@example.com", {}});
    writeAliasFile();
}

std::string listFile(int count) {
    std::string bytes = "#new\n%name:large\n#start member\n";
    for (int entry = 0; entry < count; ++entry) {
        bytes += numbered("member", entry, "@example.com\n");
    }
    return bytes + "#end\n#endlist\n";
}

void members() {
    readMailListFile();
    EditList editor{nullptr, "edit", maillist_list.head};
    show(editor);
    editor.store(*maillist_list.head);
    maillist_list.head->member.head->addr = "changed@example.com";
    writeMailListFile();
}

struct Format {
    const char *name;
    std::string (*makeFile)(int count);
    void (*roundTrip)();
};

constexpr std::array<Format, 3> formats{{{"reject entries", rejectFile, rejects},
                                         {"aliases of three targets", aliasFile, aliases},
                                         {"members of one list", listFile, members}}};

} // namespace

int main(int argc, char **argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    const QApplication application{argc, argv};
    std::filesystem::create_directories(BENCH_PRODUCT);
    settings().mail_file_smtpreject.value = file;
    settings().mail_file_alias.value = file;
    settings().mail_file_maillist.value = file;
    for (const Format &format : formats) {
        double before = 0;
        for (const int count : {10'000, 100'000, 1'000'000}) {
            rewriteFile(file, format.makeFile(count));
            const double plain =
                milliseconds([] { rewriteFile(file, readWholeFile(file).value_or("")); });
            const double all = milliseconds(format.roundTrip);
            std::printf("%8d %s: %8.1f ms, plain %7.1f ms, ratio %5.1f", count, format.name, all,
                        plain, all / plain);
            std::printf(before > 0 ? ", growth %4.1f\n" : "\n", all / before);
            before = all;
        }
    }
    return 0;
}
