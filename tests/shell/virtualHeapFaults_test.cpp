#include "shell/bufferSuiteAllocator.h"
#include "shell/virtualHeap.h"
#include "tests/shell/heapFixture.h"

#include <csignal>
#include <functional>
#include <map>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace Sarnik
{
namespace
{

const char noMoreTiles[] = "$$$/Sarnik/VirtualHeap/AcquireTileError=No more virtual tiles can be allocated.";

/// An allocator that does what the test says and keeps count of what is out.
class scriptedAllocator final : public CVirtualAllocator
{
public:
    /// Called before every allocation: throws, or answers whether there is memory.
    std::function<bool()> grant = [] { return true; };
    std::map<void *, std::size_t> out;
    int asked = 0;

    void *Allocate(std::size_t size) override
    {
        ++asked;
        if (!grant())
            return nullptr;
        void *memory = std::malloc(size);
        out[memory] = size;
        return memory;
    }
    void Free(void *memory) noexcept override
    {
        EXPECT_EQ(out.erase(memory), 1u); // nothing that came from elsewhere
        std::free(memory);
    }
};

class HeapFaults : public heapTest
{
protected:
    HeapFaults() { CVirtualAllocator::Install(allocator); }
    ~HeapFaults() override { CVirtualAllocator::Clear(); }

    void fillTiles(CVirtualHeap &heap, unsigned count, int sizeClass)
    {
        for (unsigned i = 0; i < count; ++i)
        {
            const unsigned seed = static_cast<unsigned>(tiles.size());
            tiles.push_back(heap.AcquireTile(sizeClass, sizeClass, count));
            fill(heap, tiles.back(), seed);
        }
    }
    void expectAllThere(CVirtualHeap &heap)
    {
        for (unsigned i = 0; i < tiles.size(); ++i)
            EXPECT_TRUE(holds(heap, tiles[i], i)) << "tile " << i;
    }

    std::shared_ptr<scriptedAllocator> allocator = std::make_shared<scriptedAllocator>();
    std::vector<VirtualTile *> tiles;
};

TEST_F(HeapFaults, MemoryGoesBackToWhereItCameFrom)
{
    {
        CVirtualHeap heap;
        heap.Open(volume());
        heap.SetLimit(20 * tileBytes(6));
        allocator->grant = [&] { return allocator->asked % 3 != 0; }; // every third from the process
        fillTiles(heap, 9, 6);
        EXPECT_EQ(allocator->asked, 9);
        EXPECT_EQ(allocator->out.size(), 6u);
        CVirtualAllocator::Clear();
        fillTiles(heap, 3, 6);
        EXPECT_EQ(allocator->asked, 9);
        heap.SetLimit(4 * tileBytes(6));
        EXPECT_LE(allocator->out.size(), 4u);
        expectAllThere(heap);
    }
    EXPECT_TRUE(allocator->out.empty());
}

/// A host whose every third call has no buffer and whose every third buffer lies at an odd address.
struct bufferHost
{
    int asked = 0;
    std::map<void *, std::unique_ptr<char[]>> out; // by the pointer that was handed out

    static void *allocate(void *context, std::uint64_t size)
    {
        bufferHost &host = *static_cast<bufferHost *>(context);
        if (host.asked++ % 3 == 0)
            return nullptr;
        auto memory = std::make_unique<char[]>(size + 1);
        char *const handed = memory.get() + (host.asked % 3 == 0);
        host.out[handed] = std::move(memory);
        return handed;
    }
    static void dispose(void *context, void *buffer)
    {
        EXPECT_EQ(static_cast<bufferHost *>(context)->out.erase(buffer), 1u);
    }
};

TEST_F(HeapFaults, AHostsBuffersAreUsedWhereTheyAreFitAndItsSuiteIsGivenBackLast)
{
    bufferHost host;
    bool released = false;
    const TNBufferSuite suite{&host, bufferHost::allocate, bufferHost::dispose, nullptr};
    CVirtualAllocator::Install(std::make_shared<CBufferSuiteAllocator>(suite, [&] { released = true; }));
    {
        CVirtualHeap heap;
        heap.Open(volume());
        fillTiles(heap, 9, 5);
        EXPECT_EQ(host.asked, 9);
        EXPECT_EQ(host.out.size(), 3u);
        CVirtualAllocator::Clear();
        EXPECT_FALSE(released);
        expectAllThere(heap);
    }
    EXPECT_TRUE(released && host.out.empty());
}

TEST_F(HeapFaults, WhenMemoryRunsOutPagesAreGivenUpAndTheLimitComesDown)
{
    constexpr std::uint64_t size = std::uint64_t{1} << 20;
    std::uint64_t there = 24 * size;
    allocator->grant = [&] {
        if ((allocator->out.size() + 1) * size > there)
            throw std::bad_alloc();
        return true;
    };
    CVirtualHeap heap;
    heap.Open(volume());
    heap.SetLimit(100 * size);
    fillTiles(heap, 24, 12);
    EXPECT_EQ(heap.Limit(), 100 * size);
    fillTiles(heap, 1, 12); // one block is given back and asked for again
    EXPECT_EQ(heap.TotalBytes(), 24 * size);
    EXPECT_EQ(heap.Limit(), 100 * size - 23 * size / 20);
    EXPECT_FALSE(heap.InMemory(tiles[0]));
    EXPECT_TRUE(heap.InMemory(tiles[1]));
    expectAllThere(heap);

    heap.SetLimit(10 * size);
    there = 10 * size;
    heap.SetLimit(100 * size);
    fillTiles(heap, 1, 12); // at 16 MiB and below the limit stays
    EXPECT_EQ(heap.Limit(), 100 * size);

    there = 0; // the second failure is the caller's
    VirtualTile *const old = tiles[0];
    heap.DetachMemory(old);
    heap.SetLimit(0);
    EXPECT_THROW(heap.Pin(old, CPageAccess::read), std::bad_alloc);
    there = 24 * size;
    expectAllThere(heap);
}

TEST_F(HeapFaults, WithoutRoomOnDiskThereAreNoMoreTiles)
{
    CVirtualHeap none;
    none.Open({});
    EXPECT_EQ(errorOf([&] { none.AcquireTile(0, 0); }), noMoreTiles);
    CVirtualHeap nowhere;
    nowhere.Open({{(folder / "missing").string()}});
    EXPECT_EQ(errorOf([&] { nowhere.AcquireTile(0, 0); }), noMoreTiles);

    CVirtualHeap heap;
    heap.Open({{folder.string(), 10 * tileBytes(10) + 100}});
    heap.SetLimit(0);
    fillTiles(heap, 10, 10);
    EXPECT_EQ(errorOf([&] { heap.AcquireTile(10, 10, 1000000000); }), noMoreTiles);
    expectAllThere(heap);
    heap.ReleaseTile(tiles.back());
    EXPECT_EQ(heap.AcquireTile(10, 10), tiles.back());
}

TEST_F(HeapFaults, AFailedWriteLosesNothing)
{
    CVirtualHeap heap;
    heap.Open(volume());
    heap.SetLimit(4 * tileBytes(8));
    fillTiles(heap, 8, 8);
    VirtualTile *const next = heap.AcquireTile(8, 8);

    // The system refuses every write behind the first page: what a full disk does.
    rlimit normal;
    ASSERT_EQ(::getrlimit(RLIMIT_FSIZE, &normal), 0);
    const auto oldHandler = std::signal(SIGXFSZ, SIG_IGN);
    rlimit small = normal;
    small.rlim_cur = tileBytes(8);
    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &small), 0);
    const std::string attach = errorOf([&] { heap.AttachMemory(next); });
    const std::string reattach = errorOf([&] { heap.AttachMemory(tiles[0]); });
    const std::string shrink = errorOf([&] { heap.SetLimit(0); });
    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &normal), 0);
    std::signal(SIGXFSZ, oldHandler);

    for (const std::string &error : {attach, reattach, shrink})
        EXPECT_NE(error.find("scratch data cannot be written"), std::string::npos) << error;
    EXPECT_FALSE(heap.InMemory(next));
    EXPECT_TRUE(heap.InMemory(tiles[4]));
    expectAllThere(heap);
    heap.SetLimit(0);
    EXPECT_EQ(heap.TotalBytes(), 0u);
    expectAllThere(heap);
}

