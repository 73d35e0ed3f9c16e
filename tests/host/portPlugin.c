/* A filter plug-in in plain C over nothing but the interface's header, for tests of the host: well behaved or not, as
 * portPluginTasks.h lists. */
#define STILLMARK_BUILDS_PLUGIN
#include "shell/tintorel.h"
#include "tests/host/portPluginTasks.h"

#include <pthread.h>
#include <stdio.h>
#include <string.h>

#define bandRows 16

static intptr_t numberOf(const TNPropertyProcs *properties, const TNHandleProcs *handles, uint32_t key)
{
    intptr_t number = 0;
    TNHandle text = NULL;
    if (properties->get(properties->context, TN_PROPERTY_SIGNATURE, key, 0, &number, &text) != TNNoError)
        return -1;
    if (text)
    {
        handles->dispose(handles->context, text);
        return -2;
    }
    return number;
}

static const void *acquire(const TNFilterBlock *block, const char *name, int32_t version)
{
    const void *suite = NULL;
    if (!block->suites || block->suites->acquire(block->suites->context, name, version, &suite) != TNNoError)
        return NULL;
    return suite;
}

static void release(const TNFilterBlock *block, const char *name, int32_t version, const void *suite)
{
    if (suite)
        block->suites->release(block->suites->context, name, version);
}

static TNError record(const TNFilterBlock *block, const TNDescriptorSuite *suite, int32_t samples)
{
    static const uint8_t bytes[5] = {1, 2, 3, 4, 5};
    TNDescriptor made = NULL, again = NULL;
    TNHandle handle = NULL;
    uint32_t keys = 0, key = 0;
    int32_t old = 0;
    TNError error = TNNoError;
    if (!suite || !block->descriptor)
        return TNNoError;
    if (block->descriptor->descriptor &&
        suite->fromHandle(suite->context, block->descriptor->descriptor, &again) == TNNoError && again)
    {
        /* What was recorded before counts on. */
        if (suite->count(suite->context, again, &keys) == TNNoError && keys == 3 &&
            suite->key(suite->context, again, 0, &key) == TNNoError &&
            suite->getInteger(suite->context, again, key, &old) == TNNoError && old > 0 && old < 1000000)
            samples += old;
        suite->free(suite->context, again);
    }
    error = suite->create(suite->context, &made);
    if (error != TNNoError || !made)
        return error;
    if ((error = suite->putInteger(suite->context, made, TN_CODE('s', 'm', 'p', 'l'), samples)) == TNNoError &&
        (error = suite->putBoolean(suite->context, made, TN_CODE('d', 'o', 'n', 'e'), 1)) == TNNoError &&
        (error = suite->putData(suite->context, made, TN_CODE('d', 'a', 't', 'a'), sizeof bytes, bytes)) == TNNoError)
        error = suite->toHandle(suite->context, made, &handle);
    suite->free(suite->context, made);
    if (error == TNNoError && handle)
        block->descriptor->descriptor = handle;
    return error;
}

