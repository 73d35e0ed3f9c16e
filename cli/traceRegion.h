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

/// Throws Platform::fileError unless area lies within the picture.
void requireInside(const photo &picture, const rectangle &area);

/// Makes drawn, which lies in a picture of cols x rows, at least three times as wide and high as a kernel of `size`:
/// by the same amount on every side, then moved into the picture and cut where it is still too large.
rectangle grownRegion(const rectangle &drawn, int size, int cols, int rows);

/// Pixels that a region needs on each side for a kernel of `size`.
constexpr int imageToKernelRatio = 3;

/// grownRegion; throws Platform::fileError if the picture has no room for the kernel.
rectangle regionFor(const photo &picture, const rectangle &drawn, int size);

} // namespace Stillmark
