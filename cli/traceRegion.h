#pragma once

#include "deblur/estimate/regionRect.h"
#include "host/photo.h"

/// Where the blur is looked for.
namespace Stillmark
{

CorvaneDeblur::regionRect toEngine(const rectangle &area);
rectangle fromEngine(const CorvaneDeblur::regionRect &region);
rectangle wholeOf(const photo &picture);

/// "x,y,width,height", as the command line takes it.
std::string regionText(const rectangle &area);

/// Throws Platform::fileError unless the region lies within the area, which is the picture or the bounds of what is
/// selected in it.
void requireInside(const photo &picture, const rectangle &area, const rectangle &region);

/// Makes drawn, which lies in the area, at least three times as wide and high as a kernel of `size`: by the same amount
/// on every side, then moved into the area and cut where it is still too large.
rectangle grownRegion(const rectangle &drawn, int size, const rectangle &area);

/// Pixels that a region needs on each side for a kernel of `size`.
constexpr int imageToKernelRatio = 3;

/// grownRegion; throws Platform::fileError if the area has no room for the kernel.
rectangle regionFor(const photo &picture, const rectangle &area, const rectangle &drawn, int size);

} // namespace Stillmark
