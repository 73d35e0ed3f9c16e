#pragma once

#include "host/plugin/pluginPicture.h"
#include "host/plugin/runState.h"
#include "shell/tintorel.h"

namespace Stillmark
{

/// The channel ports suite and the colour space suite of one run, over its picture.
class pixelTable
{
public:
    pixelTable(runState &run, pluginPicture &shownPicture);
    pixelTable(const pixelTable &) = delete;
    pixelTable &operator=(const pixelTable &) = delete;

    const TNChannelPortsSuite *ports() const { return &portsTable; }
    const TNColorSpaceSuite *colours() const { return &coloursTable; }
    bool wrote() const { return written; }

private:
    bool sound(const char *function, const TNRect32 *area, const TNPixelMemory *memory);
    TNError read(TNPort port, const TNRect32 *area, const TNPixelMemory *destination);
    TNError write(TNPort port, const TNRect32 *area, const TNPixelMemory *source);

    runState &state;
    pluginPicture &picture;
    TNChannelPortsSuite portsTable;
    TNColorSpaceSuite coloursTable;
    bool written = false;
};

} // namespace Stillmark
