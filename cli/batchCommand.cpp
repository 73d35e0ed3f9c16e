#include "cli/commands.h"
#include "cli/jsonWriter.h"
#include "cli/stopwatch.h"
#include "platform/error.h"

#include <exception>
#include <filesystem>
#include <map>
#include <new>
#include <tuple>

namespace Stillmark
{
namespace
{

namespace fs = std::filesystem;

/// Results by photo. Throws Platform::fileError where two photos would have one result, or a result its own photo.
std::vector<std::pair<std::string, std::string>> resultsOf(const batchOptions &options)
{
    std::error_code unknown;
    if (!fs::is_directory(options.folder, unknown))
        throw Platform::fileError(options.folder + ": is no folder");
    std::vector<std::pair<std::string, std::string>> jobs;
    std::map<std::string, std::string> taken;
    for (const std::string &photo : options.photos)
    {
        const std::string result = (fs::path(options.folder) / fs::path(photo).filename()).string();
        const auto [other, added] = taken.emplace(result, photo);
        if (!added)
            throw Platform::fileError(result + ": would be the result of " + other->second + " and of " + photo);
        if (fs::equivalent(photo, result, unknown))
            throw Platform::fileError(result + ": the result would replace the photo");
        jobs.emplace_back(photo, result);
    }
    return jobs;
}

struct tally
{
    int done = 0;
    std::vector<std::string> failed; ///< a sentence each
    std::vector<std::string> json;
};

/// Adds one photo's outcome. What is cancelled ends it all.
void doOne(const removeOptions &job, int number, std::size_t count, runContext &context, tally &sum)
{
    context.bar.prefix(std::to_string(number) + "/" + std::to_string(count) + " ");
    runContext own{context.bar, {}};
    try
    {
        const commandResult result = removeBlur(job, own);
        ++sum.done;
        sum.json.push_back(result.json);
    }
    catch (const Platform::cancelled &)
    {
        throw;
    }
    catch (const std::bad_alloc &)
    {
        sum.failed.push_back(job.photo + ": not enough memory");
    }
    catch (const std::exception &e)
    {
        sum.failed.push_back(e.what());
    }
    context.notes.insert(context.notes.end(), own.notes.begin(), own.notes.end());
}

} // namespace

commandResult removeBlurFromAll(const batchOptions &options, runContext &context)
{
    const auto jobs = resultsOf(options);
    const stopwatch watch;
    tally sum;
    const auto first = static_cast<std::size_t>(options.shard - 1), step = static_cast<std::size_t>(options.shards);
    for (std::size_t i = first; i < jobs.size(); i += step)
    {
        removeOptions job = options.job;
        std::tie(job.photo, job.output) = jobs[i];
        doOne(job, static_cast<int>(i + 1), jobs.size(), context, sum);
    }

    std::vector<std::string> failures;
    for (const std::string &sentence : sum.failed)
    {
        context.notes.push_back("failed: " + sentence);
        failures.push_back(jsonString(sentence));
    }
    const auto failed = static_cast<int>(sum.failed.size());
    std::string text = std::to_string(sum.done) + " of " + std::to_string(sum.done + failed) + " photos done in " +
                       secondsText(watch.seconds()) + (failed != 0 ? ", " + std::to_string(failed) + " failed" : "");
    return {failed != 0 ? 1 : 0, std::move(text),
            jsonObject({{"photos", jsonArray(sum.json)},
                        {"failures", jsonArray(failures)},
                        {"done", jsonNumber(sum.done)},
                        {"failed", jsonNumber(failed)},
                        {"seconds", jsonNumber(watch.seconds())}})};
}

} // namespace Stillmark
