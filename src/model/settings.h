// Every preference of the user, one record, each with its default. A field is the name of the stored value without
// its blanks; ranges stand behind it. Read once at start-up, written at exit; the program reads only this record.
#pragma once

#include <array>
#include <cstdint>
#include <string>

struct ZephSettings {
    // Window and general numbers
    std::int32_t Left = 0;            // window position, twips
    std::int32_t Top = 0;             // window position, twips
    std::int32_t Width = 20970;       // window size, twips
    std::int32_t Height = 16095;      // window size, twips
    std::int32_t State = 0;           // 0 normal, 1 minimised, 2 maximised
    std::int32_t OnStartup = 0;       // row 0..2 of the start-up action table
    std::int32_t BulbSize = 2;        // 1..16
    std::int32_t BulbSpacing = 2;     // 0..64
    std::int32_t BulbShape = 1;       // 1..11
    std::int32_t KeshBulbShape = 11;  // always the pixel bulb
    std::int32_t FloodSize = 32;      // 1..64
    std::int32_t FloodOpacity = 50;   // 5..100
    std::int32_t ZOrder = 1;          // 0..16
    std::int32_t AutoSave = 0;        // minutes, 0 = never
    std::int32_t ShowGrid = 0;        // row 0..4 of the grid line table
    std::int32_t GridDensity = 1;     // 1..20
    std::int32_t GridColor = 0;
    std::int32_t FixtureTextColor = 0;
    std::int32_t ToolHandleColor = 255;
    std::int32_t VertexHandleColor = 65280;
    std::int32_t SampleBackgroundColor = 0;
    std::int32_t SampleRGBColor = 0;
    std::int32_t DefaultChannelType = 1;        // 1..2
    std::int32_t FixtureTextLocation = 1;       // row 0..7 of the fixture text location table
    std::int32_t LastOptsTab = 0;               // 0..5
    std::int32_t SimulationPort = 30303;        // 0..65535
    std::int32_t StrobeFireTime = 50;           // ms, 0..100
    std::int32_t DrawPixelQty = 2;              // 2..500
    std::int32_t ToolTipsPixelFlash = 5;        // 1..25, x 40 ms
    std::int32_t ToolTipsNumAsgnChannels = 16;  // 0..16
    std::int32_t ToolTipsNumAsgnFixtures = 64;  // 0..64

    // General flags
    bool ConfirmDeletes = true;             // ask before a delete
    bool LEDDefault = false;                // new channels are LED
    bool PropertiesOnNewFixture = true;     // show the fixture dialog after creating a fixture
    bool PropertiesOnEditorSelect = false;  // ... after selecting in the editor
    bool PropertiesOnListSelect = false;    // ... after selecting in the list
    bool PropertiesOnAddPoints = true;      // ... after adding points
    bool PropertiesOnObjectUndo = true;     // kept and shown; without effect
    bool PropertiesOnWizardUse = true;      // show the prop dialog after a wizard made fixtures
    bool AssumeNewObject = false;           // false "Ask", true "Always"
    bool AlwaysShowPropNames = false;
    bool SimplePropDisplay = true;
    bool ReferenceFileWarning = false;  // no "Load Another" reminder
    bool BulbSizeWarning = false;       // no minimum bulb size warning
    bool KeshBulbCountWarning = false;  // no warning about a wrong ribbon pixel count
    bool EditInColor = true;            // draw the editor in the channels' colours
    bool ShowPixelOrder = true;
    bool BackgroundWarning = false;       // no background warning
    bool EndStopsSimulation = true;       // closing the window only ends a simulation
    bool NoCorruptFileWarning = false;    // stored and shown; no message depends on it
    bool DisableFixtureText = false;      // no fixture names
    bool CheckFileExtension = true;       // stored and shown; no effect
    bool ForceSimulationForward = false;  // bring the simulation to the front when a sequence starts
    bool AdvancedRenderEngine = true;     // true OpenGL, false the drawing engine
    bool UseTCP = false;                  // each run starts on UDP, whatever was stored
    bool ChannelDefaultName = false;      // new channel names use the fixture name
    bool ChannelDefaultOrderNum = false;  // ... the channel number
    bool ChannelDefaultRGBColor = false;  // ... the colour name
    bool NoFixtureNamesDuringSelection = false;

