#include "platform/files.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <cerrno>
#include <climits>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <memory>
#include <sys/random.h>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <unistd.h>
#include <utility>

namespace Platform
{

namespace
{

/// The names a signal handler must be able to remove: fixed storage, since nothing may be allocated or locked there.
struct pendingName
{
    enum
    {
        unused,
        beingFilled,
        ready
    };
    std::atomic<int> state{unused};
    char path[PATH_MAX];
};

std::array<pendingName, 64> pending;

int enterPending(const std::string &path)
{
    for (std::size_t i = 0; i < pending.size() && path.size() < PATH_MAX; ++i)
    {
        int expected = pendingName::unused;
        if (!pending[i].state.compare_exchange_strong(expected, pendingName::beingFilled))
            continue;
        std::memcpy(pending[i].path, path.c_str(), path.size() + 1);
        pending[i].state = pendingName::ready;
        return static_cast<int>(i);
    }
    return -1;
}

void leavePending(int &slot)
{
    if (slot >= 0)
        pending[static_cast<std::size_t>(slot)].state = pendingName::unused;
    slot = -1;
}

/// A name nobody else uses, so that a handler that removes it can hit no foreign file.
std::string hiddenName(const std::string &target)
{
    const std::size_t slash = target.rfind('/');
    const std::string folder = slash == std::string::npos ? "" : target.substr(0, slash + 1);
    const std::string name = target.substr(folder.size(), 200); // a name may have 255 bytes in all
    std::uint64_t noise = 0;
    if (getrandom(&noise, sizeof noise, 0) != sizeof noise)
        noise = static_cast<std::uint64_t>(getpid()) << 32 ^ reinterpret_cast<std::uintptr_t>(&noise);
    static const char letters[] = "abcdefghijklmnopqrstuvwxyz0123456789";
    std::string suffix;
    for (int i = 0; i < 10; ++i, noise /= 36)
        suffix += letters[noise % 36];
    return folder + "." + name + "." + suffix;
}

void writeAll(int fd, const char *bytes, std::size_t size, const std::string &path)
{
    while (size > 0)
    {
        const ssize_t done = ::write(fd, bytes, size);
        if (done < 0 && errno == EINTR)
            continue;
        if (done < 0)
            throw errnoError(path, "cannot be written", errno);
        bytes += done;
        size -= static_cast<std::size_t>(done);
    }
}

std::string megabytes(std::uint64_t bytes)
{
    return std::to_string((bytes + (1u << 20) - 1) >> 20) + " MB";
}

int openUnnamed(const std::string &folder)
{
    int fd = ::open(folder.c_str(), O_TMPFILE | O_RDWR | O_CLOEXEC | O_EXCL, 0600);
    if (fd < 0 && (errno == EOPNOTSUPP || errno == EISDIR || errno == EINVAL)) // a file system without unnamed files
    {
        std::string name = folder + "/stillmark.XXXXXX";
        fd = ::mkostemp(name.data(), O_CLOEXEC);
        if (fd >= 0)
            ::unlink(name.c_str());
    }
    return fd;
}

} // namespace

fileError errnoError(const std::string &path, const std::string &what, int code)
{
    return fileError(path + ": " + what + ": " + std::strerror(code));
}

std::vector<std::uint8_t> readWholeFile(const std::string &path, std::size_t limit)
{
    const std::unique_ptr<std::FILE, int (*)(std::FILE *)> file(std::fopen(path.c_str(), "rbe"), std::fclose);
    struct stat info;
    if (!file || fstat(fileno(file.get()), &info) != 0)
        throw errnoError(path, "cannot be read", errno);
    if (S_ISDIR(info.st_mode))
        throw errnoError(path, "cannot be read", EISDIR);
    if (!S_ISREG(info.st_mode))
        throw fileError(path + ": cannot be read: it is not a regular file");
    if (static_cast<std::uint64_t>(info.st_size) > limit)
        throw fileError(path + ": too large: " + std::to_string(info.st_size) + " bytes, at most " +
                        std::to_string(limit) + " are taken");
    std::vector<std::uint8_t> bytes(static_cast<std::size_t>(info.st_size));
    const std::size_t got = std::fread(bytes.data(), 1, bytes.size(), file.get());
    if (got != bytes.size() && std::ferror(file.get()))
        throw errnoError(path, "cannot be read", errno);
    bytes.resize(got); // it may have been cut since its size was asked
    return bytes;
}

void checkWritable(const std::string &path)
{
    atomicFile probe(path);
}

atomicFile::atomicFile(const std::string &path) : shownPath(path), target(path)
{
    const std::string failure = "cannot be written";
    if (const std::unique_ptr<char, decltype(&std::free)> real(::realpath(path.c_str(), nullptr), std::free); real)
        target = real.get();

    mode_t creation = 0666;
    struct stat old;
    const bool replaces = ::stat(target.c_str(), &old) == 0;
    if (replaces)
    {
        if (S_ISDIR(old.st_mode))
            throw errnoError(path, failure, EISDIR);
        if (!S_ISREG(old.st_mode))
            throw fileError(path + ": " + failure + ": it is not a regular file");
        if (::access(target.c_str(), W_OK) != 0)
            throw errnoError(path, failure, errno);
        creation = 0600; // nobody may look in before it has the old one's permissions
    }
    else if (path.empty() || path.back() == '/')
        throw fileError(path + ": " + failure + ": it names no file");

    do
    {
        temporary = hiddenName(target);
        slot = enterPending(temporary);
        fd = ::open(temporary.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, creation);
        if (fd < 0)
            leavePending(slot);
    } while (fd < 0 && errno == EEXIST);
    if (fd < 0)
    {
        temporary.clear();
        const int code = errno;
        const std::size_t slash = target.rfind('/');
        if (code == ENOENT && slash != std::string::npos)
            throw fileError(path + ": " + failure + ": there is no folder " + target.substr(0, slash + 1));
        throw errnoError(path, failure, code);
    }
    if (replaces)
        (void)::fchmod(fd, old.st_mode & 07777); // some file systems know no permissions
}

atomicFile::~atomicFile()
{
    discard();
}

void atomicFile::discard() noexcept
{
    if (fd >= 0)
        ::close(fd);
    fd = -1;
    if (!temporary.empty())
        ::unlink(temporary.c_str());
    temporary.clear();
    leavePending(slot);
}

void atomicFile::write(const void *bytes, std::size_t size)
{
    writeAll(fd, static_cast<const char *>(bytes), size, shownPath);
}

void atomicFile::commit(bool durable)
{
    int failed = durable && ::fsync(fd) != 0 ? errno : 0;
    // Some network file systems report a full disk only here.
    if (::close(std::exchange(fd, -1)) != 0 && failed == 0)
        failed = errno;
    if (failed == 0 && ::rename(temporary.c_str(), target.c_str()) != 0)
        failed = errno;
    if (failed != 0)
    {
        discard();
        throw errnoError(shownPath, "cannot be written", failed);
    }
    temporary.clear();
    leavePending(slot);
}

void removePendingTemporaries() noexcept
{
    for (pendingName &name : pending)
        if (name.state == pendingName::ready)
            ::unlink(name.path);
}

std::string scratchFile::defaultFolder()
{
    const char *chosen = std::getenv("TMPDIR");
    return chosen && *chosen ? chosen : "/var/tmp";
}

scratchFile::scratchFile(const std::string &where, openTag) : folder(where), fd(openUnnamed(where))
{
    if (fd < 0)
        throw errnoError(folder, "no scratch file can be made there", errno);
}

scratchFile::scratchFile(std::uint64_t size, const std::string &where) : scratchFile(where, openTag{})
{
    grow(size);
}

void scratchFile::grow(std::uint64_t size)
{
    // Besides being useless, setting a length of 0 makes some file systems write everything out when the file is
    // closed.
    if (size <= length)
        return;
    struct statvfs disk;
    struct stat file;
    if (::fstatvfs(fd, &disk) == 0 && ::fstat(fd, &file) == 0)
    {
        const std::uint64_t room = static_cast<std::uint64_t>(disk.f_bavail) * disk.f_frsize;
        const std::uint64_t written = static_cast<std::uint64_t>(file.st_blocks) * 512;
        const std::uint64_t missing = size - std::min(size, written);
        if (room < missing)
            throw fileError(folder + ": too little room for scratch data: " + megabytes(missing) + " are needed, " +
                            megabytes(room) + " are free (TMPDIR names another folder)");
    }
    if (::ftruncate(fd, static_cast<off_t>(size)) != 0)
        throw errnoError(folder, "a scratch file of " + megabytes(size) + " cannot be made there", errno);
    length = size;
}

scratchFile::~scratchFile()
{
    ::close(fd);
}

void scratchFile::read(std::uint64_t offset, void *bytes, std::size_t size) const
{
    for (char *to = static_cast<char *>(bytes); size > 0;)
    {
        const ssize_t done = ::pread(fd, to, size, static_cast<off_t>(offset));
        if (done < 0 && errno == EINTR)
            continue;
        if (done <= 0)
            throw errnoError(folder, "scratch data cannot be read", done < 0 ? errno : EIO);
        to += done;
        offset += static_cast<std::uint64_t>(done);
        size -= static_cast<std::size_t>(done);
    }
}

void scratchFile::write(std::uint64_t offset, const void *bytes, std::size_t size)
{
    for (const char *from = static_cast<const char *>(bytes); size > 0;)
    {
        const ssize_t done = ::pwrite(fd, from, size, static_cast<off_t>(offset));
        if (done < 0 && errno == EINTR)
            continue;
        if (done < 0)
            throw errnoError(folder, "scratch data cannot be written", errno);
        from += done;
        offset += static_cast<std::uint64_t>(done);
        size -= static_cast<std::size_t>(done);
    }
}

} // namespace Platform
