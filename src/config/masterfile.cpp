#include "config/masterfile.h"

#include "base/byteset.h"
#include "base/lines.h"
#include "config/productpaths.h"
#include "config/settings.h"

#include <cstdio>
#include <map>

LostSettings lostSettings;

namespace {

ProductFile masterFile;
bool hasTemplate = false;

/// It holds passwords.
constexpr mode_t newFileMode = 0640;

constexpr char commentMark = '|';
constexpr char keyMark = '%';
constexpr ByteSet blanks{" \t"};

struct KeyLine {
    std::string_view key;
    std::optional<std::string_view> value; ///< None without a colon.
};

/// Divides a line that begins with the key mark.
KeyLine divided(std::string_view line) {
    const std::string_view text = lineText(line);
    const std::size_t colon = text.find(':');
    if (colon == std::string_view::npos) {
        return {text.substr(1), std::nullopt};
    }
    return {text.substr(1, colon - 1), text.substr(colon + 1)};
}

using TemplateLines = std::map<std::string, std::optional<std::string_view>, LettersAlike>;

/// Values by their keys: views of the template's bytes.
TemplateLines templateLines(std::string_view masterTemplate) {
    TemplateLines values;
    LinePieces lines{masterTemplate};
    while (const std::optional<std::string_view> line = lines.next()) {
        if (line->front() == keyMark) {
            const auto [key, value] = divided(*line);
            values.insert_or_assign(std::string{key}, value);
        }
    }
    return values;
}

/// How a value is spelled says nothing, nor how it is divided into lines.
std::string withoutBlanksAndCommas(std::string_view value) {
    std::string rest{value};
    std::erase_if(rest, [](char byte) { return byte == ',' || blanks.holds(byte); });
    return rest;
}

/// Collects one setting's lines; hands them over when the next setting begins.
class ValueReader {
public:
    explicit ValueReader(std::string_view masterTemplate)
        : template_{templateLines(masterTemplate)} {}

    void begin(std::string_view key) {
        end();
        key_ = key;
        value_.clear();
        isCut_ = false;
    }

    /// `rest` is what stands behind the line's text.
    void add(std::string_view text, std::string_view rest) {
        text.remove_prefix(blanks.span(text));
        if (!text.empty() && !value_.empty()) {
            value_ += ',';
        }
        value_ += text;
        isCut_ = isCut_ || holdsWord(rest);
    }

    void end() const {
        if (key_.empty()) {
            return;
        }
        Setting *setting = settings().find(key_);
        if (setting != nullptr) {
            setting->exchange(value_);
        }
        lostSettings.keys.erase(key_); // Of several lines the last counts.
        lostSettings.accessLists.erase(key_);
        if (!isKept(setting) || isCut_) {
            lostSettings.keys.insert(key_);
        } else if (dynamic_cast<AccessListSetting *>(setting) != nullptr && !isKeptWhole(value_)) {
            lostSettings.accessLists.insert(key_);
        }
    }

private:
    /// The template's line gets the store's value, or stays as it is.
    bool isKept(const Setting *setting) const {
        const auto line = template_.find(key_);
        if (line == template_.end() || setting != nullptr) {
            return line != template_.end() && line->second;
        }
        return withoutBlanksAndCommas(line->second.value_or("")) == withoutBlanksAndCommas(value_);
    }

    TemplateLines template_;
    std::string key_;
    std::string value_;
    bool isCut_ = false;
};

std::optional<std::string> readTemplate() {
    std::optional<std::string> lines;
    const auto take = [&lines](std::string bytes) { lines = std::move(bytes); };
    hasTemplate = ProductFile{}.read(productPaths().masterTemplate, take) == 0;
    return lines;
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
    const auto [key, ownValue] = divided(line);
    const std::optional<std::string> value = settingByKey(std::string{key}, std::nullopt);
    if (!ownValue || !value) {
        bytes += line;
        return;
    }
    bytes += keyMark;
    bytes += key;
    appendValue(bytes, *value);
}

} // namespace

void parseMasterConfig(std::string_view bytes, std::string_view masterTemplate) {
    ValueReader setting{masterTemplate};
    lostSettings = {};
    LinePieces lines{bytes};
    while (const std::optional<std::string_view> line = lines.next()) {
        const bool isEmptyLine = line->front() == '\r' || line->front() == '\n';
        if (isEmptyLine || line->front() == commentMark) {
            continue;
        }
        std::string_view text = lineText(*line);
        const std::string_view rest = line->substr(text.size());
        if (line->front() == keyMark) {
            const auto [key, value] = divided(*line);
            setting.begin(key);
            text = value.value_or("");
        }
        setting.add(text, rest);
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
