#include "host/document/resultRaster.h"

namespace Stillmark
{

void resultRaster::start()
{
    if (!started)
        writer.takeModelPixels();
    started = true;
}

void resultRaster::write(int plane, const rectangle &area, const planeSamples &codes)
{
    start();
    writer.replacePlane(plane, area, codes.data, codes.rowBytes);
}

void resultRaster::commit(const progressCheck &progress)
{
    start();
    writer.commit(progress);
}

} // namespace Stillmark
