#include "alias/aliasfile.h"

#include "base/byteset.h"
#include "base/lines.h"
#include "config/settings.h"

#include <cctype>

RecordChain<alias_entry> alias_list;
ProductFile aliasFile;

namespace {

constexpr ByteSet skippedBeginnings{"|# \r\n\t"};
constexpr ByteSet wordEnds{"\t ,"};

bool separatesTargets(unsigned char character) {
    return character == ',' || std::isspace(character) != 0;
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

alias_list_entry takeTarget(KeptText &rest) {
    alias_list_entry target;
    if (rest.starts_with('!')) {
        target.bang = 1;
        rest.remove_prefix(1);
    }
    target.alias = rest.substr(0, wordEnds.spanBefore(rest));
    rest.remove_prefix(target.alias.size());
    if (target.alias.starts_with('#')) {
        target.type = ALIAS_LIST_ADMIN;
        target.alias.remove_prefix(1);
    } else {
        target.type = typeByContent(target.alias);
    }
    return target;
}

/// `rest` is what follows an alias's address on its line.
void takeTargets(KeptText rest, const ByteSet &separators, alias_entry &alias) {
    RecordAppender<alias_list_entry> end{&alias.aliases.head};
    for (;;) {
        rest.remove_prefix(separators.span(rest));
        if (rest.empty()) {
            return;
        }
        end.append(takeTarget(rest));
    }
}

void appendAlias(std::string &bytes, const alias_entry &alias) {
    bytes += alias.address;
    for (const alias_list_entry &target : alias.aliases) {
        bytes += target.bang == 0 ? "," : ",!";
        if (target.type == ALIAS_LIST_ADMIN && !target.alias.starts_with('#')) {
            bytes += '#';
        }
        bytes += target.alias;
    }
    bytes += '\n';
}

} // namespace

std::size_t parseAliases(KeptText bytes, RecordChain<alias_entry> &list) {
    const ByteSet separators = ByteSet::of(separatesTargets);
    RecordAppender<alias_entry> end{&list.head};
    LinePieces lines{bytes};
    LostLines lost;
    while (const std::optional<KeptText> line = lines.next()) {
        const KeptText text = lineText(*line);
        const std::size_t addressEnd = wordEnds.spanBefore(text);
        const bool isAlias = !skippedBeginnings.holds(line->front()) && addressEnd < text.size();
        if (isAlias) {
            alias_entry &alias = end.append({text.substr(0, addressEnd), {}});
            takeTargets(text.substr(addressEnd), separators, alias);
        }
        lost.add(*line, line->substr(isAlias ? text.size() : 0));
    }
    return lost.count();
}

void formatAliases(const RecordChain<alias_entry> &list, std::string &bytes) {
    for (const alias_entry &alias : list) {
        appendAlias(bytes, alias);
    }
}

int readAliasFile() {
    return aliasFile.read(settings().mail_file_alias.value, [](std::string bytes) {
        aliasFile.lostLines = parseAliases(keep(std::move(bytes)), alias_list);
    });
}

void writeAliasFile() {
    aliasFile.rewrite([](std::string &bytes) { formatAliases(alias_list, bytes); });
}