/// The open files of a process that lie in the folder, as paths under /proc.
std::vector<std::filesystem::path> openIn(const std::filesystem::path &folder, const std::string &process)
{
    std::vector<std::filesystem::path> found;
    for (const auto &fd : std::filesystem::directory_iterator("/proc/" + process + "/fd"))
    {
        std::error_code gone;
        if (std::filesystem::read_symlink(fd.path(), gone).string().rfind(folder.string(), 0) == 0)
            found.push_back(fd.path());
    }
    return found;
}

TEST_F(HeapFaults, AFailedReadGivesTheMemoryBack)
{
    CVirtualHeap heap;
    heap.Open(volume());
    fillTiles(heap, 4, 8);
    heap.SetLimit(0);
    const auto files = openIn(folder, "self");
    ASSERT_EQ(files.size(), 1u);
    std::filesystem::resize_file(files[0], 100); // what was paged out is gone
    for (int time = 0; time < 2; ++time)
        EXPECT_NE(errorOf([&] { heap.Pin(tiles[0], CPageAccess::read); }).find("scratch data cannot be read"),
                  std::string::npos);
    EXPECT_FALSE(heap.InMemory(tiles[0]));
    EXPECT_EQ(heap.TotalBytes(), tileBytes(8)); // the same block both times
    EXPECT_EQ(heap.FreeBytes(), tileBytes(8));
    for (unsigned i = 0; i < 4; ++i)
        fill(heap, tiles[i], i); // writing them anew needs no reading
    expectAllThere(heap);
}

/// Waits until a line comes through the pipe, or the other side is gone.
std::string lineFrom(int pipe)
{
    std::string line;
    for (char c = 0; ::read(pipe, &c, 1) == 1 && c != '\n';)
        line += c;
    return line;
}

TEST_F(HeapFaults, LeavesNoFile)
{
    {
        CVirtualHeap heap;
        heap.Open(volume());
        heap.SetLimit(0);
        fillTiles(heap, 20, 9);
        heap.SetLimit(0);
        EXPECT_TRUE(folderIsEmpty());
    }
    EXPECT_TRUE(folderIsEmpty());

    int report[2];
    ASSERT_EQ(::pipe(report), 0);
    const pid_t child = ::fork();
    ASSERT_GE(child, 0);
    if (child == 0)
    {
        CVirtualHeap heap;
        heap.Open(volume());
        heap.SetLimit(0);
        VirtualTile *tile = heap.AcquireTile(9, 9);
        fill(heap, tile, 1);
        heap.DetachMemory(tile);
        if (::write(report[1], "written\n", 8) != 8)
            ::_exit(1);
        for (;;)
            ::pause();
    }
    ::close(report[1]);
    EXPECT_EQ(lineFrom(report[0]), "written");
    ::close(report[0]);

    // The child does have its page file there.
    EXPECT_EQ(openIn(folder, std::to_string(child)).size(), 1u);
    ::kill(child, SIGKILL);
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    EXPECT_TRUE(WIFSIGNALED(status));
    EXPECT_TRUE(folderIsEmpty());
}

} // namespace
} // namespace Sarnik
