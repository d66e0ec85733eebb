// Where settings are kept: named strings under a key. Names and keys are told apart without regard to case; the
// spelling of the last write is kept. The program's store is a file of the user; a test's is a map.
#pragma once

#include <QSettings>

#include <map>
#include <optional>
#include <string>
#include <string_view>

// Keys of the store.
inline constexpr std::string_view kSettingsKey = "Software\\Kalvora\\Zeph\\Settings";
inline constexpr std::string_view kSharedIpcKey = "Software\\Kalvora\\Shared\\VisIPC";

class SettingsStore {
public:
    virtual ~SettingsStore() = default;

    // Nothing where there is no such value.
    virtual std::optional<std::string> value(std::string_view key, std::string_view name) const = 0;
    virtual void setValue(std::string_view key, std::string_view name, std::string_view text) = 0;
    // Removes the key with all its values.
    virtual void removeKey(std::string_view key) = 0;
    // Brings what was written to where the next run, or another process, reads it, and takes in what others wrote
    // since the store was opened. False where that failed.
    virtual bool flush() = 0;
    // Why the store as a whole could not be read, for the log; empty = it could.
    virtual std::string problem() const = 0;
};

// An INI file with one section a key; see docs/files.md. QSettings writes it whole, under a lock, so that two processes
// may share it: each changes only the values that it set.
class FileSettingsStore : public SettingsStore {
public:
    // file: full path; neither it nor its folder need exist.
    explicit FileSettingsStore(const std::string& file);

    // This user's file: "settings.ini" in $ZEPH_DATA if that is set, else in "Zeph" under the platform's folder for
    // configuration.
    static std::string userFile();

    std::optional<std::string> value(std::string_view key, std::string_view name) const override;
    void setValue(std::string_view key, std::string_view name, std::string_view text) override;
    void removeKey(std::string_view key) override;
    bool flush() override;
    std::string problem() const override { return problem_; }

private:
    void listNames();

    QSettings file_;
    std::map<QString, QString> spelling_;  // in lower case -> as it stands in the file
    std::string problem_;
};
