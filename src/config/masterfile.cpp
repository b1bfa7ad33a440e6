#include "config/masterfile.h"

#include "base/byteset.h"
#include "base/lines.h"
#include "base/productfile.h"
#include "base/textfile.h"
#include "config/productpaths.h"
#include "config/settings.h"

#include <cstdio>
#include <new>

namespace {

ProductFile masterFile;

/// It holds passwords.
constexpr mode_t newFileMode = 0640;

constexpr char commentMark = '|';
constexpr char keyMark = '%';
constexpr ByteSet blanks{" \t"};

/// Collects one setting's lines; hands them over when the next setting begins.
class ValueReader {
public:
    void begin(std::string_view key) {
        end();
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

    void end() const {
        if (!key_.empty()) {
            settingByKey(key_, value_);
        }
    }

private:
    std::string key_;
    std::string value_;
};

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
    const int result =
        masterFile.read(path, [](const std::string &bytes) { parseMasterConfig(bytes); });
    if (result == 1) {
        std::printf("Couldn't open config file:%s\n", path);
        std::fflush(stdout);
    }
    return result;
}

void writeMasterConfig() {
    try {
        const FileRead masterTemplate = readWholeFile(productPaths().masterTemplate);
        if (const std::optional<std::string> &lines = masterTemplate.bytes) {
            masterFile.rewrite(
                productPaths().master,
                [&lines](std::string &bytes) { formatMasterConfig(*lines, bytes); }, newFileMode);
        }
    } catch (const std::bad_alloc &) { // Like every failed write: nothing is reported.
    }
}
