#include "framework/base/exceptions.h"
#include "framework/controls/navigator/fileChoice.h"
#include "framework/controls/navigator/folderList.h"
#include "tests/support/temporaryFolder.h"

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
    void File(const char *name) const { std::ofstream(path / name) << "x"; }

    const TestSupport::temporaryFolder own;
    const fs::path path = own.path();
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

TEST_F(Folder, DecidesAboutATypedName)
{
    File("there.dbw");
    File("other.txt");
    fs::create_directory(path / "sub");
    fs::create_directory(path / "locked.dbw");
    const std::string here = path.string();
    using outcome = CFileChoice::outcome;

    EXPECT_EQ(choiceToOpen(here, "there.dbw"), (CFileChoice{outcome::take, here + "/there.dbw", {}}));
    EXPECT_EQ(choiceToOpen(here, "sub/.."), (CFileChoice{outcome::enterFolder, here, {}}));
    EXPECT_EQ(choiceToOpen(here, "none.dbw").what, outcome::refuse);
    EXPECT_EQ(choiceToOpen(here, "/dev/null").message, "\"null\" is not a file.");

    const CFileType workspace{"Workspace", {"dbw"}};
    EXPECT_EQ(choiceToSave(here, "new", workspace), (CFileChoice{outcome::take, here + "/new.dbw", {}}));
    EXPECT_EQ(choiceToSave(here, "new.DBW", workspace), (CFileChoice{outcome::take, here + "/new.DBW", {}}));
    EXPECT_EQ(choiceToSave(here, "there", workspace).what, outcome::askToReplace);
    EXPECT_EQ(choiceToSave(here, "other.txt", workspace), (CFileChoice{outcome::take, here + "/other.txt.dbw", {}}));
    EXPECT_EQ(choiceToSave(here, "sub", workspace).what, outcome::enterFolder);
    EXPECT_EQ(choiceToSave(here, "locked", workspace).what, outcome::refuse);
    EXPECT_EQ(choiceToSave(here, "none/", workspace).what, outcome::refuse);
    EXPECT_EQ(choiceToSave(here, "none/new", workspace).what, outcome::refuse);

    const CFileType png{"PNG", {"png"}}, any{"All", {}};
    EXPECT_EQ(choiceToSave(here, "new.PNG", workspace, {workspace, png, any}).path, here + "/new.PNG");
    EXPECT_EQ(choiceToSave(here, "new.txt", workspace, {workspace, png, any}).path, here + "/new.txt.dbw");
    EXPECT_EQ(nameForType("a.dbw", png, {workspace, png, any}), "a.png");
    EXPECT_EQ(nameForType("a.b", png, {workspace, png, any}), "a.b.png");
    EXPECT_EQ(nameForType("a.dbw", any, {workspace, any}), "a.dbw");
    EXPECT_EQ(nameForType("", png, {workspace}), "");
}

} // namespace
} // namespace Sarnik
