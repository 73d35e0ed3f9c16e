#pragma once

#include "deblur/estimate/floatArray.h"
#include "framework/pixels/rect.h"
#include "store/preferences.h"
#include "store/traces/kernel.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

/// What a file holds, for people who wonder: a workspace, a trace, a trace picture, a preferences file.
namespace Project
{

struct PInspectedTrace
{
    PKernelKind kind;
    Sarnik::CRect region;
    KernelSettings settings;
    CorvaneDeblur::floatArray kernel; ///< empty when the trace has not been estimated yet
    /// It would be used in a result without the user's insisting.
    bool reliable = false;
    /// Of a trace drawn by hand.
    std::optional<std::pair<PLinePoint, PLinePoint>> line;
};

struct PInspection
{
    enum class Kind
    {
        Workspace,
        Trace,
        Picture,
        Preferences,
        Unknown
    };

    std::string file; ///< its name without the folder
    Kind kind = Kind::Unknown;
    /// The picture for which it was loaded; none for a picture or preferences without an image size.
    std::optional<Sarnik::CRect> bounds;
    bool result = false;                  ///< the loader's answer
    std::string error;                    ///< what the user would be told
    std::optional<std::uint32_t> version; ///< of the format; a trace picture has none
    std::int32_t selected = -1;           ///< as the file says, lowered for rejected traces
    std::vector<std::int32_t> active;     ///< indices of traces in ascending order; then -1, if any named no trace
    std::uint32_t defaultSize = 0;        ///< the Blur Trace Bounds that were found automatically; 0 for none
    std::vector<PInspectedTrace> traces;
    std::unique_ptr<PPreferences> preferences;
};

struct PImageSize
{
    std::int32_t width = 0, height = 0;
};

/// Loads the file by the program's own loaders as for a picture of this size whose origin is 0, 0. Without a size a
/// workspace or a trace file is loaded for a picture of the size that it says itself, and the region of a trace picture
/// counts from the middle of the picture. The kind follows from the name's extension, that of preferences from the
/// content, too. Throws Platform::fileError if the file cannot be read at all.
PInspection InspectFile(const std::string &path, std::optional<PImageSize> size = {});

/// In words, several lines, each ended by a line feed.
std::string DescribeInspection(const PInspection &inspection);

/// One JSON object (docs/files/traces.md, "In JSON").
std::string InspectionJson(const PInspection &inspection);

} // namespace Project
