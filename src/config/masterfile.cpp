#include "config/masterfile.h"

#include "base/textfile.h"
#include "config/productpaths.h"
#include "config/settings.h"

#include <algorithm>
#include <cstdio>
#include <new>

namespace {

constexpr char commentMark = '|';
constexpr char keyMark = '%';

std::string_view withoutLeadingBlanks(std::string_view text) {
    return text.substr(std::min(text.find_first_not_of(" \t"), text.size()));
}

/// Collects one setting's lines; hands them over when the next setting begins.
class ValueReader {
public:
    void begin(std::string_view key) {
        end();
        key_ = key;
        value_.clear();
    }

    void add(std::string_view text) {
        text = withoutLeadingBlanks(text);
        if (!text.empty() && !value_.empty()) {
            value_ += ',';
        }
        value_ += text;
    }

    void end() const {
        if (!key_.empty()) {
            settingByKey(key_, value_);
        }
    }

private:
    std::string key_;
    std::string value_;
};

void appendValue(std::string &output, std::string_view value) {
    for (const char character : value) {
        if (character == ',') {
            output += "\n\t";
        } else {
            output += character;
        }
    }
}

/// A template's key line with the store's value, or the line itself.
void appendKeyLine(std::string &output, std::string_view line) {
    const std::size_t colon = line.find(':');
    std::optional<std::string> value;
    if (colon != std::string_view::npos) {
        value = settingByKey(std::string{line.substr(1, colon - 1)}, std::nullopt);
    }
    if (!value) {
        output += line;
        return;
    }
    output += line.substr(0, colon);
    output += ": ";
    appendValue(output, *value);
    output += '\n';
}

} // namespace

void parseMasterConfig(std::string_view bytes) {
    ValueReader setting;
    LinePieces lines{bytes};
    while (const std::optional<std::string_view> line = lines.next()) {
        std::string_view text = lineText(*line);
        const bool isEmptyLine = line->front() == '\r' || line->front() == '\n';
        if (isEmptyLine || line->front() == commentMark) {
            continue;
        }
        if (line->front() == keyMark) {
            const std::size_t colon = text.find(':');
            setting.begin(text.substr(1, colon == std::string_view::npos ? colon : colon - 1));
            text.remove_prefix(colon == std::string_view::npos ? text.size() : colon + 1);
        }
        setting.add(text);
    }
    setting.end();
}

std::string formatMasterConfig(std::string_view masterTemplate) {
    std::string output;
    LinePieces lines{masterTemplate};
    while (const std::optional<std::string_view> line = lines.next()) {
        if (line->front() == commentMark) {
            output += *line;
        } else if (line->front() == keyMark) {
            appendKeyLine(output, *line);
        }
    }
    return output;
}

int readMasterConfig() {
    const char *path = productPaths().master;
    std::optional<std::string> bytes;
    try {
        bytes = readWholeFile(path);
        if (bytes) {
            parseMasterConfig(*bytes);
        }
    } catch (const std::bad_alloc &) { // What the store was given until here stays.
    }
    if (!bytes) {
        std::printf("Couldn't open config file:%s\n", path);
        std::fflush(stdout);
        return 1;
    }
    return 0;
}

void writeMasterConfig() {
    try {
        if (const auto masterTemplate = readWholeFile(productPaths().masterTemplate)) {
            rewriteFile(productPaths().master, formatMasterConfig(*masterTemplate));
        }
    } catch (const std::bad_alloc &) { // The file is not opened yet and stays as it was.
    }
}
