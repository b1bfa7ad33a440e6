#include "config/settingvalues.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <cstdlib>
#include <strings.h>

namespace {

constexpr std::int32_t byteMask = 0xff;

struct BooleanWord {
    const char *word;
    std::int32_t value;
};

constexpr std::array<BooleanWord, 6> booleanWords{
    {{"yes", 1}, {"no", 0}, {"true", 1}, {"false", 0}, {"on", 1}, {"off", 0}}};

/// The integer's low 32 bits as they would be stored.
std::int32_t wrapped(std::int64_t number) {
    return static_cast<std::int32_t>(static_cast<std::uint32_t>(number));
}

std::int32_t parseBoolean(const std::string &text) {
    if (text == "0") {
        return 0;
    }
    for (const BooleanWord &known : booleanWords) {
        if (compareNoCase(text.c_str(), known.word) == 0) {
            return known.value;
        }
    }
    return 1;
}

std::int32_t parseTime(std::string_view text) {
    std::size_t separator = std::string_view::npos;
    for (const char candidate : {':', ',', ';', ' '}) {
        separator = text.find(candidate);
        if (separator != std::string_view::npos) {
            break;
        }
    }
    const std::int32_t minute =
        separator == std::string_view::npos ? 0 : parseInteger(text.substr(separator + 1));
    return (parseInteger(text) & byteMask) * 256 + (minute & byteMask);
}

} // namespace

std::optional<std::string> textSetting(std::optional<std::string> &field, TextOrNone text) {
    if (!text) {
        return field;
    }
    field.reset();
    field.emplace(*text);
    return std::nullopt;
}

std::optional<std::string> numberSetting(std::int32_t &field, TextOrNone text, int scale) {
    scale = std::max(scale, 1);
    if (!text) {
        return std::to_string(field / scale);
    }
    field = wrapped(std::int64_t{parseInteger(*text)} * scale);
    return std::nullopt;
}

std::optional<std::string> boolSetting(std::int32_t &field, TextOrNone text) {
    if (!text) {
        return field != 0 ? "yes" : "no";
    }
    field = parseBoolean(std::string{*text});
    return std::nullopt;
}

std::optional<std::string> timeSetting(std::int32_t &field, TextOrNone text) {
    if (!text) {
        std::array<char, sizeof "255:255"> hourAndMinute{};
        std::snprintf(hourAndMinute.data(), hourAndMinute.size(), "%2d:%2d",
                      (field >> 8) & byteMask, field & byteMask);
        return hourAndMinute.data();
    }
    field = parseTime(*text);
    return std::nullopt;
}

std::optional<std::string> accessListSetting(std::optional<AccessList> &field, TextOrNone text) {
    if (!text) {
        return field ? formatAccessList(*field) : std::string{};
    }
    field.reset();
    field = parseAccessList(*text);
    return std::nullopt;
}

int compareNoCase(const char *a, const char *b) {
    if (a == nullptr || b == nullptr) {
        return -1;
    }
    return std::clamp(::strcasecmp(a, b), -1, 1);
}

std::string formatUnsigned(std::uint32_t value) { return std::to_string(value); }

std::int32_t parseInteger(std::string_view text) {
    // atoi itself may do anything with a number that is too large; this is what it does here.
    return wrapped(std::strtoll(std::string{text}.c_str(), nullptr, 10));
}
