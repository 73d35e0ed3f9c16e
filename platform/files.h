#pragma once

#include "platform/error.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

/// Files that are written whole or not at all, and scratch space on disk. Failures throw Platform::fileError.
namespace Platform
{

/// The line "<path>: <what>: <strerror of code>", for errors met outside this file.
fileError errnoError(const std::string &path, const std::string &what, int code);

/// The bytes of a regular file. One that is longer than limit is refused before anything is allocated.
std::vector<std::uint8_t> readWholeFile(const std::string &path, std::size_t limit);

/// Throws unless a file can be created at path: its folder exists and takes new files, and path itself is free or a
/// regular file. Nothing is left behind.
void checkWritable(const std::string &path);

/// A new version of a file. Bytes go into a hidden file in the same folder, which commit() renames over the target, so
/// that readers see the old file or the new one and never a half. Without commit() the destructor removes it.
///
/// The permissions of an old target are kept, a new file gets 0666 without the umask's bits. A symbolic link is
/// followed: the file it points to is replaced. One thread at a time per object.
class atomicFile
{
public:
    explicit atomicFile(const std::string &path);
    atomicFile(const atomicFile &) = delete;
    atomicFile &operator=(const atomicFile &) = delete;
    ~atomicFile();

    /// Appends size bytes.
    void write(const void *bytes, std::size_t size);

    /// Open for reading and writing; it stays the object's own.
    int descriptor() const { return fd; }

    /// Puts the file in place. With durable the bytes are on the disk before it gets its name. May be called once;
    /// when it throws, the old file is untouched and the temporary is gone.
    void commit(bool durable = false);

private:
    void discard() noexcept;

    std::string shownPath; ///< as the caller wrote it, for messages
    std::string target;    ///< with links resolved
    std::string temporary; ///< empty once committed or removed
    int slot = -1;         ///< place in the list that removePendingTemporaries() walks
    int fd = -1;
};

/// Removes the temporaries of all atomicFile objects that are not committed yet. Async-signal-safe: for a handler that
/// ends the process at once. Up to 64 files at a time are known to it.
void removePendingTemporaries() noexcept;

/// An unnamed file for data that does not fit in memory. The system frees it when the object or the process ends,
/// however that happens.
class scratchFile
{
public:
    /// $TMPDIR or /var/tmp (which, unlike /tmp, is not kept in memory).
    static std::string defaultFolder();

    /// Room for size bytes, all zero; refused when the disk has not that much free.
    explicit scratchFile(std::uint64_t size, const std::string &folder = defaultFolder());
    scratchFile(const scratchFile &) = delete;
    scratchFile &operator=(const scratchFile &) = delete;
    ~scratchFile();

    /// Ranges must lie within the size. Any threads at once, as long as nobody reads what another is writing.
    void read(std::uint64_t offset, void *bytes, std::size_t size) const;
    void write(std::uint64_t offset, const void *bytes, std::size_t size);

    /// Makes it longer, with zeros. Refused when the disk has not enough free for all that was promised and is not
    /// written yet; the file is as before then. Not while another thread asks for size().
    void grow(std::uint64_t size);

    std::uint64_t size() const { return length; }

private:
    struct openTag
    {
    };
    scratchFile(const std::string &folder, openTag);

    std::string folder;
    std::uint64_t length = 0;
    int fd = -1;
};

} // namespace Platform
