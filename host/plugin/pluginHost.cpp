#include "host/plugin/pluginHost.h"

#include "host/plugin/hostRun.h"
#include "host/plugin/pixelTable.h"

#include <algorithm>
#include <new>

namespace Stillmark
{
namespace
{

bool fits16(std::int32_t number)
{
    return number >= INT16_MIN && number <= INT16_MAX;
}

TNPoint16 to16(TNPoint32 point)
{
    if (!fits16(point.x) || !fits16(point.y))
        return {};
    return {static_cast<std::int16_t>(point.x), static_cast<std::int16_t>(point.y)};
}

TNRect16 to16(TNRect32 rect)
{
    if (!fits16(rect.left) || !fits16(rect.top) || !fits16(rect.right) || !fits16(rect.bottom))
        return {};
    return {static_cast<std::int16_t>(rect.left), static_cast<std::int16_t>(rect.top),
            static_cast<std::int16_t>(rect.right), static_cast<std::int16_t>(rect.bottom)};
}

/// The filter block of one run, and what it points to.
class filterRun
{
public:
    filterRun(TNEntry entry, pluginPicture &shownPicture, const hostOptions &options, faultScript *faults)
        : run(entry, options, faults), picture(shownPicture), pixels(run.state, picture)
    {
        run.offer(TN_CHANNEL_PORTS_SUITE, 3, pixels.ports());
        run.offer(TN_COLOR_SPACE_SUITE, 2, pixels.colours());
        fillPicture();
        fillTables();
        fillProgress();
        if (options.scripting)
            fillSlot();
        picture.watchAutoMask(&block.autoMask);
    }
    filterRun(const filterRun &) = delete;
    filterRun &operator=(const filterRun &) = delete;
    ~filterRun() { picture.watchAutoMask(nullptr); }

    hostOutcome drive()
    {
        const auto call = [&](TNSelector selector) {
            const bool good = run.call(selector, &block);
            fillBounds32();
            return good;
        };
        const bool started = (!run.options.interactive || call(TNSelectorParameters)) && call(TNSelectorPrepare) &&
                             call(TNSelectorStart);
        if (started && run.options.continues)
            call(TNSelectorContinue);
        if (started)
            call(TNSelectorFinish);

        takeRecorded();
        run.outcome.wrote = pixels.wrote();
        return run.end();
    }

private:
    void fillPicture()
    {
        block.size = sizeof block;
        block.imageMode = static_cast<std::int16_t>(picture.imageMode());
        block.imageSize = to16(picture.imageSize());
        block.filterRect = to16(picture.filterRect());
        if (run.options.bounds32)
            block.bounds32 = &bounds32;
        block.document = picture.document();
        block.autoMask = 1;

        const std::int64_t half = static_cast<std::int64_t>(mostHostMemory() / 2);
        block.maxSpace = run.options.maxSpace > 0 ? run.options.maxSpace : half;
        for (const std::string &folder : run.options.scratchFolders)
            folders.push_back(folder.c_str());
        block.scratchFolders = folders.data();
        block.scratchFolderCount = static_cast<std::uint32_t>(folders.size());
    }

    void fillTables()
    {
        block.properties = run.properties.procs();
        block.suites = run.suiteProcs();
        block.handles = run.handles.procs();
        block.alerts = run.alertProcs();
        if (run.options.blockPixels)
        {
            block.pixelContext = pixels.ports()->context;
            block.readPixels = pixels.ports()->readPixels;
            block.writePixels = pixels.ports()->writePixels;
        }
    }

    void fillProgress()
    {
        block.progressContext = &run;
        block.progress = [](void *context, std::int64_t done, std::int64_t total) {
            hostRun &its = *static_cast<hostRun *>(context);
            its.state.code("progress", [&] {
                if (its.options.progress && total > 0)
                    its.options.progress(std::clamp(done, std::int64_t{0}, total), total);
                return TNNoError;
            });
        };
        block.testAbort = [](void *context) {
            hostRun &its = *static_cast<hostRun *>(context);
            const bool stop = its.state.value("testAbort", true, [&] {
                const hostLie lie = its.state.lie(hostCall::abort);
                return lie.fails() || lie.raves() || its.state.failed() || (its.options.abort && its.options.abort());
            });
            return static_cast<std::uint8_t>(stop);
        };
    }

    void fillSlot()
    {
        block.descriptor = &slot;
        if (!run.options.action)
            return;
        slot.descriptor = given = run.handles.create(run.options.action->bytes());
        if (!given)
            throw std::bad_alloc();
    }

    void fillBounds32()
    {
        if (!bounds32.pluginUses)
            return;
        bounds32.imageSize = picture.imageSize();
        bounds32.filterRect = picture.filterRect();
    }

    /// What stands in the slot is the host's, whoever made it.
    void takeRecorded()
    {
        if (slot.descriptor && slot.descriptor != given)
        {
            if (!run.handles.lives(slot.descriptor))
                run.state.misuse("the recorded action is no handle that lives");
            else if (run.outcome.done())
                parseRecorded();
            run.handles.dispose(slot.descriptor);
        }
        if (given && !run.handles.lives(given))
            run.state.misuse("the host's recorded action was disposed of");
        run.handles.dispose(given);
    }

    void parseRecorded()
    {
        try
        {
            run.outcome.recorded = recordedAction::fromBytes(run.handles.bytes(slot.descriptor));
        }
        catch (const recordedAction::formatError &error)
        {
            run.state.misuse(std::string("what was recorded ") + error.what());
        }
    }

    hostRun run;
    pluginPicture &picture;
    pixelTable pixels;
    std::vector<const char *> folders;
    TNBounds32 bounds32{};
    TNDescriptorSlot slot{};
    TNHandle given = nullptr; ///< what the slot held at first
    TNFilterBlock block{};
};

} // namespace

hostOutcome runPlugin(TNEntry entry, pluginPicture &picture, const hostOptions &options, faultScript *faults)
{
    return filterRun(entry, picture, options, faults).drive();
}

hostOutcome runAbout(TNEntry entry, const hostOptions &options, faultScript *faults)
{
    hostRun run(entry, options, faults);
    TNAboutBlock block{};
    block.size = sizeof block;
    block.properties = run.properties.procs();
    block.suites = run.suiteProcs();
    block.handles = run.handles.procs();
    block.alerts = run.alertProcs();
    run.call(TNSelectorAbout, &block);
    return run.end();
}

} // namespace Stillmark
