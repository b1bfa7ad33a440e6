#include "fuzz.h"

#include "alias/aliasfile.h"
#include "config/masterfile.h"
#include "config/settings.h"
#include "fetch/pophosts.h"
#include "lists/maillistfile.h"
#include "server/smtprejectfile.h"

#include <algorithm>
#include <functional>
#include <sanitizer/asan_interface.h>

namespace {

/// The bytes where kept texts can be of them, until the fourth call from now: each input would stay
/// for the process's life otherwise. The address sanitizer watches their end.
KeptText placed(std::string_view bytes) {
    constexpr std::size_t places = 4;
    constexpr std::size_t placeSize = 1 << 18;
    static const KeptText all = keep(std::string(places * placeSize, '\0'));
    static auto *const memory = const_cast<char *>(all.data());
    static std::size_t next = 0;
    require(bytes.size() <= placeSize, "an input of 4 kB makes no file of 256 kB");
    const std::size_t begin = next++ % places * placeSize;
    ASAN_UNPOISON_MEMORY_REGION(memory + begin, placeSize);
    bytes.copy(memory + begin, bytes.size());
    ASAN_POISON_MEMORY_REGION(memory + begin + bytes.size(), placeSize - bytes.size());
    return all.substr(begin, bytes.size());
}

template <class Record>
struct Format {
    std::size_t (*parse)(KeptText, RecordChain<Record> &);
    std::function<void(const RecordChain<Record> &, std::string &)> format;
    std::string (*shown)(const Record &); ///< All that a record holds.

    [[nodiscard]] RecordChain<Record> read(std::string_view bytes) const {
        RecordChain<Record> list;
        parse(placed(bytes), list);
        return list;
    }
    [[nodiscard]] RecordChain<Record> readAgain(const RecordChain<Record> &list) const {
        std::string bytes;
        format(list, bytes);
        return read(bytes);
    }
    /// Records are compared: what the writer forgets is in no text of its own.
    void requireSame(const RecordChain<Record> &list, const RecordChain<Record> &other) const {
        std::string texts;
        std::string others;
        for (const Record &record : list) {
            texts += shown(record);
        }
        for (const Record &record : other) {
            others += shown(record);
        }
        require(others == texts, "a list comes back");
    }
    /// Twice, for some are turned round.
    void requireComesBack(const RecordChain<Record> &list) const {
        requireSame(list, readAgain(readAgain(list)));
    }
};

std::string shownAlias(const alias_entry &alias) {
    std::string text{std::string_view{alias.address}};
    for (const alias_list_entry &target : alias.aliases) {
        (((text += '\n') += static_cast<char>('0' + target.type)) +=
         static_cast<char>('0' + target.bang)) += std::string_view{target.alias};
    }
    return text + "\n\n";
}

std::string shownList(const maillist_entry &list) {
    std::string text;
    for (const KeptText &field : {list.name, list.post, list.admin, list.support, list.footer,
                                  list.header, list.modrt, list.info}) {
        (text += std::string_view{field}) += '\n';
    }
    for (const std::int64_t number :
         {std::int64_t{list.diglen}, std::int64_t{list.digno}, std::int64_t{list.digcnt},
          std::int64_t{list.digcur}, std::int64_t{list.flags}}) {
        (text += std::to_string(number)) += '\n';
    }
    for (const AddressChain *chain : {&list.member, &list.allow, &list.block}) {
        for (const maillist_addr_entry &address : *chain) {
            (text += std::string_view{address.addr}) += '\n';
        }
        text += '\0';
    }
    return text;
}

std::string shownWord(const smtpreject_entry &entry) {
    return std::string{std::string_view{entry.domain}} + '\n';
}

const Format<alias_entry> aliasFormat{parseAliases, formatAliases, shownAlias};
const Format<maillist_entry> mailListFormat{parseMailLists, formatMailLists, shownList};
const Format<smtpreject_entry> rejectFormat{parseSmtpRejects, formatSmtpRejects, shownWord};

/// The texts of a list that reading turns round, in the order of the input.
template <class Record>
std::vector<std::string_view> inputOrder(const RecordChain<Record> &list, KeptText Record::*text) {
    std::vector<std::string_view> texts;
    for (const Record &record : list) {
        texts.insert(texts.begin(), record.*text);
    }
    return texts;
}

template <class Record, class Matches>
void removeAll(RecordChain<Record> &list, Matches matches) {
    for (Record **link = &list.head; *(link = findRecord(link, matches)) != nullptr;) {
        removeRecord(link);
    }
}

/// An alias without targets is a line of one word, which is not read again; of several "#" before a
/// text each reading takes one.
void settle(RecordChain<alias_entry> &aliases) {
    removeAll(aliases, [](const alias_entry &alias) { return alias.aliases.head == nullptr; });
    for (alias_entry &alias : aliases) {
        for (alias_list_entry &target : alias.aliases) {
            while (target.type == ALIAS_LIST_ADMIN && target.alias.starts_with('#')) {
                target.alias.remove_prefix(1);
            }
        }
    }
}

/// The parts that a text has on lines of their own in the master file, as they are read again.
std::vector<std::string_view> lineParts(std::string_view text) {
    std::vector<std::string_view> parts;
    for (;;) {
        const std::size_t end = text.find(',');
        const std::string_view part = text.substr(0, end);
        if (const std::size_t begin = part.find_first_not_of(" \t"); begin != part.npos) {
            parts.push_back(part.substr(begin));
        }
        if (end == std::string_view::npos) {
            return parts;
        }
        text.remove_prefix(end + 1);
    }
}

std::string textOf(Setting *setting) { return setting->exchange(std::nullopt).value_or(""); }

std::vector<std::string> textsOf(const std::vector<Setting *> &chosen) {
    std::vector<std::string> texts(chosen.size());
    std::ranges::transform(chosen, texts.begin(), textOf);
    return texts;
}

/// What the setting's text is when it has been written and read again.
std::string settledText(Setting *setting) {
    const std::string text = textOf(setting);
    std::string joined;
    for (const std::string_view part : lineParts(text)) {
        (joined += joined.empty() ? "" : ",") += part;
    }
    return dynamic_cast<TextSetting *>(setting) != nullptr ? joined : text;
}

std::string filled(std::string_view masterTemplate) {
    std::string bytes;
    formatMasterConfig(masterTemplate, bytes);
    return bytes;
}

void readAnew(const std::vector<Setting *> &known, std::string_view masterFile) {
    for (Setting *setting : known) {
        setting->exchange("");
    }
    parseMasterConfig(masterFile);
}

} // namespace

