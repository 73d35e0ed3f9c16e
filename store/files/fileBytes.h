#pragma once

#include "framework/base/container.h"

#include <functional>
#include <string>

/// What loaders and savers of workspaces and traces share.
namespace Project
{

class PKernelCollection;

/// Longest file that is read, in bytes; a trace has at most 160 kB.
inline constexpr std::size_t kLongestTraceFile = std::size_t{256} << 20;

/// A file's content. Throws Platform::fileError.
Sarnik::CMemoryContainer ReadFileBytes(const std::string &path);

/// A whole load: clears the collection's last error and runs `read` over the file's content. True if `read` answers
/// true, nothing is thrown, and no error was left. What failed without a message of its own is an unrecognized format.
bool LoadFile(PKernelCollection &collection, const std::string &path,
              const std::function<bool(Sarnik::CContainer &in)> &read);

/// Replaces the file, whole or not at all, by the content of what `write` fills. False, with the old file untouched,
/// if that fails, if `write` answers false, or if it writes nothing.
bool SaveFile(const std::string &directory, const std::string &name,
              const std::function<bool(Sarnik::CContainer &out)> &write);

} // namespace Project
