#include "shell/main_window.h"
#include "tests/shell/shell_rig.h"
#include "util/whole_file.h"

#include <QAbstractButton>
#include <QAction>
#include <QApplication>
#include <QLabel>
#include <QMessageBox>
#include <QTest>

namespace {

// Real boxes; a file dialog gives the next of a list, "" = cancelled.
struct ScriptedHost : WindowHost {
    QString askFile(const FileDialog& dialog, const QString&, bool) override {
        told.append(QString::fromUtf8(dialog.title.data()));
        return chosen.isEmpty() ? QString() : chosen.takeFirst();
    }
    QStringList chosen;
    QStringList told;
};

// The window with the display of the rig open. A box gets the next of the listed buttons clicked.
struct WindowDocuments : testing::Test {
    void SetUp() override {
        rig.start();
        rig.startUp(window);
        const auto display = std::make_unique<ZephSimulation>();
        ShellRig::buildDisplay(*display);
        file = rig.save(*display, "bulb.zee");
        window.show();
        ASSERT_TRUE(QTest::qWaitForWindowActive(&window));
        ASSERT_TRUE(window.openFile(QString::fromStdString(file), false));
        answering.setInterval(10);
        QObject::connect(&answering, &QTimer::timeout, &window, [this] { answer(); });
        answering.start();
    }
    void answer() {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        if (box == nullptr) return;
        host.told.append(box->windowTitle() + "|" + box->text());
        const QString next = clicks.isEmpty() ? "nobody expected it" : clicks.takeFirst();
        QAbstractButton* clicked = box->buttons().first();
        for (QAbstractButton* button : box->buttons()) {
            if (button->text().remove('&') == next) clicked = button;
        }
        EXPECT_EQ(clicked->text().remove('&').toStdString(), next.toStdString()) << box->text().toStdString();
        QTest::mouseClick(clicked, Qt::LeftButton);
    }
    void press(Qt::Key key, Qt::KeyboardModifiers held = Qt::ControlModifier) {
        QTest::keyClick(&window, key, held);
        QCoreApplication::processEvents();
    }
    QString path(const QString& name) const { return rig.folder.filePath(name); }
    QString panel(int number) { return window.findChild<QLabel*>(QString("StatusBar1Panel%1").arg(number))->text(); }
    QAction* action(const char* name) { return window.findChild<QAction*>(name); }
    ZephSimulation& document() { return *rig.program.simulation; }
    // The name of the only fixture in a file, as the file has it.
    std::string nameIn(const QString& full) {
        LoadBench reader;
        reader.simulation->FilePath = full.toStdString();
        reader.simulation->FileName.clear();
        EXPECT_TRUE(ZephLoadVisualizerXML(false, reader.context, *reader.simulation)) << full.toStdString();
        return reader.simulation->Fixtures[1].Name;
    }
    void change(const std::string& name) {
        document().Fixtures[1].Name = name;
        document().SimulationDirty = true;
    }

    ScriptedHost host;
    ShellRig rig{host};
    frmZephMain window{rig.program, host};
    std::string file;
    QTimer answering;
    QStringList clicks;
};

}  // namespace

TEST_F(WindowDocuments, SavesByKeyAndUnderANewName) {
    change("Changed");
    press(Qt::Key_S);
    EXPECT_EQ(nameIn(QString::fromStdString(file)), "Changed");
    EXPECT_FALSE(document().SimulationDirty);

    change("Elsewhere");
    press(Qt::Key_S, Qt::ControlModifier | Qt::ShiftModifier);
    EXPECT_EQ(document().FileName, "bulb.zee");
    EXPECT_TRUE(document().SimulationDirty);
    host.chosen = {path("porch")};  // gets its extension
    press(Qt::Key_S, Qt::ControlModifier | Qt::ShiftModifier);
    EXPECT_EQ(nameIn(path("porch.zee")), "Elsewhere");
    EXPECT_EQ(nameIn(QString::fromStdString(file)), "Changed");
    EXPECT_EQ(window.windowTitle(), "Qen Visualizer v1.0.0 -porch.zee");
    EXPECT_TRUE(action("mnuRecentFiles(0)")->text().endsWith("porch.zee"));
    EXPECT_TRUE(action("mnuRecentFiles(1)")->isVisible());
    // A name without its extension must not run over the file that has it.
    host.told.clear();
    host.chosen = {path("bulb"), ""};
    clicks = {"No"};
    press(Qt::Key_S, Qt::ControlModifier | Qt::ShiftModifier);
    EXPECT_EQ(host.told.join("; ").toStdString(),
              "Save File; Save File|" + file + " already exists.\nDo you want to replace it?; Save File");
    EXPECT_EQ(nameIn(QString::fromStdString(file)), "Changed");
}

