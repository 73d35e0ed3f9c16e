#include "framework/base/exceptions.h"
#include "framework/controls/navigator/navigatorWindow.h"
#include "framework/views/timer.h"
#include "tests/framework/views/stage.h"
#include "tests/support/temporaryFolder.h"

#include <filesystem>
#include <fstream>

namespace Sarnik::Test
{
namespace
{

using Platform::key;
namespace fs = std::filesystem;

/// A folder with files, and the window over it.
struct Navigator : stage
{
    Navigator()
    {
        fs::create_directory(folder / "sub");
        for (const char *name : {"a.dbw", "b.knl", "sub/c.dbw", "photo.jpg"})
            std::ofstream(folder / name) << "x";
    }

    CNavigatorWindow::request Opening() const
    {
        return {false, "Load", folder.string(), {}, {{"Workspace", {"dbw"}}, {"Blur Trace", {"knl"}}}, 0};
    }
    CNavigatorWindow::request Saving() const
    {
        return {true, "Save", folder.string(), "photo.dbw", {{"Workspace", {"dbw"}}, {"PNG", {"png"}}}, 0};
    }
    /// The path that was taken, without the folder; "-" for none.
    std::string Ask(CNavigatorWindow &asking)
    {
        std::string path;
        try
        {
            return asking.Ask(&window, path) ? fs::relative(path, folder).string() : "-";
        }
        catch (const CException &e)
        {
            return e.ErrorText(); // nobody has ended it, and no key is left
        }
    }
    /// The keys go to the window, and from then on to whatever window is the front-most.
    Platform::memoryDisplay &To(CNavigatorWindow &asking)
    {
        asking.Open(&window);
        return display.to(*asking.Screen());
    }

    const TestSupport::temporaryFolder own;
    const fs::path folder = own.path();
};

TEST_F(Navigator, OpensByKeysAlone)
{
    {
        CNavigatorWindow w(Opening()); // the list has the focus: sub, a.dbw
        To(w).tap(key::down).tap(key::down).tap(key::enter);
        EXPECT_EQ(Ask(w), "a.dbw");
    }
    {
        CNavigatorWindow w(Opening()); // into a folder, back up where it is selected, in again
        To(w).type("s").tap(key::enter).tap(key::backspace).tap(key::enter).tap(key::down).tap(key::enter);
        EXPECT_EQ(Ask(w), "sub/c.dbw");
        EXPECT_EQ(w.Folder(), (folder / "sub").string());
    }
    {
        CNavigatorWindow w(Opening());
        To(w)
            .with(Platform::altModifier)
            .tap(key::n)
            .with(0)
            .type("sub")
            .tap(key::enter)
            .type("../b.knl")
            .tap(key::enter);
        EXPECT_EQ(Ask(w), "b.knl"); // of another type, but it was named
    }
    {
        CNavigatorWindow w(Opening());
        To(w).tap(key::escape);
        EXPECT_EQ(Ask(w), "-");
    }
    {
        CNavigatorWindow w(Opening());
        To(w).with(Platform::altModifier).tap(key::up).with(0).close();
        EXPECT_EQ(Ask(w), "-");
        EXPECT_EQ(w.Folder(), folder.parent_path().string());
    }
}

TEST_F(Navigator, SavesAndAsksBeforeItReplaces)
{
    /// Presses keys in the window that is open after a while.
    struct later
    {
        Platform::memoryDisplay &display;
        key k;
        CTimer timer{0.5, [](void *p) { static_cast<later *>(p)->Press(); }, this};
        void Press()
        {
            timer.Stop();
            display.to(*display.windows().back()).tap(k);
        }
    };
    {
        CNavigatorWindow w(Saving()); // "photo" is selected: typing replaces it
        To(w).type("new.and").tap(key::enter);
        EXPECT_EQ(Ask(w), "new.and.dbw");
    }
    {
        CNavigatorWindow w(Saving());
        To(w).type("a").tap(key::enter);
        later replace{display, key::tab};
        replace.timer.Start();
        later press{display, key::enter};
        press.timer.SetPeriod(0.7);
        press.timer.Start();
        EXPECT_EQ(Ask(w), "a.dbw");
    }
    {
        CNavigatorWindow w(Saving());
        To(w).type("a").tap(key::enter);
        // Not to replace it; the old name comes back; give up.
        later keep{display, key::escape}, restore{display, key::escape}, giveUp{display, key::escape};
        restore.timer.SetPeriod(0.9);
        giveUp.timer.SetPeriod(1.2);
        for (later *each : {&keep, &restore, &giveUp})
            each->timer.Start();
        EXPECT_EQ(Ask(w), "-");
    }
}

TEST_F(Navigator, StartsSomewhereWhateverTheFolder)
{
    CNavigatorWindow::request wanted = Opening();
    wanted.folder = (folder / "sub/none/at/all").string();
    wanted.typeIndex = 99;
    wanted.types.clear();
    EXPECT_EQ(CNavigatorWindow(wanted).Folder(), (folder / "sub").string());
    wanted.folder = std::string(5000, 'x');
    EXPECT_EQ(CNavigatorWindow(wanted).Folder(), "/");
}

} // namespace
} // namespace Sarnik::Test