    // What the wizards were last given
    std::int32_t ArchWizardType = 0;                // 0..1
    std::int32_t ArchWizardSize = 50;               // 10..100
    std::int32_t ArchWizardFirstLocation = 0;       // 0..1
    std::int32_t ArchWizardSegments = 7;            // 1..64
    std::int32_t ArchWizardChannelType = 0;         // 0..2
    std::int32_t ArchWizardPixelsPerSegment = 2;    // 2..50
    std::int32_t ArchWizardFillDensity = 5;         // 1..10
    std::int32_t TreeWizardSize = 50;               // 25..150
    std::int32_t TreeWizardTopSize = 50;            // 0..150
    std::int32_t TreeWizardXRot = 75;               // 0..180
    std::int32_t TreeWizardYRot = 0;                // -89..89
    std::int32_t TreeWizardHeight = 100;            // 25..150
    std::int32_t TreeWizardType = 1;                // 0..1
    std::int32_t TreeWizardBundleType = 0;          // 0..12
    std::int32_t TreeWizardFirstLocation = 0;       // 0..1
    std::int32_t TreeWizardNumberOfBundles = 8;     // 4..64
    std::int32_t TreeWizardConsecutiveBundles = 1;  // 1..32
    std::int32_t TreeWizardChannelType = 0;         // 0..1
    std::int32_t TreeWizardPixelsPerSegment = 2;    // 2..170
    std::int32_t MatrixWizardBulbSize = 2;          // 1..16
    std::int32_t MatrixWizardChannelType = 1;       // 1..2
    std::int32_t MatrixWizardHorizSpacing = 5;      // 1..50
    std::int32_t MatrixWizardVertSpacing = 5;       // 1..50
    std::int32_t MatrixWizardPixelHeight = 10;      // 1..170
    std::int32_t MatrixWizardPixelWidth = 10;       // 1..170
    std::int32_t MatrixWizardOrientation = 1;       // 0..1
    std::int32_t MatrixWizardOrigin = 0;            // 0..3
    bool ArchWizardOptionFillFan = false;
    bool ArchWizardCenterToEdge = false;
    bool ArchWizardCorrectArch = true;
    bool TreeWizardOptionCC = false;
    bool TreeWizardOptionBaseLights = true;
    bool MatrixWizardSnakePattern = false;
    bool MatrixWizardShowFlow = false;

    // Lines of the object tip
    bool ToolTipsShow = true;
    bool ToolTipsAlwaysShowFixture = true;
    bool ToolTipsAsgnProp = true;
    bool ToolTipsKeshHardware = true;
    bool ToolTipsKeshModes = true;
    bool ToolTipsKeshResolution = true;
    bool ToolTipsComment = true;
    bool ToolTipsLevel = true;
    bool ToolTipsLock = true;
    bool ToolTipsName = true;
    bool ToolTipsOpacity = true;
    bool ToolTipsPoints = true;
    bool ToolTipsPropComment = true;
    bool ToolTipsPropLock = true;
    bool ToolTipsPropName = true;
    bool ToolTipsSize = true;
    bool ToolTipsType = true;

    // Text. Paths are held in full; the store holds their stored form.
    std::string AdapterToUse;  // caption of the network adapter; empty = the first
    std::string LastFixtureFile;
    std::string LastPropFile;
    std::array<std::string, 4> RecentFiles;  // newest first, no gaps

    // The channel wizard
    std::array<std::int32_t, 16> ChannelWizardColorMask = [] {
        std::array<std::int32_t, 16> white;
        white.fill(16777215);
        return white;
    }();
    std::int32_t ChannelWizardRepeatingChannels = 1;  // 1..16

    bool operator==(const ZephSettings&) const = default;
};
