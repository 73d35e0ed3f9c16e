/* The smallest host there can be: plain C that links nothing of ours, no suites, a grey picture in memory. It loads the
 * plug-in, runs every selector, and checks what a host may rely on.
 *
 *     plainHost PLUGIN
 */
#include "shell/tintorel.h"

#include <dlfcn.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>

enum
{
    width = 96,
    height = 80
};

static uint8_t picture[height][width], result[height][width];
static int failures;

static void expect(int holds, const char *what)
{
    if (!holds)
    {
        fprintf(stderr, "plainHost: not so: %s\n", what);
        ++failures;
    }
}

static TNError transfer(const TNRect32 *rect, uint8_t *memory, const TNPixelMemory *layout, int reading)
{
    if (layout->depth != 8 || rect->left < 0 || rect->top < 0 || rect->right > width || rect->bottom > height)
        return TNErrParameter;
    for (int y = rect->top; y < rect->bottom; ++y)
        for (int x = rect->left; x < rect->right; ++x)
        {
            uint8_t *sample =
                memory + (y - rect->top) * (layout->rowBits / 8) + (x - rect->left) * (layout->columnBits / 8);
            if (reading)
                *sample = picture[y][x];
            else
                result[y][x] = *sample;
        }
    return TNNoError;
}

static TNError readPixels(void *context, TNPort port, const TNRect32 *rect, const TNPixelMemory *to)
{
    (void)context, (void)port;
    return transfer(rect, to->data, to, 1);
}

static TNError writePixels(void *context, TNPort port, const TNRect32 *rect, const TNPixelMemory *from)
{
    (void)context, (void)port;
    return transfer(rect, from->data, from, 0);
}

static TNError getProperty(void *context, uint32_t signature, uint32_t key, int32_t index, intptr_t *number,
                           TNHandle *text)
{
    (void)context, (void)index;
    *text = NULL;
    if (signature != TN_PROPERTY_SIGNATURE || key != TN_PROPERTY_VERSION)
        return TNErrParameter;
    *number = 14 << 16;
    return TNNoError;
}

static TNError setProperty(void *context, uint32_t signature, uint32_t key, int32_t index, intptr_t number)
{
    (void)context, (void)signature, (void)key, (void)index, (void)number;
    return TNErrParameter;
}

static int16_t call(TNEntry entry, uint16_t selector, void *block)
{
    static intptr_t data = 42;
    int16_t answer = 77;
    entry(selector, block, &data, &answer);
    return answer;
}

static void wholeRun(TNEntry entry)
{
    static struct TNPortData *const port = (struct TNPortData *)&picture;
    const TNChannel channel = {
        .bounds = {0, 0, width, height}, .depth = 8, .present = 1, .readPort = port, .writePort = port};
    const TNDocument document = {
        .version = 4, .depth = 8, .size = {width, height}, .targetComposite = &channel, .mergedComposite = &channel};
    const TNPropertyProcs properties = {.get = getProperty, .set = setProperty};
    TNFilterBlock block = {.size = sizeof block,
                           .imageMode = TNModeGrey,
                           .imageSize = {width, height},
                           .filterRect = {0, 0, width, height},
                           .maxSpace = 64 << 20,
                           .properties = &properties,
                           .document = &document,
                           .readPixels = readPixels,
                           .writePixels = writePixels};
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x)
            picture[y][x] = (uint8_t)(x / 8 + y / 8) % 2 ? 200 : (uint8_t)(40 + x);

    expect(call(entry, TNSelectorPrepare, &block) == 0, "Prepare answers 0");
    expect(call(entry, TNSelectorStart, &block) == 0, "Start answers 0");
    expect(call(entry, TNSelectorContinue, &block) == 0, "Continue answers 0");
    expect(call(entry, TNSelectorFinish, &block) == 0, "Finish answers 0");
    int written = 0;
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x)
            written += result[y][x] != 0;
    expect(written == width * height, "every pixel was written");

    /* A picture that is too small: told on stderr, result 1, and Finish has nothing left to do. */
    block.filterRect.right = 49;
    expect(call(entry, TNSelectorPrepare, &block) == 0, "Prepare answers 0 for a small picture");
    expect(call(entry, TNSelectorStart, &block) == 1, "Start answers 1 for a small picture");
    expect(call(entry, TNSelectorFinish, &block) == 0, "Finish after a failed Start answers 0");
}

int main(int argc, char **argv)
{
    void *library = argc == 2 ? dlopen(argv[1], RTLD_NOW | RTLD_LOCAL) : NULL;
    if (!library)
    {
        fprintf(stderr, "plainHost: %s\n", argc == 2 ? dlerror() : "usage: plainHost PLUGIN");
        return 2;
    }
    TNEntry entry;
    *(void **)&entry = dlsym(library, TN_ENTRY_NAME);
    if (!entry)
        return 2;

    TNAboutBlock about = {.size = sizeof about};
    expect(call(entry, TNSelectorAbout, &about) == 0, "About answers 0");
    expect(call(entry, TNSelectorStart, NULL) == TNErrParameter, "no block is a parameter error");
    about.size = 4;
    expect(call(entry, TNSelectorAbout, &about) == TNErrParameter, "a block that is too short is a parameter error");
    expect(call(entry, 6, NULL) == 0, "an unknown selector answers 0");
    wholeRun(entry);
    wholeRun(entry);
    return failures ? EXIT_FAILURE : EXIT_SUCCESS;
}