namespace targets {

void masterfile(std::string_view bytes) {
    const std::vector<Setting *> &all = settings().all();
    static std::vector<Setting *> given = all; // By the input before.
    readAnew(given, {});
    static const std::vector<std::string> emptyTexts = textsOf(all);
    parseMasterConfig(bytes);
    given.clear();
    std::string keys;
    std::vector<std::string> settled;
    for (std::size_t index = 0; index < all.size(); ++index) {
        if (const std::string text = textOf(all[index]); text != emptyTexts[index]) {
            given.push_back(all[index]);
            ((keys += '%') += all[index]->key()) += ":\n";
            settled.push_back(settledText(all[index]));
            if (dynamic_cast<TextSetting *>(all[index]) != nullptr) {
                requireParts(lineParts(text), bytes);
            }
        }
    }
    const std::string first = filled(bytes);
    require(filled(first) == first, "a master file is a template of itself");
    readAnew(given, filled(keys));
    require(textsOf(given) == settled, "all settings come back");
    // A later line of the same key, one that is kept as it is, counts from the next reading on.
    readAnew(given, first);
    const std::string second = filled(bytes);
    readAnew(given, second);
    require(filled(bytes) == second, "a master file comes back");
}

void aliases(std::string_view bytes) {
    RecordChain<alias_entry> list = aliasFormat.read(bytes);
    std::vector<std::string_view> texts;
    for (const alias_entry &alias : list) {
        texts.emplace_back(alias.address);
        for (const alias_list_entry &target : alias.aliases) {
            texts.emplace_back(target.alias);
        }
    }
    requireParts(texts, bytes);
    RecordChain<alias_entry> again = aliasFormat.readAgain(list);
    settle(list);
    settle(again);
    aliasFormat.requireSame(list, again);
    aliasFormat.requireComesBack(list);
}

void maillists(std::string_view bytes) {
    RecordChain<maillist_entry> lists = mailListFormat.read(bytes);
    for (maillist_entry &list : lists) {
        for (const KeptText &text : {list.name, list.post, list.admin, list.support, list.footer,
                                     list.header, list.modrt, list.info}) {
            requireParts({text}, bytes);
        }
        for (AddressChain *chain : {&list.member, &list.allow, &list.block}) {
            requireParts(inputOrder(*chain, &maillist_addr_entry::addr), bytes);
            // A part of a longer line: its own line's end would be read as one more address.
            removeAll(*chain, [](const auto &address) { return address.addr.size() == 249; });
        }
    }
    mailListFormat.requireComesBack(lists);
}

void fetchers(std::string_view bytes) {
    parsePopHosts(bytes);
    for (const pop_host &host : pop_host_list) {
        requireParts({popHostText(host.user), popHostText(host.password), popHostText(host.server)},
                     bytes);
    }
    const std::string text = formatPopHosts();
    parsePopHosts(text);
    require(formatPopHosts() == text, "fetchers come back");
    settings().pop_hosts.value = text;
    parseMasterConfig(filled("%pop.hosts:\n"));
    parsePopHosts(settings().pop_hosts.exchange(std::nullopt));
    require(formatPopHosts() == text, "fetchers come back from the master file");
}

void rejects(std::string_view bytes) {
    const RecordChain<smtpreject_entry> list = rejectFormat.read(bytes);
    requireParts(inputOrder(list, &smtpreject_entry::domain), bytes);
    rejectFormat.requireComesBack(list);
}

void loadedlines(std::string_view bytes) {
    const AddressChain loaded = parseAddressLines(placed(bytes));
    std::vector<std::string_view> texts = inputOrder(loaded, &maillist_addr_entry::addr);
    requireParts(texts, bytes);
    std::string lines;
    for (const std::string_view text : texts) {
        (lines += text) += '\n';
    }
    // An "@" may have stood behind a carriage return.
    std::erase_if(texts, [](std::string_view text) { return text.find('@') == text.npos; });
    const AddressChain again = parseAddressLines(placed(lines));
    require(inputOrder(again, &maillist_addr_entry::addr) == texts, "addresses come back");
}

} // namespace targets
