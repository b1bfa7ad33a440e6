#include "datafiles.h"
#include "program.h"

#include "alias/aliasfile.h"
#include "config/masterfile.h"
#include "config/settings.h"
#include "lists/maillistfile.h"
#include "server/smtprejectfile.h"

#include <QRegularExpression>

#include <csignal>
#include <fcntl.h>
#include <malloc.h>
#include <sched.h>
#include <set>
#include <sys/file.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>

namespace {

using Texts = std::array<std::string, 5>;
/// In the order in which they are written; behind them the template.
const Texts names{"alias", "smtpreject", "maillist", "master", "templates/master"};
constexpr std::size_t master = 3;
constexpr std::size_t masterTemplate = 4;
#ifdef __SANITIZE_ADDRESS__
constexpr bool withSanitizer = true;
#else
constexpr bool withSanitizer = false;
#endif

/// Folders of old files, of what an apply makes of them, and of what it makes of nothing.
void makeProduct(int lines) {
    shell("n=" + std::to_string(lines) + R"(; rm -rf old new fresh
        mkdir -p old/templates new/templates fresh; cd old
        for key in alias smtpreject maillist master; do echo '| old' >$key; : >../fresh/$key; done
        for key in alias smtpreject maillist; do
            echo "%mail.file.$key: )" TEST_PRODUCT R"(/config/$key" >>master
            echo "%mail.file.$key: -" >>templates/master
        done
        (sed 1d master; seq $n | sed 's/^/| /') >../new/master
        seq $n | sed 's/^/| /' >>templates/master
        cp templates/master ../new/templates; cp templates/master ../fresh
        seq $n | sed 's/.*/a&  b/' >>alias; seq $n | sed 's/.*/a&,b/' >../new/alias
        seq $n >>smtpreject; seq $n | tac >../new/smtpreject
        (printf '#new\n%%name:cyclists\n%%flags:71\n#start member\n'; seq $n) >>maillist
        set -- ')" TEST_DATA R"(/app/applied/lists'
        (sed '/^#start/q' "$1"; seq $n | tac; sed -n '/^#end/,$p' "$1") >../new/maillist)");
}

/// The old files, and a command that does `lines` and leaves word of its run.
void lay(const std::string &lines = ":") {
    shell("chattr -R -a config; rm -rf config bin disk/*; cp -r old config; mkdir bin");
    std::ofstream{"bin/tvxreconf"} << "#!/bin/sh\ncd '" TEST_PRODUCT "/config'\n"
                                   << lines << "\necho ran >>ran\n";
    shell("chmod 755 bin/tvxreconf");
}

/// A digit a file: 0 for old, 1 for new, 2 for new bytes over old ones, 3 for less; then "ran".
std::string state() {
    std::string digits;
    for (std::size_t at = 0; at < masterTemplate; ++at) {
        const std::string bytes = bytesAt("config/" + names[at]);
        const std::string old = bytesAt("old/" + names[at]);
        const std::string applied = bytesAt("new/" + names[at]);
        const auto end = std::ranges::mismatch(bytes, applied).in1;
        const bool isOver =
            bytes.size() == std::max(old.size(), static_cast<std::size_t>(end - bytes.begin())) &&
            old.ends_with(std::string_view{end, bytes.end()});
        digits += bytes == old ? '0' : bytes == applied ? '1' : isOver ? '2' : '3';
    }
    return digits + (bytesAt("config/ran") == "ran\n" ? "ran" : "");
}

/// Reads and writes all files in a process of its own that gets so much memory more while it reads,
/// or else while it writes. Its status.
int readAndWritten(rlim_t memory, bool isReading) {
    settings(); // Not from that memory.
    const pid_t child = fork();
    if (child == 0) {
        const auto limitMemory = [memory](bool isLimited) {
            const rlim_t pages = isLimited ? std::stoul(bytesAt("/proc/self/statm")) : 0;
            const rlim_t size = pages * static_cast<rlim_t>(sysconf(_SC_PAGESIZE)) + memory;
            const rlimit limit{.rlim_cur = isLimited ? size : RLIM_INFINITY,
                               .rlim_max = RLIM_INFINITY};
            setrlimit(RLIMIT_AS, &limit);
        };
        limitMemory(isReading);
        readMasterConfig();
        readAliasFile();
        readSmtpRejectFile();
        readMailListFile();
        limitMemory(!isReading);
        writeAliasFile();
        writeSmtpRejectFile();
        writeMailListFile();
        writeMasterConfig();
        _exit(0);
    }
    int status = -1;
    waitpid(child, &status, 0);
    return status;
}

enum Reading : std::uint8_t { refused, missing, empty, whole };
enum Writing : std::uint8_t { kept, unsure, done };

/// `lines` do not end with 0 where the fault cannot be had.
struct Fault {
    const char *name, *lines;
    Reading read = refused;
    Writing written = kept;
};
using Row = std::array<const Fault *, 5>; ///< One for each file.

const Fault faults[]{{"none", ":", whole, done},
                     {"missing", "rm $f", missing, done},
                     {"empty", ": >$f", empty, done},
                     {"folder", "rm $f; mkdir $f"},
                     {"pipe", "rm $f; mkfifo $f"},
                     {"full device", "ln -sf /dev/full $f"},
                     {"null device", "ln -sf /dev/null $f"},
                     {"dangling link", "ln -sf \"$PWD/disk/new\" $f", missing, done},
                     {"link loop", "rm $f; ln -s ${f##*/} $f"},
                     {"hard link", "ln $f $f.other", whole, done},
                     {"unreadable", "chmod 200 $f; ! test -r $f", refused, done},
                     {"read-only", "chmod 444 $f; ! test -w $f", whole},
                     {"append-only", "chattr +a $f", whole},
                     {"replaced", "cp $f $f.new; mv $f.new $f", whole, done},
                     {"on a full disk",
                      "echo >disk/x; ln -sf \"$PWD/disk/x\" $f; mountpoint -q disk && "
                      "! cat /dev/zero >disk/filler",
                      empty, unsure}};

/// What the folder says of the file, and the bytes that it leads to.
using Shown = std::tuple<mode_t, ino_t, nlink_t, std::string>;

Shown shown(const std::string &name) {
    const std::string file = "config/" + name;
    struct stat status = {};
    const bool isFile = lstat(file.c_str(), &status) == 0 && S_ISREG(status.st_mode);
    const auto setMode = [&](mode_t mode) {
        // An append-only file stays as it is; it can be read.
        [[maybe_unused]] const int result = isFile ? chmod(file.c_str(), mode) : 0;
    };
    setMode(status.st_mode | S_IRUSR);
    const std::string bytes = bytesAt(file);
    setMode(status.st_mode);
    return {status.st_mode, status.st_ino, status.st_nlink, bytes};
}

/// Lays the faults, before a start or while the program runs, and applies; then mends them and
/// applies again. What went wrong.
std::string tried(Row row, const Program *running) {
    lay();
    for (std::size_t at = 0; at < row.size(); ++at) {
        const std::string file = "f=config/" + names[at] + '\n';
        if (!shell(file + row[at]->lines)) {
            QWARN((std::string{"left out, cannot be had here: "} + row[at]->name).c_str());
            row[at] = faults;
            shell(file + "rm -f $f; cp old/${f#*/} $f");
        }
    }
    std::optional<Program> own;
    for (const bool isMended : {false, true}) {
        if (isMended) {
            lay();
        }
        std::array<Shown, 5> before;
        std::ranges::transform(names, before.begin(), shown);
        if (running == nullptr) {
            running = &own.emplace();
            if (Program{{"-init"}}.end() != 0 || !own->isReady()) {
                return "does not start";
            }
        }
        if (!running->applies() || bytesAt("config/ran") != "ran\n") {
            return "does not apply";
        }
        for (std::size_t at = 0; at < row.size(); ++at) {
            const Reading read = own ? row[at]->read : whole;
            const Reading pattern = isMended || at != master ? whole : row[masterTemplate]->read;
            const Writing written = isMended ? done : row[at]->written;
            const bool isKnown = at == master || !own || row[master]->read == whole;
            const Shown after = shown(names[at]);
            Shown wanted = before[at];
            if (at != masterTemplate && isKnown && read != refused && pattern > missing &&
                written != kept) {
                const std::string made = bytesAt((read == whole ? "new/" : "fresh/") + names[at]);
                const mode_t newMode = S_IFREG | (at == master ? 0640 : 0644);
                std::get<std::string>(wanted) = pattern == empty ? "" : made;
                if (std::get<0>(wanted) == 0) {
                    wanted = {newMode, std::get<1>(after), 1, std::get<std::string>(wanted)};
                }
            }
            if (after != wanted && (written != unsure || after != before[at])) {
                return names[at] + (isMended ? " is wrong after all was mended" : " is wrong");
            }
        }
    }
    return {};
}

} // namespace

