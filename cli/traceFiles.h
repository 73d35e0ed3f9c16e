#pragma once

#include "cli/runRecord.h"
#include "host/kernelFile.h"
#include "host/plugin/recordedAction.h"

#include <string>
#include <vector>

/// Workspaces (.dbw) and trace files (.knl) of the command line; docs/files/traces.md has their bytes.
namespace Stillmark
{

/// A run that uses the traces of a workspace. It was saved for a picture (or what is selected of it) of width x height;
/// what does not fit becomes a note. Throws Platform::fileError when nothing in the file can be used.
recordedAction workspaceAction(const std::string &path, int width, int height, bool artifactSuppression,
                               std::vector<std::string> &notes);

/// Keeps the traces that a run has recorded. Throws Platform::fileError.
void saveWorkspace(const std::string &path, const recordedAction &recorded, int width, int height);

/// readKernel, and the kernel of a .knl. Throws Platform::fileError.
kernelSamples readAnyKernel(const std::string &path);

/// checkKernelPath and writeKernel, and a .knl for a picture of width x height. Throw Platform::fileError.
void checkAnyKernelPath(const std::string &path);
void writeAnyKernel(const std::string &path, const recordedTrace &trace, int width, int height);

} // namespace Stillmark
