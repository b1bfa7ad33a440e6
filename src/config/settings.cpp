#include "config/settings.h"

#include <cstring>

Setting::Setting(SettingTable &table, const char *key) : key_{key} {
    const std::size_t length = std::strlen(key);
    if (table.byLength_.size() <= length) {
        table.byLength_.resize(length + 1);
    }
    table.byLength_[length].push_back(this);
    table.all_.push_back(this);
}

Setting *SettingTable::find(const std::string &key) const {
    const std::size_t length = std::strlen(key.c_str());
    if (length < byLength_.size()) {
        for (Setting *setting : byLength_[length]) {
            if (compareNoCase(key.c_str(), setting->key()) == 0) {
                return setting;
            }
        }
    }
    return nullptr;
}

Settings &settings() {
    static Settings store;
    return store;
}

std::optional<std::string> settingByKey(const std::string &key, TextOrNone text) {
    Setting *setting = settings().find(key);
    return setting == nullptr ? std::nullopt : setting->exchange(text);
}