/* Channel by channel in bands, each read, inverted and written. */
static TNError invertChannels(const TNFilterBlock *block, const TNChannelPortsSuite *ports,
                              const TNBufferSuite *buffers, int32_t *samples)
{
    const TNChannel *channel = block->document ? block->document->targetComposite : NULL;
    TNError error = TNNoError;
    for (; channel && error == TNNoError; channel = channel->next)
    {
        const int32_t width = channel->bounds.right - channel->bounds.left;
        const uint64_t bytes = (uint64_t)width * bandRows;
        TNRect32 band = channel->bounds;
        uint8_t *data = buffers->space(buffers->context) < bytes ? NULL : buffers->allocate(buffers->context, bytes);
        if (!data)
            return TNErrMemoryFull;
        for (; band.top < channel->bounds.bottom && error == TNNoError; band.top = band.bottom)
        {
            const TNPixelMemory memory = {data, 8, 8, (int64_t)width * 8};
            uint64_t i, count;
            band.bottom = band.top + bandRows < channel->bounds.bottom ? band.top + bandRows : channel->bounds.bottom;
            count = (uint64_t)width * (uint64_t)(band.bottom - band.top);
            block->progress(block->progressContext, band.top - channel->bounds.top,
                            channel->bounds.bottom - channel->bounds.top);
            if (block->testAbort(block->progressContext))
            {
                error = TNUserHasBeenTold;
                break;
            }
            error = ports ? ports->readPixels(ports->context, channel->readPort, &band, &memory)
                          : block->readPixels(block->pixelContext, channel->readPort, &band, &memory);
            if (error != TNNoError)
                break;
            for (i = 0; i < count; i++)
                data[i] = (uint8_t)(255 - data[i]);
            error = ports ? ports->writePixels(ports->context, channel->writePort, &band, &memory)
                          : block->writePixels(block->pixelContext, channel->writePort, &band, &memory);
            *samples += (int32_t)count;
        }
        buffers->dispose(buffers->context, data);
    }
    return error;
}

static TNError invert(const TNFilterBlock *block)
{
    const TNChannelPortsSuite *ports = acquire(block, TN_CHANNEL_PORTS_SUITE, 3);
    const TNBufferSuite *buffers = acquire(block, TN_BUFFER_SUITE, 1);
    const TNDescriptorSuite *descriptors = acquire(block, TN_DESCRIPTOR_SUITE, 5);
    const TNColorSpaceSuite *colours = acquire(block, TN_COLOR_SPACE_SUITE, 2);
    const TNHandle handle = block->handles->create(block->handles->context, 100);
    uint8_t quad[4] = {1, 2, 3, 4};
    int32_t samples = 0;
    TNError error = buffers && handle ? TNNoError : TNErrMemoryFull;

    block->properties->set(block->properties->context, TN_PROPERTY_SIGNATURE, TN_PROPERTY_WATCH, 0, 1);
    if (error == TNNoError && colours)
        error = colours->cmykToRgb8(colours->context, quad, 1);
    if (error == TNNoError)
        error = invertChannels(block, ports, buffers, &samples);
    if (error == TNNoError)
        error = record(block, descriptors, samples);

    block->handles->dispose(block->handles->context, handle);
    release(block, TN_COLOR_SPACE_SUITE, 2, colours);
    release(block, TN_DESCRIPTOR_SUITE, 5, descriptors);
    release(block, TN_BUFFER_SUITE, 1, buffers);
    release(block, TN_CHANNEL_PORTS_SUITE, 3, ports);
    return error;
}

static TNError tell(const TNFilterBlock *block, uint16_t selector)
{
    char text[200];
    const TNBounds32 *wide = block->bounds32;
    snprintf(text, sizeof text, "%u 16: %dx%d %d,%d,%d,%d", (unsigned)selector, block->imageSize.x, block->imageSize.y,
             block->filterRect.left, block->filterRect.top, block->filterRect.right, block->filterRect.bottom);
    if (wide)
        snprintf(text + strlen(text), sizeof text - strlen(text), " 32: %dx%d %d,%d,%d,%d", wide->imageSize.x,
                 wide->imageSize.y, wide->filterRect.left, wide->filterRect.top, wide->filterRect.right,
                 wide->filterRect.bottom);
    block->alerts->show(block->alerts->context, TNAlertOk, "tell", text, "");
    return TNNoError;
}

/* Takes one of each and gives it back so many times. */
static void giveBack(const TNFilterBlock *block, int times)
{
    const TNBufferSuite *buffers = acquire(block, TN_BUFFER_SUITE, 1);
    const TNDescriptorSuite *descriptors = acquire(block, TN_DESCRIPTOR_SUITE, 5);
    const TNHandle handle = block->handles->create(block->handles->context, 100);
    void *buffer = buffers->allocate(buffers->context, 1000);
    TNDescriptor descriptor = NULL;
    descriptors->create(descriptors->context, &descriptor);
    for (; times > 0; times--)
    {
        descriptors->free(descriptors->context, descriptor);
        buffers->dispose(buffers->context, buffer);
        block->handles->dispose(block->handles->context, handle);
        release(block, TN_DESCRIPTOR_SUITE, 5, descriptors);
        release(block, TN_BUFFER_SUITE, 1, buffers);
    }
}

