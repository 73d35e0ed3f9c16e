#include "cli/commandLine.h"
#include "cli/commands.h"
#include "cli/stopSignal.h"

#include <exception>
#include <iostream>

namespace
{

using namespace Stillmark;

/// Carries out what the command line asks for.
class program : public commandDelegate
{
public:
    int remove(const removeOptions &options) override { return run(options, removeBlur); }
    int removeAll(const batchOptions &options) override
    {
        return runCommand(options.job.common, [&](runContext &context) { return removeBlurFromAll(options, context); });
    }
    int estimate(const estimateOptions &options) override { return run(options, estimateKernel); }
    int deconvolve(const deconvolveOptions &options) override { return run(options, deconvolvePhoto); }
    int suggest(const suggestOptions &options) override { return run(options, suggestRegions); }
    int measure(const measureOptions &options) override { return run(options, measurePhoto); }
    int line(const lineOptions &options) override { return run(options, makeLine); }
    int inspect(const inspectOptions &options) override { return run(options, inspectFile); }

private:
    template <typename Options>
    static int run(const Options &options, commandResult (*command)(const Options &, runContext &))
    {
        return runCommand(options.common, [&](runContext &context) { return command(options, context); });
    }
};

} // namespace

int main(int argc, char **argv)
{
    try
    {
        stopSignal::install();
        program stillmark;
        return runCommandLine(argc, argv, stillmark, std::cout, std::cerr);
    }
    catch (const std::exception &e)
    {
        std::cerr << "stillmark: " << e.what() << '\n';
        return exitFailed;
    }
}
