#pragma once

#include "store/params.h"

#include <string>

/// What the two dialogs that edit the parameter record do with it, apart from their windows.
namespace Project
{

// The developer's dialog of experimental parameters edits a record of its own.

/// Popup items count from 1; an item that a popup has not gives its first value, and 128 for the tile size.
std::uint32_t PyramidSmoothOfItem(int item);    ///< None, Gaussian, Bilateral
std::uint32_t PredictorDenoiseOfItem(int item); ///< Bilateral, Guided
std::uint32_t DerivativesTypeOfItem(int item);  ///< First order, Second order
std::uint32_t DeconvTypeOfItem(int item);       ///< Fast hyper laplacian old, Fast hyper laplacian
std::uint32_t TileSizeOfItem(int item);         ///< 64, 128, 256, 512, 1024

/// Opening: what the controls show, taken from the real record.
void FillExperimental(PParams &edited, const PParams &real);

enum class ExperimentalOk
{
    Closes,         ///< all is stored; the preview has to start again
    InvalidChannels ///< an alert, the focus on the channels' field, the dialog stays open
};
/// OK. All but the channels is stored first and stays stored when their text is refused.
ExperimentalOk AcceptExperimental(PParams &edited, const std::string &channelsText, PParams &real);

/// Reset. A set of values of its own: two of them are not those of a new record, and derivativesType and the channels
/// stay.
void ResetExperimental(PParams &edited);

// The preferences dialog has one check box, Enable Accurate Preview.

/// OK. True when the value changed and the preview has to be made again.
bool AcceptPreferences(bool accuratePreview, PParams &real);

/// What Reset puts into the box.
constexpr bool kResetAccuratePreview = true;

} // namespace Project
