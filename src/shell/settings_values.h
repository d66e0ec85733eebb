// Single values of the settings store: their conversion from and to text. Used by the reader and the writer of the
// settings, the tool bands, and whoever keeps a value of its own in the store.
#pragma once

#include "util/settings_store.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

// What a stored number may be.
struct LongRule {
    std::int32_t Default = 0;  // where there is none
    bool CheckRange = false;   // otherwise every number is good
    std::int32_t Min = 0;
    std::int32_t Max = 0;
    bool UseDefault = true;  // outside the range: the default, else Replacement
    std::int32_t Replacement = 0;
};

// section: the key of the store, key: the value's name. An absent or empty value gives the default. All three throw
// Failure with the value's name where the text is not of the kind; that is for the caller to report.
std::int32_t LoadZephLongRegValue(const SettingsStore& store, std::string_view section, std::string_view key,
                                  const LongRule& rule);
bool LoadZephBoolRegValue(const SettingsStore& store, std::string_view section, std::string_view key, bool fallback);
std::string LoadZephStringRegValue(const SettingsStore& store, std::string_view section, std::string_view key,
                                   std::string_view fallback);

// The roots of a registry. A user's file holds the current user's; of the others it holds what was written through
// this program.
enum class TopKey { CurrentUser, LocalMachine, Users, DynamicData, CurrentConfig, ClassesRoot };

// "HKCU", "HKLM", "HKU", "HKDD", "HKCC", "HKCR"; nothing for any other name.
std::optional<TopKey> fTopKey(std::string_view name);

struct RegistryValue {
    std::string_view Section;
    std::string_view Key;
    std::string_view Kind;  // "S" string, "B" flag, "D" word
    std::string_view Value;
};

// Writes a value under a root of the store. A topKey that is no root but names an existing file writes to that file,
// in the form of the store's own. Returns false, with nothing written, for any other topKey, another kind, or a
// value that is not of its kind; and where the file cannot be written.
bool fWriteValue(std::string_view topKey, const RegistryValue& value, SettingsStore& store);
