#include "config/settings.h"

Setting::Setting(SettingTable &table, const char *key) : key_{key} { table.all_.push_back(this); }

Settings &settings() {
    static Settings store;
    return store;
}

std::optional<std::string> settingByKey(const std::string &key, TextOrNone text) {
    for (Setting *setting : settings().all()) {
        if (compareNoCase(key.c_str(), setting->key()) == 0) {
            return setting->exchange(text);
        }
    }
    return std::nullopt;
}