/// The program in a process of its own, and what may befall it.
class TestFaults : public QObject {
    Q_OBJECT

private slots:
    void initTestCase() { makeProduct(1500); }
    void cleanup() { lay(); } // Leaves no file behind that cannot be removed.

    void faultyFilesAreLeftAndTheRestGoesOn() {
        lay();
        const Program running;
        QVERIFY(running.isReady());
        const Fault *no = faults;
        for (std::size_t first = 0; first < std::size(faults); ++first) {
            const auto next = [&](std::size_t at) {
                return faults + (first + at) % std::size(faults);
            };
            for (const Row &row :
                 {Row{next(0), next(1), next(2), no, next(3)}, {no, no, no, next(0), no}}) {
                for (const Program *program : {&running, static_cast<const Program *>(nullptr)}) {
                    std::string wrong = tried(row, program);
                    for (std::size_t at = 0; !wrong.empty() && at < row.size(); ++at) {
                        wrong += ", " + names[at] + ": " + row[at]->name;
                    }
                    QVERIFY2(wrong.empty(), wrong.c_str());
                }
            }
        }
    }

    void theCommandMayDoWhatItWants() {
        lay();
        const Program program;
        QVERIFY(program.isReady());
        using Row = std::tuple<const char *, const char *, bool>;
        for (const auto &[lines, fault, isRun] : {Row{"", "rm bin/*", false},
                                                  {"", "chmod -x bin/*", false},
                                                  {"exit 3", ":", false},
                                                  {"kill -9 $$", ":", false},
                                                  {"yes | head -c 1000000", ":", true},
                                                  {"sleep 60 & echo $! >pid", ":", true},
                                                  {"echo $$ >pid; kill -STOP $$", ":", true}}) {
            lay(lines);
            shell(fault);
            program.press('A');
            if (std::string_view{lines}.ends_with("STOP $$")) {
                QVERIFY(shell(
                    "for n in $(seq 6000); do grep '^State:.T' /proc/$(cat config/pid)/status && "
                    "exit; sleep 0.01; done; exit 1"));
                QVERIFY(program.heard(0) == '?' && shell("kill -CONT $(cat config/pid)"));
            }
            QVERIFY2(program.heard() == 'A', lines);
            QCOMPARE(state(), isRun ? "1111ran" : "1111");
            QVERIFY(std::string_view{lines}.substr(0, 5) != "sleep" ||
                    shell("kill $(cat config/pid)"));
        }
    }

