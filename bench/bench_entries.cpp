// What a million entries cost, in passes: one pass is the CPU time of reading and writing the same
// file line by line with the C library, keeping nothing. Every measure is taken in a process of its
// own, the minimum of several; the parent prints one line a measure, the goal behind it.

#include "alias/aliasfile.h"
#include "app/ktarvexapplication.h"
#include "base/lines.h"
#include "base/textfile.h"
#include "config/masterfile.h"
#include "config/productpaths.h"
#include "config/settings.h"
#include "fetch/pophosts.h"
#include "lists/listsearch.h"
#include "lists/maillistfile.h"
#include "platform/qlistbox.h"
#include "server/smtprejectfile.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QTimer>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <functional>
#include <sys/mman.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

const std::string product = BENCH_PRODUCT;
const std::string aliasPath = product + "/config/alias";
const std::string rejectPath = product + "/config/reject";
const std::string listPath = product + "/config/lists";
constexpr int million = 1'000'000;

double cpuMilliseconds(const timeval &time) {
    return static_cast<double>(time.tv_sec) * 1e3 + static_cast<double>(time.tv_usec) / 1e3;
}

/// CPU time of this process.
double cpuMilliseconds() {
    timespec time{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &time);
    return static_cast<double>(time.tv_sec) * 1e3 + static_cast<double>(time.tv_nsec) / 1e6;
}

struct Cost {
    double milliseconds = 0; ///< CPU time of the whole process, the system's for it included.
    double megabytes = 0;    ///< The maximum while it runs.
    double ofWork = 0;       ///< CPU time of the work alone, in milliseconds.
};

/// What a process costs that does `work` and nothing else; the minimum of several tries, `prepare`
/// before each.
Cost costOf(const std::function<void()> &prepare, const std::function<void()> &work,
            int tries = 5) {
    Cost minimum{.milliseconds = 1e12, .megabytes = 1e12, .ofWork = 1e12};
    // The child's answer.
    auto *ofWork = static_cast<double *>(
        mmap(nullptr, sizeof(double), PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0));
    for (int turn = 0; turn < tries; ++turn) {
        prepare();
        const pid_t child = fork();
        if (child == 0) {
            const double before = cpuMilliseconds();
            work();
            *ofWork = cpuMilliseconds() - before;
            std::exit(0);
        }
        int status = 0;
        rusage usage{};
        wait4(child, &status, 0, &usage);
        if (status != 0) {
            std::printf("A measure failed.\n");
            std::exit(1);
        }
        minimum.milliseconds = std::min(minimum.milliseconds, cpuMilliseconds(usage.ru_utime) +
                                                                  cpuMilliseconds(usage.ru_stime));
        minimum.ofWork = std::min(minimum.ofWork, *ofWork);
        minimum.megabytes =
            std::min(minimum.megabytes, static_cast<double>(usage.ru_maxrss) / 1024.0);
    }
    return minimum;
}

