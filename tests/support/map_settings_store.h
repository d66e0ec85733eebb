// The settings store's test form: a map, as forgiving of case as the real one.
#pragma once

#include "util/settings_store.h"
#include "util/text.h"

#include <map>
#include <utility>

class MapSettingsStore : public SettingsStore {
public:
    std::optional<std::string> value(std::string_view key, std::string_view name) const override {
        const auto found = values.find(place(key, name));
        if (found == values.end()) return std::nullopt;
        return found->second;
    }
    void setValue(std::string_view key, std::string_view name, std::string_view text) override {
        values[place(key, name)] = text;
    }
    void removeKey(std::string_view key) override {
        std::erase_if(values, [&](const auto& entry) { return entry.first.first == lowerCase(key); });
    }
    bool flush() override {
        ++flushes;
        return true;
    }
    std::string problem() const override { return ""; }

    // Of the settings' own key, for tests.
    void set(std::string_view name, std::string_view text) { setValue(kSettingsKey, name, text); }
    std::string get(std::string_view name) const { return value(kSettingsKey, name).value_or("(absent)"); }

    std::map<std::pair<std::string, std::string>, std::string> values;  // key and name in lower case
    int flushes = 0;

private:
    static std::pair<std::string, std::string> place(std::string_view key, std::string_view name) {
        return {lowerCase(key), lowerCase(name)};
    }
};
