#include "config/masterfile.h"

#include "base/textfile.h"
#include "config/productpaths.h"
#include "config/settings.h"

#include <cstdio>
#include <new>

namespace {

constexpr char commentMark = '|';
constexpr char keyMark = '%';
constexpr ByteSet blanks{" \t"};

std::string_view withoutLeadingBlanks(std::string_view text) {
    return text.substr(blanks.lengthOf(text));
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

/// A template's key line with the store's value, or as it is.
MasterLine keyLine(std::string_view line) {
    const std::size_t colon = beforeNul(line).find(':');
    if (colon != std::string_view::npos) {
        if (auto value = settingByKey(std::string{line.substr(1, colon - 1)}, std::nullopt)) {
            return {line.substr(0, colon), std::move(value)};
        }
    }
    return {line, std::nullopt};
}

void putValue(ByteSink &sink, std::string_view value) {
    sink.put(": ");
    for (std::size_t comma = 0; (comma = value.find(',')) != std::string_view::npos;) {
        sink.put(value.substr(0, comma));
        sink.put("\n\t");
        value.remove_prefix(comma + 1);
    }
    sink.put(value);
    sink.put('\n');
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

std::vector<MasterLine> masterLines(std::string_view masterTemplate) {
    std::vector<MasterLine> filled;
    LinePieces lines{masterTemplate};
    while (const std::optional<std::string_view> line = lines.next()) {
        if (line->front() == commentMark) {
            filled.push_back({*line, std::nullopt});
        } else if (line->front() == keyMark) {
            filled.push_back(keyLine(*line));
        }
    }
    return filled;
}

void formatMasterConfig(const std::vector<MasterLine> &lines, ByteSink &sink) {
    for (const MasterLine &line : lines) {
        sink.put(line.text);
        if (line.value) {
            putValue(sink, *line.value);
        }
    }
}

int readMasterConfig() {
    const char *path = productPaths().master;
    std::optional<FileBytes> bytes;
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
            const std::vector<MasterLine> lines = masterLines(*masterTemplate);
            rewriteFile(productPaths().master,
                        [&lines](ByteSink &sink) { formatMasterConfig(lines, sink); });
        }
    } catch (const std::bad_alloc &) { // Like every failed write: nothing is reported.
    }
}
