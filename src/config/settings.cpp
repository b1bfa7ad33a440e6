#include "config/settings.h"

namespace {

/// What equal keys have in common whatever the locale holds for one letter in two cases: their
/// length, and where the dots are.
std::size_t shapeOf(std::string_view key) {
    const auto place = [](std::size_t dot) { return (dot + 1) & 0xff; };
    return (key.size() << 16) + (place(key.find('.')) << 8) + place(key.rfind('.'));
}

} // namespace

Setting::Setting(SettingTable &table, const char *key) : key_{key} {
    table.byShape_[shapeOf(key)].push_back(this);
    table.all_.push_back(this);
}

Setting *SettingTable::find(const std::string &key) const {
    const auto sameShape = byShape_.find(shapeOf(key.c_str()));
    if (sameShape != byShape_.end()) {
        for (Setting *setting : sameShape->second) {
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
