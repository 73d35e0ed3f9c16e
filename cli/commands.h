#pragma once

#include "cli/options.h"
#include "cli/runContext.h"

/// The subcommands: each does its job, or throws what runCommand turns into a message. Each is in a file of its own.
namespace Stillmark
{

commandResult removeBlur(const removeOptions &options, runContext &context);
/// One photo after the other. One that fails does not keep the rest from being done; the status tells of it.
commandResult removeBlurFromAll(const batchOptions &options, runContext &context);
commandResult estimateKernel(const estimateOptions &options, runContext &context);
commandResult deconvolvePhoto(const deconvolveOptions &options, runContext &context);
commandResult suggestRegions(const suggestOptions &options, runContext &context);
commandResult measurePhoto(const measureOptions &options, runContext &context);
commandResult makeLine(const lineOptions &options, runContext &context);
commandResult inspectFile(const inspectOptions &options, runContext &context);

/// How every command that reads a photo begins.
photo openPhoto(const std::string &path, runContext &context);

} // namespace Stillmark
