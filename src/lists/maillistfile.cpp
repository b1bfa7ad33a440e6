#include "lists/maillistfile.h"

#include "base/lines.h"
#include "config/settings.h"
#include "config/settingvalues.h"

#include <algorithm>
#include <array>
#include <cstdlib>

RecordChain<maillist_entry> maillist_list;
ProductFile mailListFile;

namespace {

constexpr std::size_t longestPiece = 249;
constexpr std::size_t longestLoadedPiece = 254;

struct TextKey {
    std::string_view key;
    KeptText maillist_entry::*field;
};

/// In the order of the written block. The info file stands twice: that is how the file is.
constexpr std::array<TextKey, 9> textKeys{{{"%name:", &maillist_entry::name},
                                           {"%post:", &maillist_entry::post},
                                           {"%admin:", &maillist_entry::admin},
                                           {"%support:", &maillist_entry::support},
                                           {"%info:", &maillist_entry::info},
                                           {"%footer:", &maillist_entry::footer},
                                           {"%header:", &maillist_entry::header},
                                           {"%modrt:", &maillist_entry::modrt},
                                           {"%info:", &maillist_entry::info}}};

struct NumberKey {
    std::string_view key;
    std::int32_t maillist_entry::*field;
};

constexpr std::array<NumberKey, 4> numberKeys{{{"%diglen:", &maillist_entry::diglen},
                                               {"%digno:", &maillist_entry::digno},
                                               {"%digcnt:", &maillist_entry::digcnt},
                                               {"%digcur:", &maillist_entry::digcur}}};

constexpr std::string_view flagsKey = "%flags:";

struct Section {
    std::string_view name; ///< Its first letter alone decides on reading.
    AddressChain maillist_entry::*chain;
};

constexpr std::array<Section, 3> sections{{{"member", &maillist_entry::member},
                                           {"allow", &maillist_entry::allow},
                                           {"block", &maillist_entry::block}}};

constexpr std::size_t sectionLetter = 7;

AddressChain *sectionOpened(maillist_entry &list, std::string_view startLine) {
    for (const Section &section : sections) {
        if (startLine.size() > sectionLetter && startLine[sectionLetter] == section.name.front()) {
            return &(list.*section.chain);
        }
    }
    return nullptr;
}

/// Sets the number that the value gives. Gives back what stands behind it; all of the value where
/// it takes the place of another number.
template <class Number>
KeptText setNumber(Number &number, KeptText value) {
    const std::string digits{std::string_view{value}};
    char *end = nullptr;
    std::strtoll(digits.c_str(), &end, 10);
    const Number before = std::exchange(number, static_cast<Number>(parseInteger(value)));
    const bool isOther = before != 0 && before != number;
    return isOther ? value : value.substr(static_cast<std::size_t>(end - digits.c_str()));
}

/// Sets the field that the line gives. Gives back what of the line is in no record; all of it where
/// it takes the place of another.
KeptText setField(maillist_entry &list, KeptText line) {
    for (const auto &[key, field] : textKeys) {
        if (line.starts_with(key)) {
            const KeptText before = std::exchange(list.*field, line.substr(key.size()));
            const bool isOther = std::string_view{before} != list.*field && holdsWord(before);
            return isOther ? line : KeptText{};
        }
    }
    for (const auto &[key, field] : numberKeys) {
        if (line.starts_with(key)) {
            return setNumber(list.*field, line.substr(key.size()));
        }
    }
    if (line.starts_with(flagsKey)) {
        return setNumber(list.flags, line.substr(flagsKey.size()));
    }
    return line;
}

/// Outside a list, inside a list, or inside one of its address sections.
class BlockReader {
public:
    explicit BlockReader(RecordChain<maillist_entry> &lists) : lists_{lists} {}

