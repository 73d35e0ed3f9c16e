#pragma once

#include <string>

/// Workspaces: all Blur Traces of a run in a file of the extension ".dbw" (docs/files/traces.md). Main thread. None of
/// these throws; what went wrong in a load stands in the collection's last error, for the user.
namespace Project
{

class PKernelCollection;
struct PStreamIndices;

/// Looks at the header alone, so that the user can be asked before anything is lost. True if it is that of a file of
/// ours for a picture of this size; nothing but the collection's last error and version changes.
bool CheckFileHeader(PKernelCollection &collection, const std::string &path);

/// Replaces all traces. A bad header leaves them as they are; in a file that is cut short or senseless further on, the
/// old ones are gone and those before that place are loaded. False, too, when some were left out because they do not
/// fit the picture, while the rest has been loaded. `indices`, where given, is told what the file says of them.
bool LoadWorkspace(PKernelCollection &collection, const std::string &path, PStreamIndices *indices = nullptr);

/// Replaces the file whole or not at all; false, without a message, if that cannot be done. Afterwards the collection
/// counts as unchanged.
bool SaveWorkspace(PKernelCollection &collection, const std::string &directory, const std::string &name);

} // namespace Project
