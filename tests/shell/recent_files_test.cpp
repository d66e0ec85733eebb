#include "shell/recent_files.h"
#include "shell/window_place.h"

using Files = std::array<std::string, 4>;

TEST(RecentFiles, TheLastUsedStandsFirstAndTheOldestFallsOff) {
    ZephSettings settings;
    ZephUpdateRecentFilesList("/a.zee", settings);
    ZephUpdateRecentFilesList("/b.zee", settings);
    ZephUpdateRecentFilesList("/c.zee", settings);
    EXPECT_EQ(settings.RecentFiles, (Files{"/c.zee", "/b.zee", "/a.zee", ""}));
    ZephUpdateRecentFilesList("/B.ZEE", settings);
    EXPECT_EQ(settings.RecentFiles, (Files{"/B.ZEE", "/c.zee", "/a.zee", ""}));
    ZephUpdateRecentFilesList("/b.zee", settings);  // the first already: nothing changes
    EXPECT_EQ(settings.RecentFiles, (Files{"/B.ZEE", "/c.zee", "/a.zee", ""}));
    ZephUpdateRecentFilesList("/d.zee", settings);
    ZephUpdateRecentFilesList("/e.zee", settings);
    EXPECT_EQ(settings.RecentFiles, (Files{"/e.zee", "/d.zee", "/B.ZEE", "/c.zee"}));
    ZephUpdateRecentFilesList("/c.zee", settings);
    EXPECT_EQ(settings.RecentFiles, (Files{"/c.zee", "/e.zee", "/d.zee", "/B.ZEE"}));
    ZephUpdateRecentFilesList("", settings);
    EXPECT_EQ(settings.RecentFiles[0], "/c.zee");
}

TEST(RecentFiles, ALongPathIsCutInItsMiddle) {
    struct Case {
        int most;
        const char* folder;
        const char* name;
        const char* shown;
    };
    for (const Case& each : {
             Case{35, "/home/ann/", "show.zee", "/home/ann/show.zee"},
             Case{35, "/home/ann", "show.zee", "/home/ann/show.zee"},
             Case{35, "/home/ann/show.zee", "", "/home/ann/show.zee"},
             Case{18, "/home/ann/", "show.zee", "/home/ann/show.zee"},
             Case{17, "/home/ann/", "show.zee", "/home...\\show.zee"},
             Case{13, "/home/ann/", "show.zee", "/...\\show.zee"},
             Case{12, "/home/ann/", "show.zee", "...\\show.zee"},
             Case{11, "/home/ann/", "show.zee", "show.zee..."},
             Case{10, "/home/ann/", "show.zee", "show.ze..."},
             Case{12, "C:\\shows\\old", "ä.zee", "C:\\...\\ä.zee"},
             Case{15, "/日本語日本語日本語/", "語.zee", "/日本語日本...\\語.zee"},
             Case{2, "/home/", "show.zee", "..."},
             Case{35, "", "show.zee", "show.zee"},
         }) {
        EXPECT_EQ(ZephDisplayFileName(each.most, each.folder, each.name), each.shown) << each.most << each.shown;
    }
}

TEST(RecentFiles, TheMenuNamesEachByItsStoredForm) {
    const ZephPathService paths("/data/Zeph");
    ZephSettings settings;
    EXPECT_TRUE(ZephRecentFileCaptions(settings, paths).empty());
    settings.RecentFiles = {"/data/Zeph/Editor/a.zee", "/home/ann/lights/of/this/and/last/year/b&c.zee", "", ""};
    EXPECT_EQ(ZephRecentFileCaptions(settings, paths),
              (std::vector<std::string>{"&1 <base>/Editor/a.zee", "&2 /home/ann/lights/of/this...\\b&&c.zee"}));
}

TEST(RecentFiles, ASingleOneIsNotOpenedByItself) {
    ZephSettings settings;
    EXPECT_EQ(ZephStartupAction(settings), StartupAction::Nothing);
    settings.OnStartup = 1;
    EXPECT_EQ(ZephStartupAction(settings), StartupAction::ShowOpenDialog);
    settings.OnStartup = 2;
    EXPECT_EQ(ZephStartupAction(settings), StartupAction::ShowOpenDialog);
    settings.RecentFiles[0] = "/a.zee";
    EXPECT_EQ(ZephStartupAction(settings), StartupAction::ShowOpenDialog);
    settings.RecentFiles[1] = "/b.zee";
    EXPECT_EQ(ZephStartupAction(settings), StartupAction::OpenNewest);
}

TEST(WindowPlace, ComesBackWhereItWasUnlessTheScreenIsGone) {
    const QRect screen(0, 30, 1920, 1050);
    ZephSettings settings;
    ZephKeepWindowPlace({100, 200, 800, 600}, 2, settings);
    EXPECT_EQ(settings.Left, 1500);
    EXPECT_EQ(settings.Height, 9000);
    EXPECT_EQ(settings.State, 2);
    EXPECT_EQ(ZephWindowPlace(settings, screen), QRect(100, 200, 800, 600));

    settings.Left = settings.Top = std::numeric_limits<std::int32_t>::max();
    EXPECT_EQ(ZephWindowPlace(settings, screen), QRect(1120, 480, 800, 600));
    settings = {};
    EXPECT_EQ(ZephWindowPlace(settings, screen), QRect(0, 30, 1398, 1050));  // taller than the screen
    settings.Width = std::numeric_limits<std::int32_t>::max();
    EXPECT_EQ(ZephWindowPlace(settings, screen), QRect(0, 30, 1920, 1050));
}
