#include "shell/recent_files.h"
#include "shell/window_place.h"

TEST(RecentFiles, TheLastUsedStandsFirstAndTheOldestFallsOff) {
    using Files = std::array<std::string, 4>;
    const std::pair<const char*, Files> steps[] = {
        {"/a.zee", {"/a.zee", "", "", ""}},
        {"/b.zee", {"/b.zee", "/a.zee", "", ""}},
        {"/A.ZEE", {"/A.ZEE", "/b.zee", "", ""}},
        {"/a.zee", {"/A.ZEE", "/b.zee", "", ""}},  // the first already: nothing changes
        {"/c.zee", {"/c.zee", "/A.ZEE", "/b.zee", ""}},
        {"/d.zee", {"/d.zee", "/c.zee", "/A.ZEE", "/b.zee"}},
        {"/e.zee", {"/e.zee", "/d.zee", "/c.zee", "/A.ZEE"}},
        {"/a.zee", {"/a.zee", "/e.zee", "/d.zee", "/c.zee"}},
        {"", {"/a.zee", "/e.zee", "/d.zee", "/c.zee"}},
    };
    ZephSettings settings;
    for (const auto& [used, list] : steps) {
        ZephUpdateRecentFilesList(used, settings);
        EXPECT_EQ(settings.RecentFiles, list) << used;
    }
}

TEST(RecentFiles, ALongPathIsCutInItsMiddle) {
    const std::tuple<int, const char*, const char*, const char*> rows[] = {
        {35, "/home/ann", "show.zee", "/home/ann/show.zee"},
        {35, "/home/ann/show.zee", "", "/home/ann/show.zee"},
        {18, "/home/ann/", "show.zee", "/home/ann/show.zee"},
        {17, "/home/ann/", "show.zee", "/home...\\show.zee"},
        {11, "/home/ann/", "show.zee", "show.zee..."},
        {12, "C:\\shows\\old", "ä.zee", "C:\\...\\ä.zee"},
        {15, "/日本語日本語日本語/", "語.zee", "/日本語日本...\\語.zee"},
        {2, "/home/", "show.zee", "..."},
    };
    for (const auto& [most, folder, name, shown] : rows)
        EXPECT_EQ(ZephDisplayFileName(most, folder, name), shown) << most;
    const ZephPathService paths("/data/Zeph");
    ZephSettings settings;
    settings.RecentFiles = {"/data/Zeph/Editor/a.zee", "/home/ann/lights/of/this/and/last/year/b&c.zee", "", ""};
    EXPECT_EQ(ZephRecentFileCaptions(settings, paths),
              (std::vector<std::string>{"&1 <base>/Editor/a.zee", "&2 /home/ann/lights/of/this...\\b&&c.zee"}));
}

TEST(RecentFiles, ASingleOneIsNotOpenedByItself) {
    ZephSettings settings;
    settings.RecentFiles = {"/a.zee", "/b.zee", "", ""};
    EXPECT_EQ(ZephStartupAction(settings), StartupAction::Nothing);
    settings.OnStartup = 1;
    EXPECT_EQ(ZephStartupAction(settings), StartupAction::ShowOpenDialog);
    settings.OnStartup = 2;
    EXPECT_EQ(ZephStartupAction(settings), StartupAction::OpenNewest);
    for (const std::size_t gone0 : {1U, 0U}) {
        settings.RecentFiles[gone0].clear();
        EXPECT_EQ(ZephStartupAction(settings), StartupAction::ShowOpenDialog);
    }
}

TEST(WindowPlace, ComesBackWhereItWasUnlessTheScreenIsGone) {
    const QRect screen(0, 30, 1920, 1050);
    ZephSettings settings;
    ZephKeepWindowPlace({100, 200, 800, 600}, 2, settings);
    EXPECT_EQ(settings.Left, 1500);
    EXPECT_EQ(settings.State, 2);
    EXPECT_EQ(ZephWindowPlace(settings, screen), QRect(100, 200, 800, 600));

    settings.Left = settings.Top = std::numeric_limits<std::int32_t>::max();
    EXPECT_EQ(ZephWindowPlace(settings, screen), QRect(1120, 480, 800, 600));
    settings = {};
    EXPECT_EQ(ZephWindowPlace(settings, screen), QRect(0, 30, 1398, 1050));  // taller than the screen
}
