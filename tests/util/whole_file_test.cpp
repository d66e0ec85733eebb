#include "tests/support/folder.h"
#include "util/whole_file.h"

TEST(WholeFile, ShowsTheNewBytesOnlyWhenAllAreThereAndRefusesWhatMayNotBeWritten) {
    const Folder folder;
    folder.write("file", "old");
    {
        WholeFile given(folder.path("file"));
        given.append("half");
    }
    EXPECT_EQ(folder.read("file"), "old");
    EXPECT_EQ(folder.files(), 1) << "what was given up leaves nothing beside it";
    WholeFile file(folder.path("file"));
    file.append("the ___ ");
    file.overwrite(4, "new");
    file.append("bytes");
    EXPECT_TRUE(file.commit());
    EXPECT_EQ(folder.read("file"), "the new bytes");

    folder.protect("file");
    for (const char* name : {"file", "", "file/below"})
        EXPECT_FALSE(replaceWholeFile(folder.path(name), "newest")) << name << ", even for who may do everything";
    EXPECT_EQ(folder.read("file"), "the new bytes");
    EXPECT_EQ(folder.files(), 1);
}
