#include "config/settings.h"

#include <algorithm>

Setting::Setting(SettingTable &table, const char *key) : key_{key} { table.all_.push_back(this); }

Setting *SettingTable::find(const std::string &key) const {
    const auto found = std::ranges::find_if(all_, [&key](const Setting *setting) {
        return compareNoCase(key.c_str(), setting->key()) == 0;
    });
    return found == all_.end() ? nullptr : *found;
}

Settings &settings() {
    static Settings store;
    return store;
}

std::optional<std::string> settingByKey(const std::string &key, TextOrNone text) {
    Setting *setting = settings().find(key);
    return setting == nullptr ? std::nullopt : setting->exchange(text);
}
