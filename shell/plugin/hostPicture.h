#pragma once

#include "shell/blockChannels.h"
#include "stages/stageHost.h"
#include "store/traces/tracePicture.h"

#include <cstdint>
#include <optional>

namespace Project
{

class PFilter;

/// The host's picture and its callbacks as the stages and the traces see them. What is to be filtered counts as the
/// whole picture: the selection's bounding rectangle where there is a selection. Main thread; the filter outlives it,
/// and the block is the one that it works on.
class PHostPicture final : public PStageHost, public PTracePicture
{
public:
    PHostPicture(PFilter &owner, const TNFilterBlock &filterBlock, const TNChannelPortsSuite *ports);

    /// The host's colour space suite, while a run has it; null otherwise. CMYK counts as RGB without it.
    void SetColourSuite(const TNColorSpaceSuite *suite);

    Sarnik::CImageFormat Format() const override { return channels.Format(); }
    Sarnik::CRect ImageBounds() const override { return Sarnik::ImageBounds(block); }
    Sarnik::CRect SelectionBounds() const override { return ImageBounds(); }
    bool HasSelection() const override { return channels.HasSelection(); }
    bool HasTransparency() const override { return channels.HasTransparency(); }
    void ReadSource(Sarnik::CBasicPixmap &pixmap) override;
    void ReadSelection(Sarnik::CBasicPixmap &pixmap, int plane) override;
    void Write(Sarnik::CBasicPixmap &pixmap, const Sarnik::CRect &rect) override;
    Sarnik::CQuadConverter *CmykConverter() override { return converter ? &*converter : nullptr; }
    Sarnik::CPageStore &PageStore() override;
    PParams &Params() override;
    PKernelCollection &Kernels() override;
    /// The second half of the host's bar where traces were estimated before, else the whole of it.
    void Progress(std::uint64_t done, std::uint64_t total) override;
    bool Abort() override;

    Sarnik::CRect Bounds() const override { return ImageBounds(); }
    int Planes() const override { return Format().planes; }
    int Depth() const override { return Format().depth; }
    /// From the pages of the source stage, so that the host is read once for the estimation and the render. Throws
    /// CAbort, silent, when the user wants it to end.
    void ReadGrey(const Sarnik::CRect &rect, std::uint8_t maskThreshold, const CorvaneDeblur::floatArray &grey,
                  const CorvaneDeblur::byteArray &mask) override;

    /// How far the estimation of traces is, 0 to 1: the first half of the host's bar.
    void EstimationProgress(double done);

private:
    void Show(std::uint64_t done, std::uint64_t total);

    PFilter &filter;
    const TNFilterBlock &block;
    Sarnik::CBlockChannels channels;
    std::optional<Sarnik::CSuiteQuadConverter> converter;
    bool estimated = false;
};

} // namespace Project
