// The settings with everything that reading them takes: a map for a store, a clock set by hand, a machine with two
// network adapters.
#pragma once

#include "shell/settings_registry.h"
#include "tests/support/map_settings_store.h"
#include "tests/support/recording_host.h"

#include <QFile>

struct SettingsRig {
    bool read() { return ZephReadRegistryDefaults(context, settings, connection, adapters); }
    void write(bool writeShutDownTime = false) { ZephWriteClosingRegistry(context, settings, writeShutDownTime); }
    // Reads what the last write stored into a record of its own.
    ZephSettings readBack() {
        ZephSettings back;
        Connection link;
        EXPECT_TRUE(ZephReadRegistryDefaults(context, back, link, adapters));
        return back;
    }
    // With the same surroundings.
    RegistryContext on(SettingsStore& other) { return {other, clock, paths, failures, host, context.lister}; }

    MapSettingsStore store;
    ManualClock clock{100'000};
    ZephPathService paths{"/data/Zeph"};
    CollectingFailures failures;
    RecordingHost host;
    std::vector<ZephAdapter> machine{{"Stage", "192.168.1.20"}, {"Spare", "0.0.0.0"}};
    RegistryContext context{store, clock, paths, failures, host, [this] { return machine; }};

    ZephSettings settings;
    Connection connection;
    ZephAdapters adapters;
};

// The lines of a table beside the tests, without remarks.
inline QStringList tableLines(const char* name) {
    QFile file(QString(ZEPH_TEST_DATA "/") + name);
    EXPECT_TRUE(file.open(QIODevice::ReadOnly)) << name;
    QStringList lines = QString::fromUtf8(file.readAll()).split('\n', Qt::SkipEmptyParts);
    lines.removeIf([](const QString& line) { return line.startsWith('#'); });
    return lines;
}
