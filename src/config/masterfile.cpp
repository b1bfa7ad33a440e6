#include "config/masterfile.h"

#include "base/byteset.h"
#include "base/lines.h"
#include "base/textfile.h"
#include "config/productpaths.h"
#include "config/settings.h"

#include <algorithm>
#include <cstdio>
#include <map>
#include <new>

LostSettings lostSettings;

namespace {

ProductFile masterFile;
bool hasTemplate = false;

/// It holds passwords.
constexpr mode_t newFileMode = 0640;

constexpr char commentMark = '|';
constexpr char keyMark = '%';
constexpr ByteSet blanks{" \t"};

/// How a value is spelled says nothing, nor how it is divided into lines.
std::string withoutBlanksAndCommas(std::string_view value) {
    std::string rest{value};
    std::erase_if(rest, [](char byte) { return byte == ',' || blanks.holds(byte); });
    return rest;
}

struct KeyLine {
    std::string_view key;
    std::string_view value;
    bool hasColon;
};

/// Divides the text of a line that begins with the key mark.
KeyLine divided(std::string_view text) {
    const std::size_t colon = std::min(text.find(':'), text.size());
    const bool hasColon = colon < text.size();
    return {text.substr(1, colon - 1), text.substr(hasColon ? colon + 1 : colon), hasColon};
}

struct LettersAlike {
    bool operator()(const std::string &a, const std::string &b) const {
        return compareNoCase(a.c_str(), b.c_str()) < 0;
    }
};

/// By their keys; views of the template's bytes.
using TemplateLines = std::map<std::string, KeyLine, LettersAlike>;

TemplateLines templateLines(std::string_view masterTemplate) {
    TemplateLines found;
    LinePieces lines{masterTemplate};
    while (const std::optional<std::string_view> line = lines.next()) {
        if (line->front() == keyMark) {
            const KeyLine keyLine = divided(lineText(*line));
            found.insert_or_assign(std::string{keyLine.key}, keyLine);
        }
    }
    return found;
}

/// Names the key among the lost ones, or takes it from there: its last line counts.
void note(std::vector<std::string> &keys, const std::string &key, bool isLost) {
    std::erase_if(keys, [&key](const std::string &other) {
        return compareNoCase(other.c_str(), key.c_str()) == 0;
    });
    if (isLost && keys.size() < LostSettings::maximumNamed) {
        keys.push_back(key);
    }
}

/// Collects one setting's lines; hands them over when the next setting begins.
class ValueReader {
public:
    explicit ValueReader(std::string_view masterTemplate)
        : template_{templateLines(masterTemplate)} {}

    void begin(std::string_view key) {
        end();
        isCut_ = false;
        key_ = key;
        value_.clear();
    }

    void add(std::string_view text) {
        text.remove_prefix(blanks.span(text));
        if (!text.empty() && !value_.empty()) {
            value_ += ',';
        }
        value_ += text;
    }

    /// Of a line of the setting, what stands behind its text.
    void drop(std::string_view rest) { isCut_ = isCut_ || (rest != "\n" && holdsWord(rest)); }

    void end() const {
        if (key_.empty()) {
            return;
        }
        Setting *setting = settings().find(key_);
        if (setting != nullptr) {
            setting->exchange(value_);
        }
        // The template's line gets the store's value, or stays as it is.
        const auto line = template_.find(key_);
        const bool isKept = line != template_.end() &&
                            (setting != nullptr ? line->second.hasColon
                                                : withoutBlanksAndCommas(line->second.value) ==
                                                      withoutBlanksAndCommas(value_));
        note(lostSettings.keys, key_, !isKept || isCut_);
        note(lostSettings.accessLists, key_,
             isKept && dynamic_cast<AccessListSetting *>(setting) != nullptr &&
                 !isKeptWhole(value_));
    }

private:
    TemplateLines template_;
    bool isCut_ = false;
    std::string key_;
    std::string value_;
};

std::optional<std::string> readTemplate() {
    hasTemplate = false;
    try {
        FileRead file = readWholeFile(productPaths().masterTemplate);
        hasTemplate = file.bytes.has_value();
        return std::move(file.bytes);
    } catch (const std::bad_alloc &) {
        return std::nullopt;
    }
}

void appendValue(std::string &bytes, std::string_view value) {
    bytes += ": ";
    for (std::size_t comma = 0; (comma = value.find(',')) != std::string_view::npos;) {
        bytes += value.substr(0, comma);
        bytes += "\n\t";
        value.remove_prefix(comma + 1);
    }
    bytes += value;
    bytes += '\n';
}

/// Appends a template's key line with the store's value, or as it is.
void appendKeyLine(std::string &bytes, std::string_view line) {
    const std::size_t colon = beforeNul(line).find(':');
    if (colon != std::string_view::npos) {
        if (const auto value = settingByKey(std::string{line.substr(1, colon - 1)}, std::nullopt)) {
            bytes += line.substr(0, colon);
            appendValue(bytes, *value);
            return;
        }
    }
    bytes += line;
}

} // namespace

void parseMasterConfig(std::string_view bytes, std::string_view masterTemplate) {
    ValueReader setting{masterTemplate};
    lostSettings = {};
    LinePieces lines{bytes};
    while (const std::optional<std::string_view> line = lines.next()) {
        std::string_view text = lineText(*line);
        const std::string_view rest = line->substr(text.size());
        const bool isEmptyLine = line->front() == '\r' || line->front() == '\n';
        if (isEmptyLine || line->front() == commentMark) {
            continue;
        }
        if (line->front() == keyMark) {
            const KeyLine keyLine = divided(text);
            setting.begin(keyLine.key);
            text = keyLine.value;
        }
        setting.add(text);
        setting.drop(rest);
    }
    setting.end();
}

void formatMasterConfig(std::string_view masterTemplate, std::string &bytes) {
    LinePieces lines{masterTemplate};
    while (const std::optional<std::string_view> line = lines.next()) {
        if (line->front() == commentMark) {
            bytes += *line;
        } else if (line->front() == keyMark) {
            appendKeyLine(bytes, *line);
        }
    }
}

int readMasterConfig() {
    const char *path = productPaths().master;
    const std::optional<std::string> lines = readTemplate();
    const int result = masterFile.read(path, [&lines](const std::string &bytes) {
        parseMasterConfig(bytes, lines ? *lines : std::string_view{});
    });
    if (result == 1) {
        std::printf("Couldn't open config file:%s\n", path);
        std::fflush(stdout);
    }
    return result;
}

void writeMasterConfig() {
    const std::optional<std::string> lines = readTemplate();
    const auto format = [&lines](std::string &bytes) { formatMasterConfig(*lines, bytes); };
    if (lines && masterFile.rewrite(format, newFileMode)) {
        lostSettings = {};
    }
}

std::optional<TranslatableText> masterFileObstacle() {
    const std::optional<TranslatableText> obstacle = masterFile.obstacle();
    return obstacle || hasTemplate ? obstacle : translatable("there is no template");
}
