#include "datafiles.h"

#include "alias/aliasfile.h"
#include "config/settings.h"
#include "fetch/pophosts.h"
#include "lists/maillistfile.h"
#include "server/smtprejectfile.h"

#include <cstdlib>

using namespace std::string_literals;

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

/// "[name|post|<member>|<allowed>|<blocked>]" for each list.
std::string shown(const RecordChain<maillist_entry> &lists) {
    std::string text;
    for (const maillist_entry &list : lists) {
        text += '[' + list.name + '|' + list.post;
        for (const AddressChain *chain : {&list.member, &list.allow, &list.block}) {
            text += '|';
            for (const maillist_addr_entry &address : *chain) {
                text += '<' + address.addr + '>';
            }
        }
        text += ']';
    }
    return text;
}

template <auto parse, auto &list>
const auto &parsed(const std::string &bytes) {
    list.clear();
    parse(bytes, list);
    return list;
}

constexpr auto aliases = parsed<parseAliases, alias_list>;
constexpr auto rejects = parsed<parseSmtpRejects, smtpreject_list>;
constexpr auto mailLists = parsed<parseMailLists, maillist_list>;

std::string fetchers(const std::string &bytes) {
    parsePopHosts(bytes);
    return formatPopHosts();
}

/// A block with every field set; the value of the first and the last is given, and the members.
std::string block(const std::string &name, const std::string &flags, const std::string &members) {
    return "#new\n%name:" + name +
           "\n%post:all@x\n%admin: join@x\n%support:help@x\n%info:/i\n%footer:/f\n%header:/h\n"
           "%modrt:mod\344@x\n%info:/i\n%diglen:-2147483648\n%digno:1024\n%digcnt:7\n%digcur:-8\n"
           "%flags:" +
           flags + "\n#start member\n" + members +
           "#end\n#start allow\n\n#end\n#start block\nc d\n#end\n#endlist\n\n\n";
}

