#pragma once

#include "store/kernelSettings.h"

#include <cstdint>
#include <string>
#include <vector>

namespace Sarnik
{
class CContainer;
}

namespace Project
{

/// The parameter record: everything that steers a run. A filter has one for the run, the preferences hold one that
/// persists, a dialog edits one of its own.
///
/// Written on the main thread. Estimations and previews read it while they run; whoever changes a field stops or
/// restarts the work that depends on it first.
struct PParams
{
    /// planeCount: planes of the picture's colour mode, for deconvChannels.
    explicit PParams(int planeCount = 3);

    /// Not a plain copy. What a user sees and what a run must carry along is taken over: version, the preview's flags,
    /// the names, the colour, the count, the panes, randomKernelLevel and previewCap. The settings of new traces and
    /// the other experimental fields, tileSize among them, start afresh; the developer's menus and log are off.
    explicit PParams(const PParams &other);
    PParams &operator=(const PParams &) = delete;

    std::uint32_t version = 0; ///< of the stored record that was read last; decides what ReadParameters expects
    bool showPreview = true;
    bool showRegions = true;
    bool fineResult = true;        ///< Artifact Suppression: deconvolution by deconvType; off: Wiener
    std::string lastFolder;        ///< of the last file dialog, UTF-8
    std::string lastWorkspaceName; ///< offered by the workspace's save dialog
    std::string lastTraceName;     ///< offered by the trace's save dialog, with the extension
    std::string lastTraceExtension = ".knl";
    KernelSettings defaultSettings;            ///< of a new trace
    std::uint32_t overflowColour = 0xFFFF0000; ///< four bytes shown where a preview's colours leave their range
    std::uint32_t autoTraceCount = 1;          ///< traces that an automatic run adds; as read, without a limit
    bool advancedOpen = false;
    bool previewWindowOpen = false;
    bool accuratePreview = true;
    bool behaviorMenus = false;      ///< the menu offers the developer's dialogs
    bool outputLog = false;          ///< the time log is written
    std::uint32_t pyramidSmooth = 1; ///< of the estimator's levels: 0 none, 1 Gaussian, 2 bilateral
    float smoothParameter1 = 1.0f;
    float smoothParameter2 = 0.0f;
    std::uint32_t predictorDenoise = 0;        ///< 0 bilateral, 1 guided
    std::int32_t pyramidLevel = 0;             ///< 0..10: finest levels that the estimator leaves out
    std::vector<std::uint32_t> deconvChannels; ///< planes to deconvolve; numbers that are no plane do nothing
    std::uint32_t tileSize = 512;              ///< as read; see HubTileSize
    std::uint32_t derivativesType = 0;         ///< order of the derivatives: 0 first, 1 second
    std::uint32_t deconvType = 2;              ///< 0 Wiener, 1 classic, 2 fast; any other acts as 1
    std::int32_t randomKernelLevel = 0;        ///< coarsest levels that search from seeds
    std::int32_t previewCap = 1250;            ///< largest side of the fast preview's picture

    /// Tile size of the image hub: tileSize, or 512 where that is 0.
    std::uint32_t HubTileSize() const { return tileSize == 0 ? 512 : tileSize; }

private:
    int planes;
};

/// Between the preferences' record, the run's and a replay's: copies what persists, and derivativesType.
void CopySelected(PParams &to, const PParams &from);

/// The version that WriteParameters writes.
constexpr std::uint32_t kParametersVersion = 1;

/// The persistent part as bytes (docs/files/preferences.md, "Parameters"), in the preferences and in a recorded action.
void WriteParameters(Sarnik::CContainer &out, const PParams &parameters);
/// Reads by parameters.version, which the caller sets. Throws CError at the end of the data; fields before that place
/// have changed then.
void ReadParameters(Sarnik::CContainer &in, PParams &parameters);

} // namespace Project
