#include "shell/settings_values.h"

#include "util/failure.h"
#include "util/text.h"

#include <QFileInfo>

namespace {

// Damage can be long and hold anything; the log takes a line of it.
[[noreturn]] void refuse(std::string_view key, std::string_view kind, std::string_view text) {
    constexpr qsizetype kShown = 40;
    QString shown = QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()));
    if (shown.size() > kShown) shown = shown.left(kShown) + "...";
    for (QChar& letter : shown) {
        if (!letter.isPrint()) letter = '?';
    }
    std::string description = "the setting \"";
    description.append(key).append("\" is no ").append(kind).append(": \"").append(shown.toStdString()).append("\"");
    throw Failure(description);
}

struct NamedTopKey {
    std::string_view Name;
    TopKey Key;
};
constexpr std::array kTopKeys{NamedTopKey{"HKCU", TopKey::CurrentUser},   NamedTopKey{"HKLM", TopKey::LocalMachine},
                              NamedTopKey{"HKU", TopKey::Users},          NamedTopKey{"HKDD", TopKey::DynamicData},
                              NamedTopKey{"HKCC", TopKey::CurrentConfig}, NamedTopKey{"HKCR", TopKey::ClassesRoot}};

// The text in which a value of the kind is kept.
std::optional<std::string> storedText(std::string_view kind, std::string_view value) {
    if (kind == "S") return std::string(value);
    if (kind == "B") {
        const std::optional<bool> flag = parseFlag(value);
        if (flag) return *flag ? "True" : "False";
    }
    if (kind == "D") {
        const std::optional<std::int32_t> number = parseLong(value);
        if (number) return std::to_string(*number);
    }
    return std::nullopt;
}

}  // namespace

std::int32_t LoadZephLongRegValue(const SettingsStore& store, std::string_view section, std::string_view key,
                                  const LongRule& rule) {
    const std::optional<std::string> text = store.value(section, key);
    if (!text || text->empty()) return rule.Default;
    const std::optional<std::int32_t> number = parseLong(*text);
    if (!number) refuse(key, "whole number of 32 bits", *text);
    if (rule.CheckRange && (*number < rule.Min || *number > rule.Max)) {
        return rule.UseDefault ? rule.Default : rule.Replacement;
    }
    return *number;
}

bool LoadZephBoolRegValue(const SettingsStore& store, std::string_view section, std::string_view key, bool fallback) {
    const std::optional<std::string> text = store.value(section, key);
    if (!text || text->empty()) return fallback;
    const std::optional<bool> flag = parseFlag(*text);
    if (!flag) refuse(key, "flag", *text);
    return *flag;
}

std::string LoadZephStringRegValue(const SettingsStore& store, std::string_view section, std::string_view key,
                                   std::string_view fallback) {
    return store.value(section, key).value_or(std::string(fallback));
}

std::optional<TopKey> fTopKey(std::string_view name) {
    for (const NamedTopKey& row : kTopKeys) {
        if (row.Name == name) return row.Key;
    }
    return std::nullopt;
}

bool fWriteValue(std::string_view topKey, const RegistryValue& value, SettingsStore& store) {
    const std::optional<std::string> text = storedText(value.Kind, value.Value);
    if (!text) return false;
    const std::optional<TopKey> root = fTopKey(topKey);
    if (root == TopKey::CurrentUser) {
        store.setValue(value.Section, value.Key, *text);
        return true;
    }
    if (root) {
        store.setValue(std::string(topKey).append("\\").append(value.Section), value.Key, *text);
        return true;
    }
    const std::string file(topKey);
    if (!QFileInfo(QString::fromStdString(file)).isFile()) return false;
    FileSettingsStore profile(file);
    profile.setValue(value.Section, value.Key, *text);
    return profile.flush();
}
