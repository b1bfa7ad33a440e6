#include "alias/aliasfile.h"

#include "config/datafile.h"

#include <algorithm>
#include <cctype>

RecordChain<alias_entry> alias_list;

namespace {

constexpr std::string_view skippedBeginnings{"|# \r\n\t"};
constexpr std::string_view wordEnds{"\t ,"};

bool separatesTargets(char character) {
    return character == ',' || std::isspace(static_cast<unsigned char>(character)) != 0;
}

std::uint8_t typeByContent(std::string_view word) {
    if (word.starts_with('[')) {
        return ALIAS_BRACKET;
    }
    if (word.find('@') != std::string_view::npos) {
        return ALIAS_ADDRESS;
    }
    return word.find('$') != std::string_view::npos ? ALIAS_LIST_POSTING : ALIAS_PLAIN;
}

/// Takes the target that `rest` begins with.
alias_list_entry takeTarget(std::string_view &rest) {
    alias_list_entry target;
    if (rest.starts_with('!')) {
        target.bang = 1;
        rest.remove_prefix(1);
    }
    std::string_view word = rest.substr(0, rest.find_first_of(wordEnds));
    rest.remove_prefix(word.size());
    if (word.starts_with('#')) {
        target.type = ALIAS_LIST_ADMIN;
        word.remove_prefix(1);
    } else {
        target.type = typeByContent(word);
    }
    target.alias = word;
    return target;
}

/// `rest` is what follows an alias's address on its line.
void takeTargets(std::string_view rest, alias_entry &alias) {
    RecordAppender<alias_list_entry> end{&alias.aliases.head};
    for (;;) {
        const auto *const target = std::ranges::find_if_not(rest, separatesTargets);
        rest.remove_prefix(static_cast<std::size_t>(target - rest.begin()));
        if (rest.empty()) {
            return;
        }
        end.append(takeTarget(rest));
    }
}

void appendAlias(std::string &bytes, const alias_entry &alias) {
    bytes += alias.address;
    for (const alias_list_entry &target : alias.aliases) {
        bytes += ',';
        bytes += target.bang != 0 ? "!" : "";
        bytes += target.type == ALIAS_LIST_ADMIN && !target.alias.starts_with('#') ? "#" : "";
        bytes += target.alias;
    }
    bytes += '\n';
}

} // namespace

void parseAliases(std::string_view bytes, RecordChain<alias_entry> &list) {
    RecordAppender<alias_entry> end{&list.head};
    LinePieces lines{bytes};
    while (const std::optional<std::string_view> line = lines.next()) {
        const std::string_view text = lineText(*line);
        const std::size_t addressEnd = text.find_first_of(wordEnds);
        if (skippedBeginnings.find(line->front()) == std::string_view::npos &&
            addressEnd != std::string_view::npos) {
            alias_entry &alias = end.append({std::string{text.substr(0, addressEnd)}, {}});
            takeTargets(text.substr(addressEnd), alias);
        }
    }
}

std::string formatAliases(const RecordChain<alias_entry> &list) {
    std::string bytes;
    for (const alias_entry &alias : list) {
        appendAlias(bytes, alias);
    }
    return bytes;
}

int readAliasFile() {
    try {
        const std::optional<std::string> bytes = readDataFile(settings().mail_file_alias);
        if (!bytes) {
            return 1;
        }
        parseAliases(*bytes, alias_list);
    } catch (const std::bad_alloc &) {
        return 2;
    }
    return 0;
}

void writeAliasFile() {
    rewriteDataFile(settings().mail_file_alias, [] { return formatAliases(alias_list); });
}
