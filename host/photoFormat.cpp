#include "host/photoFormat.h"

#include <algorithm>
#include <cctype>
#include <limits>
#include <utility>

namespace Stillmark
{

namespace
{

constexpr int unlimited = std::numeric_limits<int>::max();

// The largest sides are those of the formats' own libraries.
constexpr photoFormat formats[] = {
    {photoFormat::kind::jpeg, "JPEG", 8, 8, true, false, 0, 65500},
    {photoFormat::kind::png, "PNG", 8, 16, false, false, 1, unlimited},
    {photoFormat::kind::tiff, "TIFF", 8, 32, true, true, unlimited, unlimited},
    {photoFormat::kind::webp, "WebP", 8, 8, false, false, 1, 16383},
    {photoFormat::kind::floatMap, "A float map", 32, 32, false, false, 0, unlimited},
};

constexpr std::pair<const char *, photoFormat::kind> extensions[] = {
    {".jpg", photoFormat::kind::jpeg},     {".jpeg", photoFormat::kind::jpeg}, {".png", photoFormat::kind::png},
    {".tif", photoFormat::kind::tiff},     {".tiff", photoFormat::kind::tiff}, {".webp", photoFormat::kind::webp},
    {".pfm", photoFormat::kind::floatMap},
};

} // namespace

const photoFormat &formatForPath(const std::string &path)
{
    const std::string name = path.substr(path.rfind('/') + 1);
    const std::size_t dot = name.rfind('.');
    std::string extension = dot == std::string::npos || dot == 0 ? "" : name.substr(dot);
    std::transform(extension.begin(), extension.end(), extension.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    for (const auto &[known, kind] : extensions)
        if (extension == known)
            return formats[static_cast<std::size_t>(kind)];
    throw Platform::fileError(path + ": cannot be written: its name ends in none of .jpg .jpeg .png .tif .tiff .webp "
                                     ".pfm");
}

savePlan planSaving(const photo &model, const photoFormat &format, const std::string &path)
{
    if (std::max(model.width(), model.height()) > format.largestSide)
        throw Platform::fileError(path + ": cannot be written: " + format.name + " holds at most " +
                                  std::to_string(format.largestSide) + " pixels a side, the picture has " +
                                  std::to_string(model.width()) + " x " + std::to_string(model.height()));
    savePlan plan;
    const std::string holds = std::string(format.name) + " holds ";

    plan.depth = std::clamp(model.depth(), format.leastDepth, format.mostDepth);
    if (plan.depth < model.depth())
        plan.notes.push_back(holds + (plan.depth == 8 ? "8" : "16") + " bits a channel: the picture is reduced from " +
                             std::to_string(model.depth()) + ".");

    if (model.mode() == colourMode::cmyk && !format.cmyk)
    {
        plan.toRgb = true;
        plan.notes.push_back(holds + "no CMYK: the picture is converted to sRGB.");
    }
    if (model.mode() == colourMode::lab && !format.lab)
    {
        plan.toRgb = true;
        plan.notes.push_back(holds + "no Lab: the picture is converted to sRGB.");
    }

    plan.extraPlanes = std::min(model.extraPlanes(), format.mostExtraPlanes);
    if (model.hasTransparency() && plan.extraPlanes == 0)
    {
        plan.flatten = format.id == photoFormat::kind::jpeg;
        plan.notes.push_back(
            holds + "no transparency: " + (plan.flatten ? "the picture is laid over white." : "it is left out."));
    }
    if (model.extraPlanes() > std::max(plan.extraPlanes, 1))
        plan.notes.push_back(holds + "no further masks: they are left out.");
    return plan;
}

} // namespace Stillmark