TEST_F(WindowDocuments, InsertsUndoesAndRedoesByKey) {
    ASSERT_TRUE(replaceWholeFile(path("star.zff").toStdString(),
                                 "<ZephFixture zephSaveFileVersion=\"1.5.2\"><DrawObjects><DrawObject ID=\"1\" "
                                 "Name=\"Star\" BulbSize=\"2\" BulbSpacing=\"2\" Comment=\"\" BulbShape=\"1\" "
                                 "ZOrder=\"1\" AssignedItem=\"0\" Locked=\"False\"/></DrawObjects></ZephFixture>"));
    host.chosen = {path("star.zff")};
    press(Qt::Key_F, Qt::ControlModifier | Qt::ShiftModifier);
    ASSERT_EQ(document().FixtureCount, 2);
    EXPECT_EQ(panel(2), "Fixture Selected:Star - Layer:1");
    EXPECT_EQ(action("mnuUndo")->text(), "Undo Inserted Fixture ");
    press(Qt::Key_Z);
    EXPECT_EQ(document().FixtureCount, 1);
    EXPECT_EQ(panel(2), "Undo of last action");
    EXPECT_FALSE(action("mnuUndo")->isEnabled());
    press(Qt::Key_Y);
    EXPECT_EQ(document().FixtureCount, 2);
    // Another document: nothing of it can be undone, but redo would bring the old one back.
    press(Qt::Key_Z);
    ASSERT_TRUE(window.openFile(QString::fromStdString(file), false));
    EXPECT_FALSE(action("mnuUndo")->isEnabled());
    EXPECT_EQ(action("mnuRedo")->toolTip(), "Redo: Inserted Fixture ");
    EXPECT_TRUE(action("mnuRedo")->isEnabled());
}

TEST_F(WindowDocuments, SavesItselfWhereTheStateAllowsIt) {
    auto* timer = window.findChild<QTimer*>("tmrAutoSave");
    ASSERT_EQ(timer->interval(), 600);
    rig.program.settings.AutoSave = 1;
    press(Qt::Key_F2, Qt::NoModifier);
    change("By itself");
    rig.program.autosave.Tag = 59;
    timer->setInterval(1);
    QTest::qWait(50);
    EXPECT_TRUE(document().SimulationDirty) << "not while props are selected";
    press(Qt::Key_F3, Qt::NoModifier);
    ASSERT_TRUE(QTest::qWaitFor([this] { return !document().SimulationDirty; }));
    timer->stop();
    EXPECT_EQ(nameIn(QString::fromStdString(file)), "By itself");
    EXPECT_EQ(panel(2), "Select Fixture");
    rig.program.autosave.Tag = 40;
    ASSERT_TRUE(window.openFile(QString::fromStdString(file), false));
    EXPECT_EQ(rig.program.autosave.Tag, 0);
}

TEST_F(WindowDocuments, ClosesOnceTheWorkIsSaved) {
    change("Kept");
    document().FileName.clear();
    clicks = {"Yes"};
    EXPECT_FALSE(window.close()) << "nothing was chosen to save under";
    EXPECT_TRUE(document().SimulationDirty);
    host.chosen = {path("gone/kept.zee")};
    clicks = {"Yes", "OK"};
    EXPECT_FALSE(window.close()) << "the folder is not there";
    EXPECT_EQ(host.told.back(),
              "Qen Visualizer-Save Error|There was a problem saving the editor data to disk.  Please try "
              "again.");
    EXPECT_TRUE(document().SimulationDirty) << "asked again the next time";
    document().FileName.clear();
    host.chosen = {path("kept.zee")};
    clicks = {"Yes"};
    EXPECT_TRUE(window.close());
    EXPECT_EQ(nameIn(path("kept.zee")), "Kept");
}

TEST_F(WindowDocuments, AnOlderFileIsBackedUpBeforeItIsClosed) {
    const std::string old = "<Zeph zephSaveFileVersion=\"2.1.0\"/>";
    ASSERT_TRUE(replaceWholeFile(file, old));
    ASSERT_TRUE(window.openFile(QString::fromStdString(file), false));
    document().SimulationDirty = true;
    clicks = {"Yes", "OK"};
    EXPECT_TRUE(window.close());
    QFile backup(path("bulb.zee.bak0001"));
    ASSERT_TRUE(backup.open(QIODevice::ReadOnly));
    EXPECT_EQ(backup.readAll().toStdString(), old);
}