/// Up to `most` times what `make` returns, in a hundred rounds: `rewrite` gives it back.
template <class Make, class Rewrite>
void checkRandomLists(unsigned most, Make make, Rewrite rewrite) {
    std::mt19937 random{1};
    for (int round = 0; round < 100; ++round) {
        std::string bytes;
        for (auto count = random() % (most + 1); count > 0; --count) {
            bytes += make(random);
        }
        QCOMPARE(rewrite(bytes), bytes);
    }
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

/// The formats that hold lists of records.
class TestListFiles : public QObject {
    Q_OBJECT

private slots:
    void readAliases() {
        checkRows(
            [](const std::string &bytes) { return shown(aliases(bytes)); },
            {{"order, no final line feed", "a b,c\n,d\na: e", "<a|0b|0c><|0d><a:|0e>"},
             {"first type that fits", "a,[#@$,#@$,$@,x$,x#\n", "<a|1[#@$|2@$|3$@|4x$|0x#>"},
             {"marks in every order", "a,##b,!#b,#!b,!!b,!##b\n", "<a|2#b|2+b|2!b|0+!b|2+#b>"},
             {"marks everywhere", "a,![b,!b@c,!$b,! b,#,!#\n", "<a|1+[b|3+b@c|4+$b|0+|0b|2|2+>"},
             {"separators in runs and inside", "a\vb,,, b\t ,\v,\fc\fd ,\n", "<a\vb|0b|0c\fd>"},
             {"skipped beginnings", "#a,b\n|a,b\n a,b\n\ta,b\n\ra,b\n\n!a,b\n", "<!a|0b>"},
             {"CR-LF, lone CR", "\344a,\240b\r\n\r\nc,d\re\nf\r,g\n", "<\344a|0\240b><c|0d>"},
             {"NUL", "a,b\0,c\n\0d,e\nf\0,g\n"s, "<a|0b>"}});
    }

    void readRejects() {
        const std::string x248(248, 'x');
        checkRows([](const std::string &bytes) { return formatSmtpRejects(rejects(bytes)); },
                  {{"newest first, no final line feed", "a#b|\nb\nc", "c\nb\na#b|\n"},
                   {"CR-LF and lone CR", "a\r\n\r\nb\rc\n", "b\na\n"},
                   {"words behind white space", "a b\nc\td\ne\vf\ng\fh\n", "g\ne\nc\na\n"},
                   {"comments and white space first", "#a\n|b\n \n\n c\n\td\n\ve\n\ff\n\rg\n", ""},
                   {"unprintable first", "\001a\n\033b\n\177c\n\303\244d\n\240e\n\377f\n", ""},
                   {"NUL and high bytes", "a\240b\303\244 d\ne\0f\n\0g\n"s, "e\na\240b\303\244\n"},
                   {"249", x248 + "1\nb\n", "b\n" + x248 + "1\n"},
                   {"500", x248 + "1" + x248 + "234", "34\n" + x248 + "2\n" + x248 + "1\n"},
                   {"rest that is a comment", x248 + "1#b\n", x248 + "1\n"}});
    }

    void readMailLists() {
        const std::string section = "#new\n#start member\n";
        const std::string x243(243, 'x');
        const std::string x248(248, 'x');
        checkRows(
            [](const std::string &bytes) { return shown(mailLists(bytes)); },
            {{"outside lists", "%name:a\n #new\n#New\n#newest\n#endlists\n%name:b\n", "[||||]"},
             {"unfinished block", "#new\n%name:a\n#new\n%post:b\n#start m\nx\n", "[a|b|<x>||]"},
             {"keys", "#new\n%name:a\n%name: b\t\n%Name:c\n %name:d\n%name\n%names:e",
              "[ b\t||||]"},
             {"sections", "#new\n#startXm\nx\n#\n#start a\ny\n#\n#start/b\nz", "[||<x>|<y>|<z>]"},
             {"no section", "#new\n#start M\n%name:a\n#new\n#start \r\n%name:a", "[||||][||||]"},
             {"reopened", section + "x\n#start a\n#start m\ny\n#endlist\n%name:a", "[a||<y><x>||]"},
             {"addresses", section + "\n a \n:\344\n%name:c", "[||<%name:c><:\344>< a ><>||]"},
             {"CR-LF", "#new\r\n%name:a\r\n#start m\r\nx\r\n\r\n#\r\n%post:b\r\n", "[a|b|<><x>||]"},
             {"NUL, CR", "#new\0\n%name:a\rb\n#start m\0\nx\0y\n\0z\nv\rw"s, "[a||<v><><x>||]"},
             {"address of 249", section + x248 + "1\ny\n", "[||<y><><" + x248 + "1>||]"},
             {"address of 250", section + x248 + "12\ny\n", "[||<y><2><" + x248 + "1>||]"},
             {"rest ends the section", section + x248 + "1#\n%name:a\n", "[a||<" + x248 + "1>||]"},
             {"rest is a key", "#new\n%name:" + x243 + "%post:a\n", "[" + x243 + "|a|||]"}});
    }

    void readFetchers() {
        const std::string x31(31, 'x');
        const std::string full = x31 + ":" + x31 + "@" + x31 + x31 + "x";
        parsePopHosts("old:old@old");
        checkRows(fetchers, {{"separators in runs", "\r\n,a:b@c\r\n,,d:e@h,\r", "*a:b@c\n*d:e@h\n"},
                             {"prefixes of one entry", "**--a:b@c,d:e@h", "-*a:b@c\n*d:e@h\n"},
                             {"prefix characters inside", "a-:*b@-c*", "*a-:*b@-c*\n"},
                             {"blanks and high bytes", " -a\t: b @c d ,\t:f\344@h",
                              "* -a\t: b @c d \n*\t:f\344@h\n"},
                             {"separator missing", "a@c,a:b:c,d:e@h", "*d:e@h\n"},
                             {"line break in the password", "a:b\nc@d", ""},
                             {"rest of a dropped entry", "a@b:c@d", "*b:c@d\n"},
                             {"ends behind the user", "a:b@c,d", "*a:b@c\n"},
                             {"ends behind the colon", "a:b@c,d:", "*a:b@c\n"},
                             {"ends behind the password", "a:b@c,d:e", "*a:b@c\n"},
                             {"empty fields", ":@", "*:@\n"},
                             {"server ends at a colon", "a:b@c:d@e", "*a:b@c\n*:d@e\n"},
                             {"user of 32", x31 + "y:b@c", "*:b@c\n"},
                             {"user of 33", x31 + "yz:b@c", "*z:b@c\n"},
                             {"password of 32", "a:" + x31 + "y@c,d:e@h", "*d:e@h\n"},
                             {"server of 63 and of 64", full + "\n" + full + "y,",
                              "*" + full + "\n*" + full + "\n"},
                             {"entry right behind a full server", full + "-d:e@h",
                              "*" + full + "\n-*d:e@h\n"}});
    }

    void fetcherRecords() {
        parsePopHosts("-a:b@c");
        pop_host &host = *pop_host_list.head;
        QVERIFY(popHostText(host.user) == "a" && popHostText(host.password) == "b");
        QVERIFY(popHostText(host.server) == "c" && host.flags == 6);
        host.flags = 0;
        QCOMPARE(formatPopHosts(), "a:b@c\n"s);
        parsePopHosts(std::nullopt);
        QVERIFY(pop_host_list.head == nullptr);
    }

    void mailListNumbers() {
        const maillist_entry &list =
            *mailLists("#new\n%diglen: \t+0012x3\n%digno:- 12\n%digcnt:2147483648\n"
                       "%digcur:99999999999999999999\n%flags:-12\n")
                 .head;
        QVERIFY(list.diglen == 12 && list.digno == 0 && list.digcnt == INT32_MIN);
        QVERIFY(list.digcur == -1 && list.flags == 4294967284U);
    }

    void mailListKeysAreThoseOfTheirFields() {
        mailLists(block("a", "4294967295", ":b@x\n"));
        maillist_entry &list = *maillist_list.head;
        QCOMPARE(list.admin + list.support + list.info + list.footer + list.header + list.modrt,
                 " join@xhelp@x/i/f/hmod\344@x"s);
        QVERIFY(list.diglen == INT32_MIN && list.digno == 1024 && list.digcnt == 7);
        QVERIFY(list.digcur == -8 && list.flags == UINT32_MAX);
        prependRecord(&list.member.head, {"#left out"});
        QCOMPARE(formatMailLists(maillist_list), block("a", "4294967295", ":b@x\n"));
    }

    void loadedLines() {
        const std::string x253(253, 'x');
        const std::vector<std::string> expected{"a@b",      "#d :\344@e ", "f",        "g@",
                                                x253 + "@", "y@",          "@" + x253, "@"};
        QVERIFY(parseAddressLines("a@b\r\nc\n\n#d :\344@e \nf\r@\ng@\0h\ni\0@\n"s + x253 +
                                  "@\ny@\n@" + x253 + "@\n") == expected);
    }

    void randomListsComeBack() {
        checkRandomLists(
            1,
            [](std::mt19937 &random) {
                constexpr std::array starts{",", ",[", ",#", ",!", ",!#", ",![", ",$@", ",y\n"};
                std::string bytes = "x";
                for (auto count = random() % 99; count > 0; --count) {
                    bytes += starts.at(random() % 8) + ('x' + randomText(random, " \t,\r\n", 300));
                }
                return bytes + ",y\n";
            },
            [](const std::string &bytes) { return formatAliases(aliases(bytes)); });
        checkRandomLists(
            20,
            [](std::mt19937 &random) {
                return 'a' + randomText(random, " \t\n\r\v\f", 248) + '\n';
            },
            [](const std::string &bytes) {
                return formatSmtpRejects(rejects(formatSmtpRejects(rejects(bytes))));
            });
        checkRandomLists(
            3,
            [](std::mt19937 &random) {
                std::string members;
                for (auto left = random() % 6; left > 0; --left) {
                    members += randomText(random, "#\r\n", 248) + '\n';
                }
                return block(randomText(random, "\r\n", 240), std::to_string(random()), members);
            },
            [](const std::string &bytes) {
                return formatMailLists(mailLists(formatMailLists(mailLists(bytes))));
            });
        checkRandomLists(
            100, // Far more than 4095 bytes.
            [](std::mt19937 &random) {
                return (random() % 2 == 0 ? "*x" : "-*x") + randomText(random, ":@,\r\n", 30) +
                       ':' + randomText(random, ":@,\r\n", 31) + '@' +
                       randomText(random, ":@,\r\n", 62) + '\n';
            },
            fetchers);
    }

    /// Read twice and written; then at paths at which no file can be read or written.
    void files() {
        struct Case {
            std::optional<std::string> &setting;
            void (*read)();
            void (*write)();
            std::string (*format)();
            std::string bytes;
            std::string rewritten;
            std::string keptWithoutFile;
        };
        const std::string whole = block("a", "0", "");
        const std::string path = newPath();
        for (const auto &[setting, read, write, format, bytes, rewritten, kept] :
             {Case{settings().mail_file_alias.value,
                   [] {
                       QCOMPARE(readAliasFile(),
                                settings().mail_file_alias.value == TEST_PRODUCT "/file" ? 0 : 1);
                   },
                   writeAliasFile, [] { return formatAliases(alias_list); },
                   "# comment\nc d ![e]\r\nf,##g\nh ,\ni", "c,d,![e]\nf,#g\nh\nc,d,![e]\nf,#g\nh\n",
                   "c,d,![e]\nf,#g\nh\nc,d,![e]\nf,#g\nh\n"},
              Case{settings().mail_file_smtpreject.value, readSmtpRejectFile, writeSmtpRejectFile,
                   [] { return formatSmtpRejects(smtpreject_list); }, "# comment\na and more\nb\n",
                   "b\na\n", ""},
              Case{settings().mail_file_maillist.value, readMailListFile, writeMailListFile,
                   [] { return formatMailLists(maillist_list); }, whole + "between\n", whole,
                   ""}}) {
            setting = path;
            alias_list.clear();
            rewriteFile(path, bytes);
            read();
            read();
            write();
            QCOMPARE(readWholeFile(path).value_or("none"), rewritten);
            for (const char *unusable : {"/", "/dev/full", "/missing/file", ""}) {
                setting = unusable;
                write();
                read();
                QCOMPARE(format(), kept);
            }
            setting.reset();
            write();
            read();
            QCOMPARE(format(), kept);
        }
    }

    void aMillionRecordsAreFreedWithoutRecursion() {
        rejects(QByteArray{"a\n"}.repeated(1'000'000).toStdString());
        smtpreject_list.clear();
        QVERIFY(smtpreject_list.head == nullptr);
    }

    void outOfMemoryKeepsWhatWasRead() {
        settings().mail_file_alias.value = newPath();
        rewriteFile(newPath(), "a,b\nc,#d\n");
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

QTEST_GUILESS_MAIN(TestListFiles)
#include "test_listfiles.moc"
