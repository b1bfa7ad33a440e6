#include "datafiles.h"

#include "alias/aliasfile.h"
#include "config/masterfile.h"
#include "config/settings.h"
#include "fetch/pophosts.h"
#include "lists/maillistfile.h"
#include "server/smtprejectfile.h"

using namespace std::string_literals;

namespace {

/// "<address|0target|2+target>": each target's type, "+" where it has the mark, its text.
void showAliases(const RecordChain<alias_entry> &list, std::string &text) {
    for (const alias_entry &alias : list) {
        text += "<"s + alias.address;
        for (const alias_list_entry &it : alias.aliases) {
            text += '|' + std::to_string(it.type) + (it.bang != 0 ? "+" : "") + it.alias;
        }
        text += '>';
    }
}

/// "[name|post|<member>|<allowed>|<blocked>]" for each list.
void showLists(const RecordChain<maillist_entry> &lists, std::string &text) {
    for (const maillist_entry &list : lists) {
        text += "["s + list.name + "|" + list.post;
        for (const AddressChain *chain : {&list.member, &list.allow, &list.block}) {
            text += '|';
            for (const maillist_addr_entry &address : *chain) {
                text += "<"s + address.addr + ">";
            }
        }
        text += ']';
    }
}

template <auto parse, auto &list, auto format>
std::string rewritten(const std::string &bytes) {
    list.clear();
    parse(keep(bytes), list);
    return whole(format, list);
}

std::string rewrittenFetchers(const std::string &bytes) {
    parsePopHosts(bytes);
    return formatPopHosts();
}

constexpr auto rewrittenRejects = rewritten<parseSmtpRejects, smtpreject_list, formatSmtpRejects>;
constexpr auto rewrittenLists = rewritten<parseMailLists, maillist_list, formatMailLists>;

/// A block with every field set; the value of the first and the last is given, and the members.
std::string block(const std::string &name, const std::string &flags, const std::string &members) {
    return "#new\n%name:" + name +
           "\n%post:all@x\n%admin: join@x\n%support:help@x\n%info:/i\n%footer:/f\n%header:/h\n"
           "%modrt:mod\344@x\n%info:/i\n%diglen:-2147483648\n%digno:1024\n%digcnt:7\n%digcur:-8\n"
           "%flags:" +
           flags + "\n#start member\n" + members +
           "#end\n#start allow\n\n#end\n#start block\nc d\n#end\n#endlist\n\n\n";
}

std::string filled(const std::string &lines) {
    std::string bytes;
    formatMasterConfig(lines, bytes);
    return bytes;
}

} // namespace

class TestFormats : public QObject {
    Q_OBJECT

private slots:
    void listsOfRecordsAreRead() {
        checkRows(rewritten<parseAliases, alias_list, showAliases>, "[aliases]");
        checkRows(rewrittenRejects, "[rejects]");
        checkRows(rewritten<parseMailLists, maillist_list, showLists>, "[mail lists]");
        checkRows(rewrittenFetchers, "[fetchers]");
    }

    /// What an apply would take away unasked.
    void lossesAreCounted() {
        const auto lostBy = [](auto parse, auto list) {
            return [parse, list](const std::string &bytes) {
                list->clear();
                return std::to_string(parse(keep(bytes), *list));
            };
        };
        checkRows(lostBy(parseAliases, &alias_list), "[lost of aliases]");
        checkRows(lostBy(parseSmtpRejects, &smtpreject_list), "[lost of rejects]");
        checkRows(lostBy(parseMailLists, &maillist_list), "[lost of mail lists]");
        checkRows([](const std::string &text) { return std::to_string(parsePopHosts(text)); },
                  "[lost of fetchers]");
        checkRows([](const std::string &text) { return isKeptWhole(text) ? "kept" : "lost"; },
                  "[lost of access lists]");
    }

    void newFetcherHasNoMark() {
        QCOMPARE(rewrittenFetchers("a:b@c"), "*a:b@c\n"s);
        pop_host_list.head->flags = 0;
        QCOMPARE(formatPopHosts(), "a:b@c\n"s);
    }

    void mailListNumbers() {
        rewrittenLists("#new\n%diglen: \t+0012x3\n%digno:- 12\n%digcnt:2147483648\n"
                       "%digcur:99999999999999999999\n%flags:-12\n");
        const maillist_entry &list = *maillist_list.head;
        QVERIFY(list.diglen == 12 && list.digno == 0 && list.digcnt == INT32_MIN);
        QVERIFY(list.digcur == -1 && list.flags == 4294967284U);
    }

    void memberThatWouldEndItsSectionIsLeftOut() {
        const std::string list = block("a", "0", std::string(249, 'x') + '\n');
        rewrittenLists(list);
        removeRecord(&maillist_list.head->member.head); // The line feed behind the 249 bytes.
        for (const std::string &leftOut : {"#left out"s, std::string(250, 'x')}) {
            prependRecord(&maillist_list.head->member.head, {keep(leftOut)});
        }
        QCOMPARE(whole(formatMailLists, maillist_list), list);
    }

    void loadedLines() {
        checkRows(
            [](const std::string &bytes) {
                std::string text;
                for (const maillist_addr_entry &address : parseAddressLines(keep(bytes))) {
                    text.insert(0, "<"s + address.addr + ">"); // The file's last is the first.
                }
                return text;
            },
            "[loaded lines]");
    }

    void masterFileIsRead() {
        checkRows(
            [](const std::string &bytes) {
                settings().admin_email.value.reset();
                parseMasterConfig(bytes);
                return settings().admin_email.value.value_or("none");
            },
            "[reading the master file]");
    }

    void masterFileIsWritten() {
        settings().admin_email.value = "a, b,,|c";
        settings().smtp_hosts.value.reset();
        settings().smtp_direct.value = "";
        checkRows(filled, "[writing the master file]");
    }

    void aLineOf100MegabytesHidesNothing() {
        std::string bytes = "%admin.email:";
        bytes.resize(bytes.size() + 100'000'000, ',');
        parseMasterConfig(bytes + "\n%smtp.sock.port: 2525\n");
        QCOMPARE(settings().admin_email.value.value_or("").size(), 100'000'000U);
        QCOMPARE(settings().smtp_sock_port.value, 2525);
    }

    void aliasesAreAddedToWhatIsThere() {
        alias_list.clear();
        const std::string path = TEST_PRODUCT "/file";
        std::filesystem::create_directories(TEST_PRODUCT);
        settings().mail_file_alias.value = path;
        for (const char *bytes : {"#a b\nc d ![e]\r\nf,##g\nh ,\ni", "j,k"}) {
            rewriteFile(path, bytes);
            QCOMPARE(readAliasFile(), 0);
        }
        writeAliasFile();
        QCOMPARE(bytesAt(path), "c,d,![e]\nf,#g\nh\nj,k\n"s);
        settings().mail_file_alias.value.reset();
        QCOMPARE(readAliasFile(), 1);
    }

    void aMillionRecordsAreFreedWithoutRecursion() {
        rewrittenRejects(QByteArray{"a\n"}.repeated(1'000'000).toStdString());
        smtpreject_list.clear();
    }
};

QTEST_GUILESS_MAIN(TestFormats)
#include "test_formats.moc"
