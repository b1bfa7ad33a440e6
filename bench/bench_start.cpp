// How long the program takes from its start to its window, beside a bare dialog with seven tabs.
// Each start is a process of its own, the two kinds in turn, so that both meet the same machine.

#include "app/ktarvexapplication.h"

#include <QApplication>
#include <QDialog>
#include <QElapsedTimer>
#include <QProcess>
#include <QPushButton>
#include <QTabWidget>
#include <QTimer>
#include <QVBoxLayout>

#include <algorithm>
#include <array>
#include <cstdio>
#include <filesystem>
#include <string>
#include <vector>

namespace fs = std::filesystem;

namespace {

constexpr int starts = 31;

/// Ends the process once a window has been painted.
class EndAtFirstPaint : public QObject {
public:
    bool eventFilter(QObject *, QEvent *event) override {
        if (event->type() == QEvent::Paint) {
            QTimer::singleShot(0, qApp, &QCoreApplication::quit);
        }
        return false;
    }
};

int runProgram(int argc, char **argv) {
    KTarvexApplication application{argc, argv, "kcmtarvex_mail"};
    EndAtFirstPaint end;
    qApp->installEventFilter(&end);
    return application.exec();
}

int runBareDialog(int argc, char **argv) {
    const QApplication application{argc, argv};
    QDialog dialog;
    auto *tabs = new QTabWidget;
    for (const char *label :
         {"&SMTP", "&POP3", "&IMAP", "Fetchers", "&Delivery", "&Aliasing", "&Mail List"}) {
        tabs->addTab(new QWidget, label);
    }
    auto *layout = new QVBoxLayout(&dialog);
    layout->addWidget(tabs);
    for (const char *label : {"Help", "OK", "Apply", "Cancel"}) {
        layout->addWidget(new QPushButton(label));
    }
    EndAtFirstPaint end;
    qApp->installEventFilter(&end);
    dialog.show();
    return QApplication::exec();
}

double milliseconds(const QString &self, const QString &kind) {
    QElapsedTimer timer;
    timer.start();
    QProcess::execute(self, {kind});
    return static_cast<double>(timer.nsecsElapsed()) / 1e6;
}

double median(std::vector<double> values) {
    std::ranges::sort(values);
    return values.at(values.size() / 2);
}

int compare(int argc, char **argv) {
    const QCoreApplication application{argc, argv};
    const QString self = QCoreApplication::applicationFilePath();
    std::vector<double> program;
    std::vector<double> bare;
    for (int start = 0; start < starts; ++start) {
        bare.push_back(milliseconds(self, "bare"));
        program.push_back(milliseconds(self, "program"));
    }
    std::printf("start to first paint, median of %d: program %.1f ms, bare dialog %.1f ms, "
                "ratio %.2f\n",
                starts, median(program), median(bare), median(program) / median(bare));
    return 0;
}

} // namespace

int main(int argc, char **argv) {
    const std::string kind = argc > 1 ? argv[1] : "";
    argc = 1;
    if (kind == "program") {
        return runProgram(argc, argv);
    }
    if (kind == "bare") {
        return runBareDialog(argc, argv);
    }
    fs::remove_all(BENCH_PRODUCT);
    fs::create_directories(BENCH_PRODUCT);
    fs::copy(BENCH_SAMPLE, BENCH_PRODUCT, fs::copy_options::recursive);
    return compare(argc, argv);
}
