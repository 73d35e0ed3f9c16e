#pragma once

#include "cli/options.h"

#include <iosfwd>

namespace Stillmark
{

/// The exit statuses of the program.
enum exitStatus : int
{
    exitDone = 0,
    exitFailed = 1, ///< or cancelled
    exitUsage = 2
};

/// What the command line can ask for. The program carries it out; a test only looks at it.
class commandDelegate
{
public:
    virtual ~commandDelegate() = default;
    virtual int remove(const removeOptions &options) = 0;
    virtual int removeAll(const batchOptions &options) = 0;
    virtual int estimate(const estimateOptions &options) = 0;
    virtual int deconvolve(const deconvolveOptions &options) = 0;
    virtual int suggest(const suggestOptions &options) = 0;
    virtual int measure(const measureOptions &options) = 0;
    virtual int line(const lineOptions &options) = 0;
    virtual int inspect(const inspectOptions &options) = 0;
};

/// Parses the arguments, calls the one delegate function they ask for and returns its answer. A subcommand is named by
/// the first argument; anything else there belongs to the main job. Help and version go to out. Wrong usage is told on
/// err in one line and answered with exitUsage; what the delegate throws passes through.
int runCommandLine(int argc, const char *const *argv, commandDelegate &delegate, std::ostream &out, std::ostream &err);

} // namespace Stillmark
