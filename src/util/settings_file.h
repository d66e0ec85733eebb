// The form of the settings file, as QSettings is told it: sections, and lines "name=value", all of it text. QSettings'
// own INI form is not used, since it builds objects out of what a damaged file holds, and comes down over some.
#pragma once

#include <QSettings>

// A line that is no "name=value" is kept as an entry without a value, so that comments and what could not be read
// survive the next write. Always true.
bool readSettingsFile(QIODevice& device, QSettings::SettingsMap& entries);
bool writeSettingsFile(QIODevice& device, const QSettings::SettingsMap& entries);

// Keys of entries are "section/name". Whether the entry is a line that should have been a value.
bool isIllegibleEntry(const QString& key, const QVariant& value);
