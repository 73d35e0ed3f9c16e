#pragma once

#include "host/photoContent.h"
#include "host/photoFormat.h"
#include "platform/files.h"

namespace Stillmark
{

/// Encodes the pixels of a result, with the metadata of its model, into a file that is not yet in place. Throws
/// Platform::fileError, for which shownPath names the file, and Platform::cancelled.
void savePicture(const sampleRaster &pixels, const photo::content &model, const photoFormat &format,
                 const savePlan &plan, Platform::atomicFile &file, const std::string &shownPath,
                 const progressCheck &progress);

} // namespace Stillmark
