#pragma once

#include "cli/runContext.h"
#include "deblur/deconv/cellRenderer.h"
#include "host/document/resultRaster.h"
#include "host/photo.h"
#include "host/photoWriter.h"

#include <string>
#include <vector>

namespace Stillmark
{

/// How the blur is removed.
struct renderSettings
{
    CorvaneDeblur::deconvolutionMethod method = CorvaneDeblur::deconvolutionMethod::fast;
    std::vector<CorvaneDeblur::latentKernel> kernels; ///< at least one
    int cellSize = 512;
};

/// Removes the blur from all colour planes of a photo and saves the result; transparency stays as it is. Throws
/// Platform::fileError or Platform::cancelled, and then has left the target untouched.
void renderPhoto(const photo &picture, photoWriter &result, const renderSettings &settings, runContext &context);

/// Saves what a run of the plug-in wrote. Throws as above.
void saveResult(resultRaster &result, runContext &context);

/// Saves the photo as it is: byte by byte where path has its extension, otherwise converted to the other format.
void savePhotoUnchanged(const photo &picture, const std::string &path, runContext &context);

} // namespace Stillmark
