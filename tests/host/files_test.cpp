#include "platform/files.h"

#include "tests/host/hostFixture.h"

#include <cerrno>
#include <cstdlib>
#include <gmock/gmock.h>
#include <memory>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace Platform
{
namespace
{

using ::testing::HasSubstr;
using ::testing::StartsWith;

class Files : public Stillmark::hostTest
{
protected:
    static mode_t permissions(const std::string &path)
    {
        struct stat info = {};
        ::stat(path.c_str(), &info);
        return info.st_mode & 07777;
    }
    static void replace(const std::string &path, const std::string &text)
    {
        atomicFile out(path);
        out.write(text.data(), text.size());
        out.commit(true);
    }
};

TEST_F(Files, AFileAppearsWholeOnCommitAndNotBefore)
{
    const std::string path = file("a.txt");
    {
        atomicFile out(path);
        out.write("new", 3);
        EXPECT_FALSE(std::filesystem::exists(path));
    }
    expectOnly({});
    replace(path, "first");
    {
        atomicFile out(path);
        out.write("second", 6);
    }
    EXPECT_EQ(Stillmark::bytesOf(path), "first");
    replace(path, "third");
    EXPECT_EQ(Stillmark::bytesOf(path), "third");
    expectOnly({"a.txt"});
}

TEST_F(Files, PermissionsAndLinksOfAnOldFileAreKept)
{
    const mode_t mask = ::umask(027);
    replace(file("new"), "x");
    ::umask(mask);
    EXPECT_EQ(permissions(file("new")), mode_t{0640});

    ::chmod(file("new").c_str(), 0604);
    std::filesystem::create_symlink("new", file("link"));
    replace(file("link"), "y");
    EXPECT_TRUE(std::filesystem::is_symlink(file("link")));
    EXPECT_EQ(Stillmark::bytesOf(file("new")), "y");
    EXPECT_EQ(permissions(file("new")), mode_t{0604});
}

TEST_F(Files, TargetsThatCannotBeWrittenAreNamedWithTheCause)
{
    std::filesystem::create_directory(file("folder"));
    const std::string longName = file(std::string(300, 'n'));
    const std::pair<std::string, std::string> cases[] = {
        {file("folder"), "Is a directory"},
        {file("none/a"), "there is no folder"},
        {"/dev/null", "not a regular file"},
        {file("new") + "/", "names no file"},
        {"", "names no file"},
    };
    for (const auto &[path, cause] : cases)
        try
        {
            checkWritable(path);
            ADD_FAILURE() << path;
        }
        catch (const fileError &error)
        {
            EXPECT_THAT(error.what(), StartsWith(path + ": cannot be written: "));
            EXPECT_THAT(error.what(), HasSubstr(cause));
        }
    try
    {
        replace(longName, "x");
        ADD_FAILURE() << "a name of 300 letters was taken";
    }
    catch (const fileError &error)
    {
        EXPECT_THAT(error.what(), HasSubstr("File name too long"));
    }
    replace(file(std::string(250, 'n')), "x"); // the temporary's name must not become too long
    expectOnly({"folder", std::string(250, 'n')});
}

TEST_F(Files, AProcessThatEndsAtOnceCanRemoveItsTemporaries)
{
    const pid_t child = ::fork();
    if (child == 0)
    {
        std::vector<std::unique_ptr<atomicFile>> pending;
        for (int i = 0; i < 70; ++i) // more than are kept track of: the rest stays, nothing breaks
            pending.push_back(std::make_unique<atomicFile>(file(std::to_string(i))));
        pending.resize(64);
        replace(file("done"), "kept");
        removePendingTemporaries();
        ::_exit(0);
    }
    int status = -1;
    ::waitpid(child, &status, 0);
    EXPECT_EQ(status, 0);
    expectOnly({"done"});
}

TEST_F(Files, WholeFilesAreReadUpToALimit)
{
    Stillmark::writeBytes(file("a"), "12345");
    EXPECT_EQ(readWholeFile(file("a"), 5), (std::vector<std::uint8_t>{'1', '2', '3', '4', '5'}));
    EXPECT_THROW(readWholeFile(file("a"), 4), fileError);
    EXPECT_THROW(readWholeFile(file("b"), 4), fileError);
    EXPECT_THROW(readWholeFile(folder.path().string(), 1 << 30), fileError);
    EXPECT_THROW(readWholeFile("/dev/zero", 1 << 30), fileError);
}

TEST_F(Files, ScratchDataIsKeptAnywhereInTheFileAndLeavesNoName)
{
    ::setenv("TMPDIR", folder.path().c_str(), 1);
    {
        scratchFile scratch((std::uint64_t{1} << 26) + 8); // sparse: no such room is taken
        expectOnly({});
        scratch.write(std::uint64_t{1} << 26, "far away", 8);
        scratch.write(3, "near", 4);
        char text[9] = {};
        scratch.read(std::uint64_t{1} << 26, text, 8);
        EXPECT_STREQ(text, "far away");
        scratch.read(2, text, 5);
        EXPECT_EQ(std::string(text, 5), std::string("\0near", 5));

        scratch.grow(std::uint64_t{1} << 27);
        EXPECT_THROW(scratch.grow(std::uint64_t{1} << 60), fileError);
        EXPECT_EQ(scratch.size(), std::uint64_t{1} << 27);
        scratch.read((std::uint64_t{1} << 27) - 4, text, 4);
        EXPECT_EQ(std::string(text, 4), std::string(4, '\0'));
        scratch.read(std::uint64_t{1} << 26, text, 8);
        EXPECT_STREQ(text, "far away");
    }
    try
    {
        scratchFile tooLarge(std::uint64_t{1} << 60);
        ADD_FAILURE() << "an exabyte was granted";
    }
    catch (const fileError &error)
    {
        EXPECT_THAT(error.what(), StartsWith(folder.path().string() + ": too little room"));
    }
    ::setenv("TMPDIR", file("none").c_str(), 1);
    EXPECT_THROW(scratchFile(1), fileError);
    ::unsetenv("TMPDIR");
}

} // namespace
} // namespace Platform