    void anotherProgramsApplyIsWaitedFor() {
        lay();
        const Program program;
        QVERIFY(program.isReady());
        const int folder = open("config", O_RDONLY | O_CLOEXEC);
        QCOMPARE(flock(folder, LOCK_EX), 0);
        program.press('A');
        QCOMPARE(program.heard(300), '?');
        QCOMPARE(state(), "0000");
        close(folder);
        QCOMPARE(program.heard(), 'A');
        QCOMPARE(state(), "1111ran");
    }

    void theCommandGetsWhatTheProgramGot() {
        for (unsigned closed = 0; closed < 8; ++closed) {
            lay("(readlink /proc/$$/fd/[012]; ls /proc/self/fd; echo $DBUS_SESSION_BUS_ADDRESS;"
                " sed -n 's/^SigI.*\\(.......\\)$/\\1/p' /proc/self/status) >seen");
            const bool isOdd = closed % 2 == 1;
            const Program program{
                {}, [&] {
                    const int zero = open("/dev/zero", O_RDWR | O_CLOEXEC);
                    for (int number = 0; number < 3 && zero >= 0; ++number) {
                        (closed >> number & 1) != 0 ? ::close(number) : dup2(zero, number);
                    }
                    for (int number = 1; number < SIGRTMAX; ++number) {
                        const bool isIgnored = isOdd && (number == SIGHUP || number == SIGXFSZ);
                        std::signal(number, isIgnored ? SIG_IGN : SIG_DFL);
                    }
                }};
            QVERIFY(program.isReady() && program.applies());
            std::string wanted;
            for (int number = 0; number < 3; ++number) {
                wanted += (closed >> number & 1) != 0 ? "/dev/null\n" : "/dev/zero\n";
            }
            wanted += "0\n1\n2\n3\n\n"; // The last is that of the list.
            wanted += isOdd ? "1000001\n" : "0000000\n";
            QCOMPARE(bytesAt("config/seen"), wanted);
            QCOMPARE(state(), "1111ran");
        }
        lay();
        shell("rm config/master");
        const auto toNobody = [] {
            int ends[2];
            if (pipe2(ends, O_CLOEXEC) == 0) {
                dup2(ends[1], 1);
                ::close(ends[0]);
            }
        };
        QCOMPARE(Program({"-init"}, toNobody).end(), 0);
        const Program program({}, toNobody);
        QVERIFY(program.isReady() && program.applies());
    }

