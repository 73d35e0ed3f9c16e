#pragma once

#include "host/document/colourConverter.h"
#include "host/document/documentChannels.h"
#include "host/document/pictureResult.h"
#include "host/document/pictureSource.h"
#include "host/document/selectionMask.h"
#include "host/plugin/pluginPicture.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace Stillmark
{

/// A picture as a document of the C interface: one layer, which holds the picture's pixels, on a canvas of any size.
///
/// Samples. 8 bits are the picture's codes. 16-bit codes 0..65535 become 0..32768 by (code + 1) / 2. Going back, a
/// sample that is what the picture's own code becomes stays that code; another becomes 2s up to the middle and 2s - 1
/// above, which is the nearest code and differs by at most 1 from any code that would have become s. Floats pass bit
/// for bit. CMYK is turned around, so that the largest value is no ink.
///
/// Reading always gives the picture as it was, also where something has been written.
///
/// Lists: target, merged (what of the layer lies on the canvas), one layer, the selection (8 bits), alpha (planes after
/// transparency). Only the target's colours and transparency can be written, and only if there is a result.
///
/// One thread, the colour conversion excepted.
class hostDocument : public pluginPicture
{
public:
    /// Source, result and what settings point to outlive the document. result: null if nothing is to be written.
    /// Throws std::invalid_argument for 32-bit CMYK or Lab, which no image mode has, for a selection of another size
    /// than the source's, for a layer mask of another depth, and for coordinates that do not fit in 32 bits.
    hostDocument(pictureSource &shownSource, pictureResult *shownResult, const documentSettings &settings = {});

    TNImageMode imageMode() const override;
    TNPoint32 imageSize() const override { return channels.document()->size; }
    /// The bounds of what is selected, else the layer's.
    TNRect32 filterRect() const override;
    const TNDocument *document() const override { return channels.document(); }

    /// The block's autoMask, looked at with each write while the document is used: not 0 blends what is written into
    /// the picture by the selection. null, the default: no blending.
    void watchAutoMask(const std::uint8_t *blockAutoMask) override { autoMask = blockAutoMask; }

    /// TNErrParameter for a port that is not the document's or not made for this, a rectangle that is empty or not
    /// within the channel's bounds, missing memory, another depth than the channel's, and strides that are not above 0
    /// or no multiples of the depth. Throws what source and result throw.
    TNError readPixels(TNPort port, const TNRect32 &area, const TNPixelMemory &destination) override;
    TNError writePixels(TNPort port, const TNRect32 &area, const TNPixelMemory &source) override;

    TNError cmykToRgb8(std::uint8_t *quads, std::uint64_t pixels) override;
    TNError cmykToRgb16(std::uint16_t *quads, std::uint64_t pixels) override;

private:
    void readBand(const documentPort &from, const rectangle &band, const TNPixelMemory &to);
    void writeBand(const documentPort &to, const rectangle &band, const TNPixelMemory &from);
    planeSamples codesOf(const documentPort &port, const rectangle &band);

    pictureSource &source;
    pictureResult *result;
    const selectionMask *selection;
    pictureSource *layerMask;
    documentChannels channels;
    colourConverter converter;
    const std::uint8_t *autoMask = nullptr;
    std::vector<std::byte> codes;           ///< of a band that is being written
    std::vector<std::uint8_t> selectedRows; ///< of a band
};

} // namespace Stillmark
