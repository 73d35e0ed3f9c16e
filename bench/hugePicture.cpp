#include "cli/runRecord.h"
#include "host/document/comparingSink.h"
#include "host/document/hostDocument.h"
#include "host/document/syntheticSource.h"
#include "host/plugin/pluginHost.h"
#include "host/plugin/pluginLibrary.h"
#include "platform/files.h"

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <string>
#include <sys/resource.h>

/// stillmark_bench_huge WIDTH HEIGHT DEPTH MIB: a made-up RGB picture that is never whole in memory goes through the
/// plug-in's read, its paging heap, which may hold MIB, and its write-back, with no trace to remove. Prints whether it
/// came back exact, how long that took, and the peak of this process's memory. Status 1 if it did not.
namespace
{

using namespace Stillmark;

int run(int width, int height, int depth, std::int64_t mebibytes)
{
    syntheticSource source(
        {.width = width, .height = height, .depth = depth, .mode = colourMode::rgb, .extraPlanes = 0, .seed = 7});
    comparingSink sink(source);
    hostDocument document(source, &sink);
    const recordedAction action = actionWith({}, width, height, true);
    hostOptions options;
    options.action = &action;
    options.maxSpace = (mebibytes << 20) * 5 / 4; // the plug-in's heap gets four fifths
    options.scratchFolders = {Platform::scratchFile::defaultFolder()};

    const pluginLibrary plugin(STILLMARK_PLUGIN);
    const auto start = std::chrono::steady_clock::now();
    const hostOutcome outcome = runPlugin(plugin.entry(), document, options);
    const double seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);

    const auto pixels = static_cast<std::uint64_t>(width) * static_cast<std::uint64_t>(height);
    const bool exact = outcome.done() && sink.pixelsWritten() == pixels && sink.samplesDiffering() == 0;
    std::printf("%s: %llu of %llu pixels came back, %llu samples differ; %.1f s, peak %ld MiB\n",
                exact ? "exact" : "NOT exact", static_cast<unsigned long long>(sink.pixelsWritten()),
                static_cast<unsigned long long>(pixels), static_cast<unsigned long long>(sink.samplesDiffering()),
                seconds, usage.ru_maxrss / 1024);
    if (!outcome.leaks.empty())
        std::printf("not given back: %s\n", outcome.leaks.text().c_str());
    return exact && outcome.leaks.empty() ? 0 : 1;
}

} // namespace

int main(int argc, char **argv)
{
    if (argc != 5)
    {
        std::fprintf(stderr, "usage: stillmark_bench_huge WIDTH HEIGHT DEPTH MIB\n");
        return 2;
    }
    try
    {
        return run(std::atoi(argv[1]), std::atoi(argv[2]), std::atoi(argv[3]), std::atoll(argv[4]));
    }
    catch (const std::exception &e)
    {
        std::fprintf(stderr, "stillmark_bench_huge: %s\n", e.what());
        return 1;
    }
}
