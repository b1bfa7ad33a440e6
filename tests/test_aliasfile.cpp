#include "datafiles.h"

#include "alias/aliasfile.h"
#include "config/settings.h"

#include <cstdlib>

namespace {

/// How many allocations of this thread still succeed; negative for any number.
thread_local int allocationsLeft = -1;

/// "<address|0target|2+target>": each target's type, "+" where it has the mark, its text.
std::string shown(const RecordChain<alias_entry> &list) {
    std::string text;
    for (const alias_entry &alias : list) {
        text += '<' + alias.address;
        for (const alias_list_entry &it : alias.aliases) {
            text += '|' + std::to_string(it.type) + (it.bang != 0 ? "+" : "") + it.alias;
        }
        text += '>';
    }
    return text;
}

} // namespace

void *operator new(std::size_t size) {
    void *memory = allocationsLeft == 0 ? nullptr : std::malloc(size);
    if (memory == nullptr) {
        throw std::bad_alloc{};
    }
    allocationsLeft -= allocationsLeft > 0 ? 1 : 0;
    return memory;
}

void operator delete(void *memory) noexcept { std::free(memory); }

void operator delete(void *memory, std::size_t) noexcept { std::free(memory); }

class TestAliasFile : public QObject {
    Q_OBJECT

    const std::string path = newPath();

private slots:
    void init() { alias_list.clear(); }

    void reading_data() {
        addRows({
            {"order, no final line feed", "a b,c\n,d\na: e", "<a|0b|0c><|0d><a:|0e>"},
            {"first type that fits", "a,[#@$,#@$,$@,x$,x#\n", "<a|1[#@$|2@$|3$@|4x$|0x#>"},
            {"marks in every order", "a,##b,!#b,#!b,!!b,!##b\n", "<a|2#b|2+b|2!b|0+!b|2+#b>"},
            {"marks everywhere", "a,![b,!b@c,!$b,! b,#,!#\n", "<a|1+[b|3+b@c|4+$b|0+|0b|2|2+>"},
            {"separators in runs and inside", "a\vb,,, b\t ,\v,\fc\fd ,\n", "<a\vb|0b|0c\fd>"},
            {"skipped beginnings", "#a,b\n|a,b\n a,b\n\ta,b\n\ra,b\n\n!a,b\n", "<!a|0b>"},
            {"CR-LF, lone CR", "\344a,\240b\r\n\r\nc,d\re\nf\r,g\n", "<\344a|0\240b><c|0d>"},
            {"NUL", {"a,b\0,c\n\0d,e\nf\0,g\n", 17}, "<a|0b>"},
        });
    }
    void reading() {
        QFETCH(const std::string, bytes);
        parseAliases(bytes, alias_list);
        QTEST(shown(alias_list), "expected");
    }

    void randomListsComeBack() {
        constexpr std::array starts{",", ",[", ",#", ",!", ",!#", ",![", ",$@", ",y\n"};
        std::mt19937 random{1};
        for (int round = 0; round < 300; ++round) {
            std::string bytes = "x";
            for (auto count = random() % 99; count > 0; --count) {
                bytes += starts.at(random() % 8) + ('x' + randomText(random, " \t,\r\n", 300));
            }
            bytes += ",y\n";
            alias_list.clear();
            parseAliases(bytes, alias_list);
            QCOMPARE(formatAliases(alias_list), bytes);
        }
    }

    void filesAreAddedAndRewritten() {
        settings().mail_file_alias.value = path;
        parseAliases("a b\n", alias_list);
        rewriteFile(path, "# comment\nc d ![e]\r\nf,##g\nh ,\ni");
        QCOMPARE(readAliasFile(), 0);
        writeAliasFile();
        QCOMPARE(readWholeFile(path).value_or("none"), std::string{"a,b\nc,d,![e]\nf,#g\nh\n"});
        forUnusablePaths(settings().mail_file_alias.value, [] {
            writeAliasFile();
            QVERIFY(readAliasFile() == 1 && shown(alias_list) == "<a|0b><c|0d|1+[e]><f|2#g><h>");
        });
    }

    void outOfMemoryKeepsWhatWasRead() {
        settings().mail_file_alias.value = path;
        rewriteFile(path, "a,b\nc,#d\n");
        std::string states = " ";
        for (int allocations = 0, result = 2; result != 0; ++allocations) {
            alias_list.clear();
            allocationsLeft = allocations;
            result = readAliasFile();
            allocationsLeft = -1;
            const std::string state = std::to_string(result) + shown(alias_list) + ' ';
            states += states.ends_with(' ' + state) ? "" : state;
        }
        QCOMPARE(states.c_str(), " 2 2<a> 2<a|0b> 2<a|0b><c> 0<a|0b><c|2d> ");
    }
};

QTEST_GUILESS_MAIN(TestAliasFile)
#include "test_aliasfile.moc"