static TNError readOnce(const TNFilterBlock *block, int32_t width, int32_t columnBits)
{
    uint8_t sample[16];
    const TNChannel *channel = block->document->targetComposite;
    const TNPixelMemory memory = {sample, 8, columnBits, 128};
    TNRect32 area = channel->bounds;
    area.right = area.left + width;
    area.bottom = area.top + 1;
    return block->readPixels(block->pixelContext, channel->readPort, &area, &memory);
}

struct onThread
{
    const TNFilterBlock *block;
    const TNColorSpaceSuite *colours;
    TNError converted;
};

static void *readAndConvert(void *context)
{
    struct onThread *work = context;
    uint16_t quad[4] = {1, 2, 3, 4};
    readOnce(work->block, 1, 8);
    work->converted = work->colours->cmykToRgb16(work->colours->context, quad, 1);
    return NULL;
}

static TNError useThread(const TNFilterBlock *block)
{
    struct onThread work = {block, acquire(block, TN_COLOR_SPACE_SUITE, 2), TNErrParameter};
    pthread_t thread;
    pthread_create(&thread, NULL, readAndConvert, &work);
    pthread_join(thread, NULL);
    release(block, TN_COLOR_SPACE_SUITE, 2, work.colours);
    return work.converted;
}

static TNError start(TNFilterBlock *block, intptr_t task)
{
    switch (task)
    {
    case taskInvert:
        return invert(block);
    case taskAsk:
        return block->alerts->show(block->alerts->context, TNAlertYesNo, "ask", "Really?", "Think.") == TNAnswerOk
                   ? TNNoError
                   : TNUserHasBeenTold;
    case taskLeak:
        giveBack(block, 0);
        return TNNoError;
    case taskTwice:
        giveBack(block, 2);
        return TNNoError;
    case taskBadRead:
        readOnce(block, 0, 8);
        return readOnce(block, 1, 7);
    case taskBadThread:
        return useThread(block);
    case taskBadHandleRecorded:
        block->descriptor->descriptor = (TNHandle)(void *)block;
        return TNNoError;
    case taskJunkRecorded:
        block->descriptor->descriptor = block->handles->create(block->handles->context, 100);
        return TNNoError;
    case taskDisposeRecorded:
        block->handles->dispose(block->handles->context, block->descriptor->descriptor);
        return TNNoError;
    default:
        return TNNoError;
    }
}

void EntryFI(uint16_t selector, void *anyBlock, intptr_t *data, int16_t *result)
{
    TNFilterBlock *block = anyBlock;
    const int16_t unwritten = *result;
    intptr_t task;
    *result = TNNoError;
    if (selector == TNSelectorAbout)
    {
        const TNAboutBlock *about = anyBlock;
        about->alerts->show(about->alerts->context, TNAlertOk, "about", "A plug-in", NULL);
        return;
    }
    /* Asked once a run, by the selector that comes first, and kept where the host keeps it. */
    if (*data == 0)
        *data = 1000 + numberOf(block->properties, block->handles, portPluginKey);
    task = *data - 1000;
    if (selector == TNSelectorPrepare && block->bounds32)
        block->bounds32->pluginUses = 1;
    if (task == taskTell || task >= taskFailAt)
        tell(block, selector);
    if (selector == TNSelectorStart)
        *result = start(block, task);
    if (task == taskFailAt + selector)
        *result = TNErrDiskFull;
    if (task == taskNoResult && selector == TNSelectorStart)
        *result = unwritten;
}
