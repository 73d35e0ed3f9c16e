#include "framework/base/exceptions.h"
#include "framework/navigator/folderList.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>

namespace Sarnik
{
namespace
{

using testing::ElementsAre;
namespace fs = std::filesystem;

struct Folder : testing::Test
{
    Folder()
    {
        fs::remove_all(path);
        fs::create_directories(path);
    }
    ~Folder() override { fs::remove_all(path); }
    void File(const char *name) const { std::ofstream(path / name) << "x"; }

    const fs::path path = fs::path(testing::TempDir()) / "folderList";
};

TEST_F(Folder, ListsFoldersAndFittingFilesInReadingOrder)
{
    for (const char *name : {"img10.dbw", "IMG9.DBW", "img009.knl", "photo.jpg", ".hidden.dbw", "plain", "b.png"})
        File(name);
    for (const char *name : {"zoo", "Attic", ".git"})
        fs::create_directory(path / name);
    fs::create_directory_symlink("zoo", path / "link");
    fs::create_symlink("nowhere.dbw", path / "broken.dbw");

    const auto names = [&](const std::vector<CFileType> &types) {
        std::vector<std::string> result;
        for (const CFolderEntry &entry : readFolder(path.string(), types))
            result.push_back(entry.isFolder ? entry.name + "/" : entry.name);
        return result;
    };
    EXPECT_THAT(names({{"Workspace", {"dbw"}}, {"Trace", {"knl"}}}),
                ElementsAre("Attic/", "link/", "zoo/", "IMG9.DBW", "img009.knl", "img10.dbw"));
    EXPECT_THAT(names({{"All", {}}}), ElementsAre("Attic/", "link/", "zoo/", "b.png", "IMG9.DBW", "img009.knl",
                                                  "img10.dbw", "photo.jpg", "plain"));
    EXPECT_THROW(readFolder((path / "none").string(), {}), CError);
    EXPECT_THROW(readFolder((path / "plain").string(), {}), CError);
}

TEST_F(Folder, UnderstandsWhatIsTyped)
{
    EXPECT_EQ(typedPath("/a/b", "c.dbw"), "/a/b/c.dbw");
    EXPECT_EQ(typedPath("/a/b", "../c//d/./"), "/a/c/d");
    EXPECT_EQ(typedPath("/a/b", "/x/../y"), "/y");
    EXPECT_EQ(typedPath("/a", "../../.."), "/");
    EXPECT_EQ(typedPath("/a/b", ""), "/a/b");
    EXPECT_EQ(typedPath("/a", "~"), typedPath("/b", "~/"));
    EXPECT_EQ(typedPath("/a", "~x"), "/a/~x");

    EXPECT_EQ(parentFolder("/a/b"), "/a");
    EXPECT_EQ(parentFolder("/"), "/");
    EXPECT_EQ(fileNameOf("/a/b.c"), "b.c");
    EXPECT_EQ(extensionOf("/a.d/B.DBW"), "dbw");
    EXPECT_EQ(extensionOf("/a.d/b"), "");
    EXPECT_EQ(extensionOf(".dbw"), "");
}

} // namespace
} // namespace Sarnik
