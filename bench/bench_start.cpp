// What a start costs: the program on the sample product, beside a bare dialog with seven tabs and
// beside a plain dialog of the same widgets and texts. Each start is a process of its own that ends
// when its window is mapped; the kinds take turns, so that all meet the same machine.
//
//     bench_start          prints the ratios
//     bench_start KIND     is one start: program, bare or plain (to count its instructions, say)

#include "app/ktarvexapplication.h"

#include <QApplication>
#include <QCheckBox>
#include <QDialog>
#include <QElapsedTimer>
#include <QFormLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QSpinBox>
#include <QTabWidget>
#include <QWindow>

#include <algorithm>
#include <array>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace fs = std::filesystem;

namespace {

constexpr int starts = 41;
constexpr std::array tabLabels{"&SMTP",     "&POP3",     "&IMAP",     "Fetchers",
                               "&Delivery", "&Aliasing", "&Mail List"};

/// Ends the process at once when a window is on the screen.
class EndWhenMapped : public QObject {
public:
    bool eventFilter(QObject *watched, QEvent *event) override {
        if (event->type() == QEvent::Expose && qobject_cast<QWindow *>(watched) != nullptr) {
            std::_Exit(0);
        }
        return false;
    }
};

int runProgram(int argc, char **argv) {
    KTarvexApplication application{argc, argv, "kcmtarvex_mail"};
    EndWhenMapped end;
    qApp->installEventFilter(&end);
    return application.exec();
}

void addServer(QVBoxLayout *page, const char *caption, const QStringList &accessLists) {
    auto *group = new QGroupBox(caption);
    auto *form = new QFormLayout(group);
    form->addRow(new QCheckBox("Enable server"));
    for (const char *number : {"&Port:", "&Timeout (secs):", "&Max Connections:"}) {
        auto *box = new QSpinBox;
        box->setRange(0, 65535);
        form->addRow(number, box);
    }
    for (const QString &accessList : accessLists) {
        form->addRow(accessList, new QLineEdit("127.0.0.1/32, 10.0.0.0/8, 192.168.0.0/16"));
    }
    page->addWidget(group);
}

QVBoxLayout *addList(QVBoxLayout *page, const char *caption) {
    auto *group = new QGroupBox(caption);
    auto *row = new QHBoxLayout(group);
    auto *list = new QListWidget;
    for (int number = 0; number < 15; ++number) {
        list->addItem(QString{"user%1@mail.example.com"}.arg(number));
    }
    row->addWidget(list);
    auto *column = new QVBoxLayout;
    for (const char *button : {"Add...", "Modify...", "Remove"}) {
        column->addWidget(new QPushButton(button));
    }
    row->addLayout(column);
    page->addWidget(group);
    return column;
}

void addDelivery(QVBoxLayout *page, const char *caption, const QStringList &texts,
                 const QStringList &numbers) {
    auto *group = new QGroupBox(caption);
    auto *form = new QFormLayout(group);
    for (const QString &text : texts) {
        form->addRow(text, new QLineEdit("example.com,example.org,lists.example.com"));
    }
    for (const QString &number : numbers) {
        auto *row = new QHBoxLayout;
        auto *box = new QSpinBox;
        box->setRange(0, 999);
        row->addWidget(box);
        row->addWidget(new QLabel("(Set to 0 to disable)"));
        auto *label = new QLabel(number);
        label->setBuddy(box);
        form->addRow(label, row);
    }
    page->addWidget(group);
}

/// What the program's pages hold, put together without care for its layout.
void fillPlainly(const std::array<QVBoxLayout *, 7> &pages) {
    addServer(pages[0], "SMTP Server Settings",
              {"&Allow Access:", "A&uth Access:", "&Block Access:"});
    addList(pages[0], "SMTP Domain Blocking");
    addServer(pages[1], "POP3 Server Settings", {"&Allow Access:", "&Block Access:"});
    addServer(pages[2], "IMAP Server Settings", {"&Allow Access:", "&Block Access:"});
    QVBoxLayout *column = addList(pages[3], "POP3 Mail Fetchers");
    column->addWidget(new QLabel("Poll time (s):"));
    column->addWidget(new QSpinBox);
    addDelivery(pages[4], "Mail Debatching", {"&Local Domains:", "&Direct Send:"},
                {"&Idle time (secs):"});
    addDelivery(pages[4], "SMTP Client", {"&Remote SMTP Server:", "&From Header force:"},
                {"&Poll Time (mins):", "&Auto connect queue size:"});
    addList(pages[5], "Mail Aliasing");
    addList(pages[6], "Mail Listing");
}

int runDialog(int argc, char **argv, bool isBare) {
    const QApplication application{argc, argv};
    QDialog dialog;
    dialog.setWindowTitle("Tarvex Mail Config");
    auto *tabs = new QTabWidget;
    std::array<QVBoxLayout *, 7> pages{};
    for (std::size_t tab = 0; tab < pages.size(); ++tab) {
        auto *page = new QWidget;
        tabs->addTab(page, tabLabels.at(tab));
        if (!isBare) {
            pages.at(tab) = new QVBoxLayout(page);
        }
    }
    if (!isBare) {
        fillPlainly(pages);
    }
    auto *layout = new QVBoxLayout(&dialog);
    layout->addWidget(tabs);
    if (!isBare) {
        auto *line = new QLabel("An apply will drop: settings that cannot be kept "
                                "(util.quote.enable), lines of the alias file (8), lines of the "
                                "reject file (6), lines of the mailing-list file (3).");
        line->setWordWrap(true);
        layout->addWidget(line);
    }
    auto *buttons = new QHBoxLayout;
    layout->addLayout(buttons);
    for (const char *label : {"Help", "OK", "Apply", "Cancel"}) {
        buttons->addWidget(new QPushButton(label));
    }
    EndWhenMapped end;
    qApp->installEventFilter(&end);
    dialog.show();
    return QApplication::exec();
}

struct Start {
    double milliseconds;
    double megabytes;
};

Start measured(const char *self, const char *kind) {
    QElapsedTimer timer;
    timer.start();
    const pid_t child = fork();
    if (child == 0) {
        execl(self, self, kind, nullptr);
        std::_Exit(1);
    }
    int status = 0;
    rusage usage{};
    wait4(child, &status, 0, &usage);
    if (status != 0) {
        std::printf("A start failed.\n");
        std::exit(1);
    }
    return {static_cast<double>(timer.nsecsElapsed()) / 1e6,
            static_cast<double>(usage.ru_maxrss) / 1024};
}

double median(const std::vector<Start> &all, double Start::*what) {
    std::vector<double> values;
    values.reserve(all.size());
    for (const Start &start : all) {
        values.push_back(start.*what);
    }
    std::ranges::sort(values);
    return values.at(values.size() / 2);
}

int compare() {
    const std::string self = fs::read_symlink("/proc/self/exe");
    std::vector<Start> program;
    std::vector<Start> bare;
    std::vector<Start> plain;
    for (int start = 0; start < starts; ++start) {
        bare.push_back(measured(self.c_str(), "bare"));
        plain.push_back(measured(self.c_str(), "plain"));
        program.push_back(measured(self.c_str(), "program"));
    }
    for (const auto &[what, unit, field] : {std::tuple{"window mapped", "ms", &Start::milliseconds},
                                            std::tuple{"memory", "MB", &Start::megabytes}}) {
        std::printf("start, %s, median of %d: program %.1f %s, plain %.1f, bare %.1f\n", what,
                    starts, median(program, field), unit, median(plain, field),
                    median(bare, field));
        std::printf("%-62s %8.2f %-9s at most %6.2f\n",
                    (std::string{"    over a bare seven-tab dialog: "} + what).c_str(),
                    median(program, field) / median(bare, field), "times", 1.10);
    }
    return 0;
}

} // namespace

int main(int argc, char **argv) {
    const std::string kind = argc > 1 ? argv[1] : "";
    argc = 1;
    if (kind == "program") {
        return runProgram(argc, argv);
    }
    if (kind == "bare" || kind == "plain") {
        return runDialog(argc, argv, kind == "bare");
    }
    return std::system(LAY_PRODUCT) == 0 ? compare() : 1;
}