std::string numbered(const char *format, int number) {
    std::array<char, 200> text{};
    std::snprintf(text.data(), text.size(), format, number, number % 100'000, number % 1000);
    return text.data();
}

std::string lines(const char *before, const char *format, int count, const char *behind = "") {
    std::string bytes = before;
    for (int entry = 0; entry < count; ++entry) {
        bytes += numbered(format, entry);
    }
    return bytes + behind;
}

std::string rejects(int count) { return lines("", "spam%07d.example.org\n", count); }

std::string aliases(int count) {
    return lines(
        "", "user%07d@mail.example.com,target%05d@example.org,#staff%03d,bob@example.net\n", count);
}

std::string members(int count) {
    return lines("#new\n%name:large\n#start member\n", "member%07d@lists.example.com\n", count,
                 "#end\n#endlist\n");
}

std::string manyLists(int count) {
    std::string bytes;
    for (int list = 0; list < count / 100; ++list) {
        bytes += numbered("#new\n%%name:list%07d\n#start member\n", list) +
                 lines("", "member%07d@lists.example.com\n", 100, "#end\n#endlist\n");
    }
    return bytes;
}

std::string fetchers(int count) {
    return lines("%pop.hosts: *a:b@c\n", "\t*user%07d:secret%05d@pop%03d.example.com\n", count);
}

std::string continuations(int count) {
    return lines("%mail.domains: a\n", "\tdomain%07d.example.com\n", count);
}

/// A line for every key.
std::string allKeys(const char *value) {
    std::string bytes;
    for (const Setting *setting : settings().all()) {
        bytes += '%' + std::string{setting->key()} + ": " + value + '\n';
    }
    return bytes;
}

std::string masterPath() { return productPaths().master; }

void roundTripMaster() {
    readMasterConfig();
    writeMasterConfig();
}

void roundTripFetchers() {
    readMasterConfig();
    parsePopHosts(settings().pop_hosts.value);
    textSetting(settings().pop_hosts.value, formatPopHosts());
    writeMasterConfig();
}

void roundTripRejects() {
    readSmtpRejectFile();
    writeSmtpRejectFile();
}

void roundTripAliases() {
    readAliasFile();
    writeAliasFile();
}

void roundTripLists() {
    readMailListFile();
    writeMailListFile();
}

struct Maximum {
    double passes = 0;
    double sessionPasses = 0; ///< 0: no session is measured.
    double bytes = 0;         ///< Of memory, an entry.
};

struct Format {
    const char *name;
    std::string (*file)(int count);
    std::string path;
    void (*roundTrip)();
    Maximum maximum;
};

const std::vector<Format> &formats() {
    static const std::vector<Format> all{
        {"reject entries",
         rejects,
         rejectPath,
         roundTripRejects,
         {.passes = 1.7, .sessionPasses = 3.5, .bytes = 120}},
        {"aliases, three targets",
         aliases,
         aliasPath,
         roundTripAliases,
         {.passes = 2.6, .sessionPasses = 3.5, .bytes = 300}},
        {"members of one list",
         members,
         listPath,
         roundTripLists,
         {.passes = 1.7, .sessionPasses = 2.0, .bytes = 90}},
        {"10,000 lists of 100", manyLists, listPath, roundTripLists, {.passes = 1.7}},
        {"fetchers", fetchers, masterPath(), roundTripFetchers, {.passes = 6}},
        {"continuation lines", continuations, masterPath(), roundTripMaster, {.passes = 3}}};
    return all;
}

/// With one file of a million entries, say, and the others empty.
void layProduct(const std::string &path = {}, std::string_view bytes = {}) {
    if (std::system(LAY_PRODUCT) != 0) {
        std::abort();
    }
    const std::string paths = "%mail.file.alias: " + aliasPath +
                              "\n%mail.file.smtpreject: " + rejectPath +
                              "\n%mail.file.maillist: " + listPath + "\n";
    rewriteFile(productPaths().master, paths);
    rewriteFile(productPaths().masterTemplate,
                paths + "%pop.hosts:\n%mail.domains:\n%smtp.sock.port: 25\n");
    if (!path.empty()) {
        rewriteFile(path, bytes);
    }
}

void pathsAreSet() {
    settings().mail_file_smtpreject.value = rejectPath;
    settings().mail_file_alias.value = aliasPath;
    settings().mail_file_maillist.value = listPath;
}

void pass(const std::string &path) {
    FILE *from = std::fopen(path.c_str(), "r");
    FILE *to = std::fopen((product + "/copy").c_str(), "w");
    if (from == nullptr || to == nullptr) {
        std::abort();
    }
    std::array<char, 4096> line{};
    while (std::fgets(line.data(), line.size(), from) != nullptr) {
        std::fputs(line.data(), to);
    }
    std::fclose(from);
    std::fclose(to);
}

/// Start, window, OK, end.
void session(bool pressesOk) {
    int argumentCount = 1;
    std::array<char, 6> name{"bench"};
    std::array<char *, 2> arguments{name.data(), nullptr};
    KTarvexApplication application{argumentCount, arguments.data(), "kcmtarvex_mail"};
    QTimer::singleShot(100, [pressesOk] {
        for (QWidget *window : QApplication::topLevelWidgets()) {
            for (auto *button : window->findChildren<QAbstractButton *>()) {
                if (button->text() == (pressesOk ? "OK" : "Cancel") && button->window() == window) {
                    button->click();
                    return;
                }
            }
        }
    });
    application.exec();
}

void print(const std::string &what, double value, const char *unit, double maximum) {
    std::printf("%-62s %8.2f %-9s at most %6.2f  %s\n", what.c_str(), value, unit, maximum,
                value <= maximum ? "" : "MISSED");
    std::fflush(stdout);
}

double loadAndWrite(const Format &format, int count) {
    const std::string bytes = format.file(count);
    const auto prepare = [&] { layProduct(format.path, bytes); };
    const auto roundTrip = [&format] {
        pathsAreSet();
        format.roundTrip();
    };
    return costOf(prepare, roundTrip, 9).ofWork;
}

void measureFormats() {
    for (const Format &format : formats()) {
        const double little = loadAndWrite(format, million / 100);
        const double much = loadAndWrite(format, million);
        const std::string bytes = format.file(million);
        const auto prepare = [&] { layProduct(format.path, bytes); };
        const double plain = costOf(prepare, [&] { pass(format.path); }).ofWork;
        print(std::string{"load + write: "} + format.name, much / plain, "passes",
              format.maximum.passes);
        print(std::string{"growth from 10,000: "} + format.name,
              std::log(much / little) / std::log(100.0), "exponent", 1.05);
        if (format.maximum.sessionPasses > 0) {
            const auto pressOk = [] { session(true); };
            const Cost full = costOf(prepare, pressOk);
            const Cost empty = costOf([] { layProduct(); }, pressOk);
            print(std::string{"session over an empty one: "} + format.name,
                  (full.milliseconds - empty.milliseconds) / plain, "passes",
                  format.maximum.sessionPasses);
            print(std::string{"memory an entry: "} + format.name,
                  (full.megabytes - empty.megabytes) * 1024 * 1024 / million, "bytes",
                  format.maximum.bytes);
        }
    }
}

void measureMasterFile() {
    const auto prepare = [] {
        layProduct();
        rewriteFile(productPaths().master, allKeys("10.1.2.3"));
        rewriteFile(productPaths().masterTemplate, allKeys(""));
    };
    const double milliseconds = costOf(prepare, roundTripMaster, 9).ofWork;
    print("load + write: a master file of all keys", milliseconds, "ms", 2);
}

void measureStart() {
    const auto prepare = [] {
        layProduct();
        for (std::size_t format = 0; format < 3; ++format) {
            rewriteFile(formats().at(format).path, formats().at(format).file(million));
        }
    };
    const auto startAndEnd = [] { session(false); };
    const Cost cost = costOf(prepare, startAndEnd, 3);
    print("start and end with a million in each of the three files", cost.milliseconds, "ms", 500);
    print("its memory", cost.megabytes, "MB", 462);
}

void measureRows() {
    static int argumentCount = 1;
    static std::array<char, 6> name{"bench"};
    static std::array<char *, 2> arguments{name.data(), nullptr};
    const QApplication application{argumentCount, arguments.data()};
    std::vector<KeptText> texts;
    texts.reserve(million);
    LinePieces rows{keep(lines("", "member%07d@lists.example.com\n", million))};
    while (const auto row = rows.next()) {
        texts.push_back(lineText(*row)); // Parts of a file, as in the program.
    }
    QListBox box;
    box.resize(300, 300);
    box.append(texts);
    box.show();
    QApplication::processEvents();
    box.setCurrentRow(million / 2);
    const auto measure = [](const char *what, double maximum, const std::function<void()> &work) {
        double worst = 0;
        for (int turn = 0; turn < 5; ++turn) {
            const double before = cpuMilliseconds();
            work();
            QApplication::processEvents();
            worst = std::max(worst, cpuMilliseconds() - before);
        }
        print(std::string{"a million rows, the slowest of five: "} + what, worst, "ms", maximum);
    };
    measure("add", 25, [&box] { box.append(keep("added")); });
    measure("modify", 5, [&box] { box.changeText(million / 2, keep("changed")); });
    measure("remove", 25, [&box] { box.remove(*box.currentRow()); });
    measure("search to the end", 10, [&box] {
        if (nextRowHolding(&box, "member99x")) {
            std::exit(1);
        }
    });
}

} // namespace

int main() {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    measureFormats();
    measureMasterFile();
    measureStart();
    // A process with an application of its own: the measures before forked from one without.
    costOf([] {}, measureRows, 1);
    return 0;
}
