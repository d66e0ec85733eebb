#include "util/whole_file.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include <gtest/gtest.h>

namespace {

struct Folder {
    QTemporaryDir folder;
    std::string path = folder.filePath("file").toStdString();

    std::string text() const {
        QFile file(QString::fromStdString(path));
        return file.open(QIODevice::ReadOnly) ? file.readAll().toStdString() : "not there";
    }
    qsizetype files() const { return QDir(folder.path()).entryList(QDir::Files | QDir::Hidden).size(); }
};

}  // namespace

TEST(WholeFile, ShowsTheNewBytesOnlyWhenAllAreThere) {
    Folder folder;
    ASSERT_TRUE(replaceWholeFile(folder.path, "old"));
    {
        WholeFile given(folder.path);
        given.append("half");
        EXPECT_EQ(folder.text(), "old");
    }
    EXPECT_EQ(folder.text(), "old");
    EXPECT_EQ(folder.files(), 1) << "what was given up leaves nothing beside it";
    WholeFile file(folder.path);
    file.append("the ___ ");
    file.overwrite(4, "new");
    file.append("bytes");
    EXPECT_TRUE(file.commit());
    EXPECT_EQ(folder.text(), "the new bytes");
}

TEST(WholeFile, RefusesWhatMayNotBeWritten) {
    Folder folder;
    ASSERT_TRUE(replaceWholeFile(folder.path, "old"));
    ASSERT_TRUE(QFile::setPermissions(QString::fromStdString(folder.path), QFile::ReadOwner));
    EXPECT_FALSE(replaceWholeFile(folder.path, "new")) << "even for who may do everything";
    EXPECT_EQ(folder.text(), "old");
    EXPECT_FALSE(replaceWholeFile(folder.folder.path().toStdString(), "new"));
    EXPECT_FALSE(replaceWholeFile(folder.path + "/below", "new"));
    EXPECT_EQ(folder.files(), 1);
}