    /// Gives back what of the piece is in no record.
    KeptText take(KeptText piece) {
        if (section_ != nullptr) {
            return takeAddress(piece);
        }
        if (list_ != nullptr) {
            const KeptText line = lineText(piece);
            const KeptText lost = takeLine(line);
            return holdsWord(lost) ? lost : piece.substr(line.size());
        }
        if (piece.starts_with("#new")) {
            list_ = &prependRecord(&lists_.head, maillist_entry{});
            return behindWord(piece);
        }
        return piece;
    }

private:
    KeptText takeAddress(KeptText piece) {
        if (piece.starts_with('#')) {
            section_ = nullptr;
            return piece.starts_with("#end") ? behindWord(piece) : piece;
        }
        const KeptText line = lineText(piece);
        prependRecord(&section_->head, {line});
        return piece.substr(line.size());
    }

    KeptText takeLine(KeptText line) {
        if (line.starts_with("#endlist")) {
            list_ = nullptr;
            return behindWord(line);
        }
        if (line.starts_with("#start")) {
            section_ = sectionOpened(*list_, line);
            list_ = section_ != nullptr ? list_ : nullptr;
            return section_ != nullptr ? behindWord(behindWord(line)) : line;
        }
        return setField(*list_, line);
    }

    RecordChain<maillist_entry> &lists_;
    maillist_entry *list_ = nullptr;
    AddressChain *section_ = nullptr;
};

void appendLine(std::string &bytes, std::string_view key, std::string_view value = {}) {
    bytes += key;
    bytes += value;
    bytes += '\n';
}

/// Adds the addresses that it leaves out to their number.
void appendSection(std::string &bytes, std::string_view name, const AddressChain &addresses,
                   std::size_t &leftOut) {
    appendLine(bytes, "#start ", name);
    for (const maillist_addr_entry &address : addresses) {
        if (!address.addr.starts_with('#') && address.addr.size() <= longestPiece) {
            appendLine(bytes, address.addr);
        } else {
            ++leftOut;
        }
    }
    appendLine(bytes, "#end");
}

void appendList(std::string &bytes, const maillist_entry &list, std::size_t &leftOut) {
    appendLine(bytes, "#new");
    for (const auto &[key, field] : textKeys) {
        appendLine(bytes, key, list.*field);
    }
    for (const auto &[key, field] : numberKeys) {
        appendLine(bytes, key, std::to_string(list.*field));
    }
    appendLine(bytes, flagsKey, formatUnsigned(list.flags));
    for (const auto &[name, chain] : sections) {
        appendSection(bytes, name, list.*chain, leftOut);
    }
    bytes += "#endlist\n\n\n";
}

} // namespace

std::size_t parseMailLists(KeptText bytes, RecordChain<maillist_entry> &lists) {
    BlockReader reader{lists};
    LinePieces pieces{bytes, longestPiece};
    LostLines lost;
    while (const std::optional<KeptText> piece = pieces.next()) {
        lost.add(*piece, reader.take(*piece));
    }
    return lost.count();
}

std::size_t formatMailLists(const RecordChain<maillist_entry> &lists, std::string &bytes) {
    std::size_t leftOut = 0;
    for (const maillist_entry &list : lists) {
        appendList(bytes, list, leftOut);
    }
    return leftOut;
}

AddressChain parseAddressLines(KeptText bytes) {
    AddressChain addresses;
    LinePieces pieces{bytes, longestLoadedPiece};
    while (const std::optional<KeptText> piece = pieces.next()) {
        if (std::string_view{beforeNul(*piece)}.find('@') != std::string_view::npos) {
            prependRecord(&addresses.head, {lineText(*piece)});
        }
    }
    return addresses;
}

std::size_t maximumBytesOf(KeptText maillist_entry::*field) {
    const auto found = std::ranges::find(textKeys, field, &TextKey::field);
    return longestTyped - found->key.size();
}

void readMailListFile() {
    maillist_list.clear();
    mailListFile.read(settings().mail_file_maillist.value, [](std::string bytes) {
        mailListFile.lostLines = parseMailLists(keep(std::move(bytes)), maillist_list);
    });
}

void writeMailListFile() {
    std::size_t leftOut = 0;
    const auto format = [&leftOut](std::string &bytes) {
        leftOut = formatMailLists(maillist_list, bytes);
    };
    if (mailListFile.rewrite(format)) {
        mailListFile.lostLines = leftOut;
    }
}
