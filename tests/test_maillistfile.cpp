#include "datafiles.h"

#include "config/settings.h"
#include "lists/maillistfile.h"

using namespace std::string_literals;

namespace {

RecordChain<maillist_entry> parsed(const std::string &bytes) {
    RecordChain<maillist_entry> lists;
    parseMailLists(bytes, lists);
    return lists;
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

/// A block with every field set; the value of the first and the last is given, and the members.
std::string block(const std::string &name, const std::string &flags, const std::string &members) {
    return "#new\n%name:" + name +
           "\n%post:all@x\n%admin: join@x\n%support:help@x\n%info:/i\n%footer:/f\n%header:/h\n"
           "%modrt:mod\344@x\n%info:/i\n%diglen:-2147483648\n%digno:1024\n%digcnt:7\n%digcur:-8\n"
           "%flags:" +
           flags + "\n#start member\n" + members +
           "#end\n#start allow\n\n#end\n#start block\nc d\n#end\n#endlist\n\n\n";
}

} // namespace

class TestMailListFile : public QObject {
    Q_OBJECT

private slots:
    void reading_data() {
        const std::string section = "#new\n#start member\n";
        const std::string x243(243, 'x');
        const std::string x248(248, 'x');
        addRows({
            {"outside lists", "%name:a\n #new\n#New\n#newest\n#endlists\n%name:b\n", "[||||]"},
            {"unfinished block", "#new\n%name:a\n#new\n%post:b\n#start m\nx\n", "[a|b|<x>||]"},
            {"keys", "#new\n%name:a\n%name: b\t\n%Name:c\n %name:d\n%name\n%names:e", "[ b\t||||]"},
            {"sections", "#new\n#startXm\nx\n#\n#start a\ny\n#\n#start/b\nz", "[||<x>|<y>|<z>]"},
            {"no section", "#new\n#start M\n%name:a\n#new\n#start \r\n%name:a", "[||||][||||]"},
            {"reopened", section + "x\n#start a\n#start m\ny\n#endlist\n%name:a", "[a||<y><x>||]"},
            {"addresses", section + "\n a \n:\344\n%name:c", "[||<%name:c><:\344>< a ><>||]"},
            {"CR-LF", "#new\r\n%name:a\r\n#start m\r\nx\r\n\r\n#\r\n%post:b\r\n", "[a|b|<><x>||]"},
            {"NUL, CR", "#new\0\n%name:a\rb\n#start m\0\nx\0y\n\0z\nv\rw"s, "[a||<v><><x>||]"},
            {"address of 249", section + x248 + "1\ny\n", "[||<y><><" + x248 + "1>||]"},
            {"address of 250", section + x248 + "12\ny\n", "[||<y><2><" + x248 + "1>||]"},
            {"rest ends the section", section + x248 + "1#\n%name:a\n", "[a||<" + x248 + "1>||]"},
            {"rest is a key", "#new\n%name:" + x243 + "%post:a\n", "[" + x243 + "|a|||]"},
        });
    }
    void reading() {
        QFETCH(const std::string, bytes);
        QTEST(shown(parsed(bytes)), "expected");
    }

    void numbers() {
        const auto lists = parsed("#new\n%diglen: \t+0012x3\n%digno:- 12\n%digcnt:2147483648\n"
                                  "%digcur:99999999999999999999\n%flags:-12\n");
        const maillist_entry &list = *lists.head;
        QVERIFY(list.diglen == 12 && list.digno == 0 && list.digcnt == INT32_MIN);
        QVERIFY(list.digcur == -1 && list.flags == 4294967284U);
    }

    void keysAreThoseOfTheirFields() {
        auto lists = parsed(block("a", "4294967295", ":b@x\n"));
        maillist_entry &list = *lists.head;
        QCOMPARE(list.admin + list.support + list.info + list.footer + list.header + list.modrt,
                 " join@xhelp@x/i/f/hmod\344@x"s);
        QVERIFY(list.diglen == INT32_MIN && list.digno == 1024 && list.digcnt == 7);
        QVERIFY(list.digcur == -8 && list.flags == UINT32_MAX);
        prependRecord(&list.member.head, {"#left out"});
        QCOMPARE(formatMailLists(lists), block("a", "4294967295", ":b@x\n"));
    }

    void randomListsComeBack() {
        std::mt19937 random{1};
        for (int round = 0; round < 200; ++round) {
            std::string bytes;
            for (auto count = random() % 4; count > 0; --count) {
                std::string members;
                for (auto left = random() % 6; left > 0; --left) {
                    members += randomText(random, "#\r\n", 248) + '\n';
                }
                bytes += block(randomText(random, "\r\n", 240), std::to_string(random()), members);
            }
            QCOMPARE(formatMailLists(parsed(formatMailLists(parsed(bytes)))), bytes);
        }
    }

    void loadedLines() {
        const std::string x253(253, 'x');
        const std::string bytes = "a@b\r\nc\n\n#d :\344@e \nf\r@\ng@\0h\ni\0@\n"s;
        const std::vector<std::string> loaded =
            parseAddressLines(bytes + x253 + "@\ny@\n@" + x253 + "@\n");
        const std::vector<std::string> expected{"a@b",      "#d :\344@e ", "f",        "g@",
                                                x253 + "@", "y@",          "@" + x253, "@"};
        QVERIFY(loaded == expected);
    }

    void filesAreReadAnewAndRewritten() {
        const std::string path = newPath();
        settings().mail_file_maillist.value = path;
        rewriteFile(path, block("a", "0", "") + "between\n");
        readMailListFile();
        readMailListFile();
        writeMailListFile();
        QCOMPARE(readWholeFile(path).value_or("none"), block("a", "0", ""));
        forUnusablePaths(settings().mail_file_maillist.value, [] {
            maillist_list = parsed("#new\n");
            writeMailListFile();
            readMailListFile();
            QVERIFY(maillist_list.head == nullptr);
        });
    }
};

QTEST_GUILESS_MAIN(TestMailListFile)
#include "test_maillistfile.moc"
