#include "shell/plugin/hostPicture.h"

#include "framework/base/exceptions.h"
#include "shell/layerReader.h"
#include "shell/plugin/filter.h"
#include "shell/plugin/regionGrey.h"
#include "stages/imageHub.h"
#include "stages/source.h"

#include <algorithm>

namespace Project
{

using Sarnik::CBasicPixmap;
using Sarnik::CRect;

PHostPicture::PHostPicture(PFilter &owner, const TNFilterBlock &filterBlock, const TNChannelPortsSuite *ports)
    : filter(owner), block(filterBlock), channels(filterBlock, ports)
{
}

void PHostPicture::SetColourSuite(const TNColorSpaceSuite *suite)
{
    converter.reset();
    if (suite != nullptr)
        converter.emplace(*suite);
}

void PHostPicture::ReadSource(CBasicPixmap &pixmap)
{
    ReadLayer(channels, pixmap, Sarnik::layerTarget, Sarnik::layerNone, Sarnik::CFillMode::fallback);
}

void PHostPicture::ReadSelection(CBasicPixmap &pixmap, int plane)
{
    ReadMask(channels, pixmap, Sarnik::layerSelection, plane);
}

void PHostPicture::Write(CBasicPixmap &pixmap, const CRect &rect)
{
    WriteTarget(channels, pixmap, rect, HasTransparency());
}

Sarnik::CPageStore &PHostPicture::PageStore()
{
    return filter.Pages();
}

PParams &PHostPicture::Params()
{
    return *filter.GetParams();
}

PKernelCollection &PHostPicture::Kernels()
{
    return *filter.GetKernels();
}

void PHostPicture::Show(std::uint64_t done, std::uint64_t total)
{
    if (block.progress != nullptr)
        block.progress(block.progressContext, static_cast<std::int64_t>(done), static_cast<std::int64_t>(total));
}

void PHostPicture::Progress(std::uint64_t done, std::uint64_t total)
{
    if (estimated)
        Show(total + done, 2 * total);
    else
        Show(done, total);
}

void PHostPicture::EstimationProgress(double done)
{
    estimated = true;
    Show(static_cast<std::uint64_t>(std::clamp(done, 0.0, 1.0) * 1000.0), 2000);
}

bool PHostPicture::Abort()
{
    return block.testAbort != nullptr && block.testAbort(block.progressContext) != 0;
}

void PHostPicture::ReadGrey(const CRect &rect, std::uint8_t maskThreshold, const CorvaneDeblur::floatArray &grey,
                            const CorvaneDeblur::byteArray &mask)
{
    // Looking at a large picture takes a while, and nothing else asks meanwhile.
    if (Abort())
        throw Sarnik::CAbort(true);
    PSource &source = filter.GetImageHub()->Source();
    source.ForceRect(rect);
    Sarnik::CGreySource about;
    about.kind = Format().kind;
    about.hasMask = HasSelection();
    about.converter = CmykConverter();
    about.limits = Sarnik::CMaskLimits::of(maskThreshold);
    ReadRegionGrey(source.Pixmap(), rect, about, grey, mask);
}

} // namespace Project
