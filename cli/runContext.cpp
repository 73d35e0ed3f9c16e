#include "cli/runContext.h"

#include "cli/commandLine.h"
#include "cli/optionValues.h"
#include "cli/stopSignal.h"
#include "platform/error.h"

#include <tbb/global_control.h>
#include <tbb/task_arena.h>

#include <unistd.h>

#include <cstdio>
#include <new>
#include <optional>

namespace Stillmark
{
namespace
{

/// Calls body on an arena of the wanted size, so that more threads than cores are possible too.
commandResult callWithThreads(int threads, const std::function<commandResult()> &body)
{
    if (threads == 0)
        return body();
    setPhotoThreads(threads);
    const tbb::global_control limit(tbb::global_control::max_allowed_parallelism, static_cast<std::size_t>(threads));
    tbb::task_arena arena(threads);
    return arena.execute(body);
}

int failed(progressBar &bar, const std::string &line)
{
    bar.clear();
    std::fputs((line + "\n").c_str(), stderr);
    return exitFailed;
}

bool printed(const std::string &text)
{
    return text.empty() || (std::fputs((text + "\n").c_str(), stdout) >= 0 && std::fflush(stdout) == 0);
}

} // namespace

progressCheck runContext::progress()
{
    return [this](double done) {
        bar.set(done);
        return !stopSignal::requested();
    };
}

int runCommand(const commonOptions &options, const commandBody &body)
{
    progressBar bar(!options.quiet && isatty(STDERR_FILENO));
    try
    {
        runContext context{bar, {}};
        const commandResult result = callWithThreads(options.threads, [&] { return body(context); });
        bar.clear();
        for (const std::string &note : context.notes)
            std::fputs((note + "\n").c_str(), stderr);
        if (!printed(options.json ? result.json : options.quiet ? "" : result.text))
            return failed(bar, "stillmark: cannot write to the standard output");
        return result.status;
    }
    catch (const Platform::cancelled &)
    {
        bar.clear();
        stopSignal::sayCancelled();
        return exitFailed;
    }
    catch (const usageError &e)
    {
        failed(bar, "stillmark: " + std::string(e.what()));
        return exitUsage;
    }
    catch (const std::bad_alloc &)
    {
        return failed(bar, "stillmark: not enough memory");
    }
    catch (const std::exception &e)
    {
        return failed(bar, "stillmark: " + std::string(e.what()));
    }
}

} // namespace Stillmark
