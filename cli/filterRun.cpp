#include "cli/filterRun.h"

#include "cli/settingsFolder.h"
#include "cli/stopSignal.h"
#include "cli/stopwatch.h"
#include "host/document/hostDocument.h"
#include "host/document/photoSource.h"
#include "host/plugin/pluginHost.h"
#include "host/plugin/pluginLibrary.h"

#include <filesystem>
#include <stdexcept>

namespace Stillmark
{
namespace
{

/// Passes writes on, and notes when the first one comes.
class watchedResult final : public pictureResult
{
public:
    watchedResult(pictureResult &to, progressBar &shown) : result(to), bar(shown) {}

    void write(int plane, const rectangle &area, const planeSamples &codes) override
    {
        if (first < 0)
        {
            first = watch.seconds();
            bar.stage("Removing the blur");
        }
        result.write(plane, area, codes);
    }

    double untilFirst() const { return first < 0 ? watch.seconds() : first; }
    double sinceFirst() const { return first < 0 ? 0 : watch.seconds() - first; }

private:
    pictureResult &result;
    progressBar &bar;
    stopwatch watch;
    double first = -1;
};

std::string sentence(const hostAlert &alert)
{
    return alert.second.empty() ? alert.first : alert.first + " " + alert.second;
}

/// A failed run's reason, in the plug-in's words or the host's.
[[noreturn]] void fail(const std::string &path, const hostOutcome &outcome)
{
    stopSignal::check();
    std::string reason = outcome.hostSentence();
    for (const hostAlert &alert : outcome.alerts)
        reason +=
            (reason.empty() ? "" : " ") + sentence(alert) + (alert.kind == TNAlertYesNo ? " (--yes says yes)" : "");
    throw std::runtime_error(path + ": " + (reason.empty() ? "the filter has stopped" : reason));
}

} // namespace

std::string pluginPath()
{
    namespace fs = std::filesystem;
    const fs::path folder = fs::read_symlink("/proc/self/exe").parent_path();
    const fs::path places[] = {folder / "stillmark.tnf", folder.parent_path() / "lib" / "stillmark" / "stillmark.tnf"};
    for (const fs::path &place : places)
        if (fs::exists(place))
            return place.string();
    throw Platform::fileError(places[0].string() + ": the plug-in is missing");
}

filterAnswer runFilter(const photo &picture, resultRaster &result, const filterJob &job, runContext &context)
{
    const settingsFolder settings;
    // Never unloaded: threads of the pool may still be leaving its code.
    static const pluginLibrary plugin(pluginPath());

    photoSource source(picture);
    watchedResult written(result, context.bar);
    documentSettings shown;
    shown.selection = job.selection;
    shown.profile = picture.profile();
    hostDocument document(source, &written, shown);

    hostOptions options;
    options.playing = true;
    options.action = &job.action;
    if (job.yes)
        options.answers.assign(8, TNAnswerOk); // more than a run has questions
    options.abort = [] { return stopSignal::requested().load(); };
    options.progress = [&](std::int64_t done, std::int64_t total) {
        context.bar.set(static_cast<double>(done) / static_cast<double>(std::max<std::int64_t>(total, 1)));
    };
    options.alert = [](const hostAlert &) {}; // told with the outcome

    context.bar.stage("Finding the blur");
    const hostOutcome outcome = runPlugin(plugin.entry(), document, options);
    if (!outcome.done())
        fail(picture.path(), outcome);
    for (const hostAlert &alert : outcome.alerts)
        context.notes.push_back(picture.path() + ": " + sentence(alert));
    return {outcome.recorded.value_or(job.action), written.untilFirst(), written.sinceFirst()};
}

} // namespace Stillmark