    void aLimitOfFileSizeLeavesFilesWhole() {
        makeProduct(20'000);
        for (const rlim_t longest : {4, 140'000, 180'000}) {
            lay();
            const rlimit limit{.rlim_cur = longest, .rlim_max = longest};
            const Program program{{}, [&] { setrlimit(RLIMIT_FSIZE, &limit); }};
            QVERIFY(program.isReady() && program.applies());
            const std::string left = state();
            for (std::size_t at = 0; at < masterTemplate; ++at) {
                const bool hasSpace = bytesAt("new/" + names[at]).size() <= longest;
                QVERIFY2(left[at] == "01"[hasSpace], left.c_str());
            }
        }
    }

    /// Reading and writing alone: the toolkit does not survive without memory.
    void aLimitOfMemoryLeavesFilesWhole() {
        if (withSanitizer) {
            QSKIP("left out with sanitizers: a limit of memory");
        }
        makeProduct(200'000);
        for (const bool isReading : {true, false}) {
            std::set<std::string> states;
            std::string left;
            for (rlim_t memory = 0; left != "1111"; memory += 2 << 20) { // Until it is enough.
                lay();
                QCOMPARE(readAndWritten(memory, isReading), 0);
                left = state();
                QVERIFY2(left.find_first_of("23") == std::string::npos, left.c_str());
                states.insert(left);
            }
            QVERIFY(states.size() > 2); // It was enough for some of the files.
        }
    }

    void signalsCutNothing() {
        makeProduct(300'000);
        std::mt19937 random{1};
        for (const int signal : {SIGTERM, SIGINT, SIGHUP, SIGKILL}) {
            for (std::size_t at = 0; at < names.size(); ++at) {
                lay();
                Program program;
                QVERIFY(program.isReady());
                program.press('A');
                while (std::ifstream{"config/" + names[at]}.get() == '|' &&
                       program.heard(0) == '?') {
                }
                usleep(static_cast<useconds_t>(random() % 3000));
                ::kill(program.number, SIGSTOP); // So that what was done is known.
                siginfo_t status{};
                waitid(P_PID, static_cast<id_t>(program.number), &status,
                       WSTOPPED | WEXITED | WNOWAIT | __WALL);
                const std::string before = state();
                ::kill(program.number, signal);
                ::kill(program.number, SIGCONT);
                QCOMPARE(program.end(), -signal);
                // The command is started before the signal does what it does.
                const bool isKilled = signal == SIGKILL;
                shell("for n in $(seq " + std::string{isKilled ? "0" : "500"} +
                      "); do cmp -s config/master new/master || exit; "
                      "test -e config/ran && exit; sleep 0.01; done");
                const std::string after = state();
                const QRegularExpression wanted{isKilled               ? "^(1*2?0*|1111ran)$"
                                                : at == masterTemplate ? "^(0000|1111ran)$"
                                                                       : "^1111ran$"};
                QVERIFY2(wanted.match(after.c_str()).hasMatch(),
                         qPrintable(QString::number(signal) + ": " + before.c_str() + ", then " +
                                    after.c_str()));
            }
        }
    }
};

int main(int argc, char **argv) {
    if (!enterProduct()) {
        return 1;
    }
    mallopt(M_ARENA_MAX, 1); // Another thread's heap would hold memory that no limit counts.
    // The mount is gone with the test's own view of the file system.
    if (unshare(CLONE_NEWNS) == 0) {
        shell("mount --make-rprivate / && mount -t tmpfs -o size=64k tmpfs disk");
    }
    TestFaults test;
    return QTest::qExec(&test, argc, argv);
}

#include "test_faults.moc"
