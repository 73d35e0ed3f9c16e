#pragma once

#include <memory>
#include <string>

/// Single Blur Traces in files: ".knl", with region and settings, and ".png", the kernel as a picture (docs/files/).
/// Main thread. None of these throws; what went wrong in a load stands in the collection's last error, for the user,
/// and the collection is as it was then.
namespace Project
{

class PKernel;
class PKernelCollection;

/// Adds the file's trace in front of the trace at `at`, -1 appends: by an undoable task, where such are kept.
bool LoadTrace(PKernelCollection &collection, const std::string &path, int at);
/// The same for a picture. It becomes a read-only trace in the middle of the picture, with the settings of new traces.
bool LoadPngTrace(PKernelCollection &collection, const std::string &path, int at);

/// Writes the selected trace; the file is replaced whole or not at all. False, without a message, when that cannot be
/// done or nothing is selected.
bool SaveTrace(const PKernelCollection &collection, const std::string &directory, const std::string &name);
/// The same as a picture; the region and the settings are lost, and what the kernel adds up to.
bool SavePngTrace(PKernelCollection &collection, const std::string &directory, const std::string &name);

} // namespace Project
