#pragma once

#include "host/photo.h"

#include <string>
#include <vector>

namespace Stillmark
{

/// A kind of file that results are saved as, and what it can hold.
struct photoFormat
{
    enum class kind
    {
        jpeg,
        png,
        tiff,
        webp,
        floatMap
    };

    kind id;
    const char *name; ///< with its article where a sentence starts
    int leastDepth, mostDepth;
    bool cmyk, lab;
    int mostExtraPlanes;
    int largestSide;
};

/// The format that a file name's extension stands for, upper or lower case. Throws Platform::fileError for others.
const photoFormat &formatForPath(const std::string &path);

/// What a picture becomes in a format, and the sentences that tell the user.
struct savePlan
{
    int depth = 8;        ///< of the saved samples
    bool toRgb = false;   ///< CMYK or Lab is converted to sRGB
    int extraPlanes = 0;  ///< that are saved
    bool flatten = false; ///< the first extra plane is transparency over white
    std::vector<std::string> notes;
};

/// Throws Platform::fileError if the format takes no picture of that size.
savePlan planSaving(const photo &model, const photoFormat &format, const std::string &path);

} // namespace Stillmark
