#include "store/traces/boundsGrey.h"
#include "store/traces/kernelCollection.h"

#include <algorithm>

/// What a collection finds out by looking at the picture: sizes, noise, regions.
namespace Project
{

using namespace CorvaneDeblur;

namespace
{

constexpr int lastResortSize = 10;   ///< where the size in force finds no region, this one may
constexpr int mostAutoTraces = 100;  ///< beyond what anybody needs; each costs a search and an estimation
constexpr int smallestRegion = 5;    ///< a suggested region's side in kernels
constexpr int smallestSearched = 31; ///< and the smallest kernel that counts there

/// A size for the region search, which takes the longer the larger it is.
int SearchSize(std::int32_t size)
{
    return std::clamp(size, 1, kLargestEstimate);
}

} // namespace

int PKernelCollection::MaxKernelSize() const
{
    const Sarnik::CRect bounds = picture.Bounds();
    return CorvaneDeblur::maxKernelSize(static_cast<int>(bounds.Width()), static_cast<int>(bounds.Height()));
}

int PKernelCollection::SizeForPreset(PSizePreset preset) const
{
    const Sarnik::CRect bounds = picture.Bounds();
    return CorvaneDeblur::sizeForPreset(preset, static_cast<int>(bounds.Width()), static_cast<int>(bounds.Height()));
}

int PKernelCollection::DefaultKernelSize() const
{
    return defaultSize != 0 ? static_cast<int>(defaultSize) : SizeForPreset(PSizePreset::small);
}

analysedImage &PKernelCollection::Analysed()
{
    // One that was stopped half-way knows nothing and is made again.
    if (!analysis || analysis->analysis().empty())
    {
        analysisSource = std::make_unique<PBoundsGrey>(picture);
        analysis = std::make_unique<analysedImage>(*analysisSource, stopFlag);
    }
    return *analysis;
}

void PKernelCollection::BuildAnalysisImage()
{
    Analysed();
}

float PKernelCollection::AnalysisNoise() const
{
    return analysis ? analysis->noise() : 0.0f;
}

void PKernelCollection::FindDefaultSize()
{
    const int found = Analysed().findDefaultSize(NoiseModeOf(parameters.defaultSettings));
    if (found <= 0)
        return;
    defaultSize = static_cast<std::uint32_t>(found);
    parameters.defaultSettings.size = found;
}

const KernelSettings &PKernelCollection::SettingsForNew() const
{
    const PKernel *chosen = Selected();
    return chosen ? chosen->Settings() : parameters.defaultSettings;
}

std::vector<regionRect> PKernelCollection::EstimatedRegions() const
{
    std::vector<regionRect> regions;
    for (const auto &trace : kernels)
        if (trace->KernelType() == PKernelKind::Estimated)
            regions.push_back(analysisSource->FromPicture(trace->Region()));
    return regions;
}

std::unique_ptr<PEstimatedKernel> PKernelCollection::addSuggestedRegion()
{
    const KernelSettings settings = SettingsForNew();
    const analysedImage &image = Analysed();
    if (image.analysis().empty())
        return nullptr;
    const auto region = image.addSuggestedRegion(SearchSize(settings.size), NoiseModeOf(settings), EstimatedRegions());
    if (!region)
        return nullptr;
    return std::make_unique<PEstimatedKernel>(*this, analysisSource->ToPicture(*region), settings);
}

Sarnik::CRect PKernelCollection::suggestRegionAt(int x, int y)
{
    const KernelSettings settings = SettingsForNew();
    const analysedImage &image = Analysed();
    if (image.analysis().empty())
        return {};
    const Sarnik::CRect bounds = picture.Bounds();
    const imagePoint point{std::clamp(x, bounds.left, bounds.right - 1) - bounds.left,
                           std::clamp(y, bounds.top, bounds.bottom - 1) - bounds.top};
    const auto region = image.suggestRegionAt(point, SearchSize(settings.size), NoiseModeOf(settings));
    return region ? analysisSource->ToPicture(*region) : Sarnik::CRect{};
}

/// How many regions of the smallest kind the picture holds side by side, and never more than anybody needs: the
/// count comes from a file.
int PKernelCollection::MostAutoTraces() const
{
    const std::int64_t side = smallestRegion * std::max(smallestSearched, SearchSize(parameters.defaultSettings.size));
    const Sarnik::CRect bounds = picture.Bounds();
    const std::int64_t places = ((bounds.Width() + side - 1) / side) * ((bounds.Height() + side - 1) / side);
    return static_cast<int>(std::min({std::int64_t{parameters.autoTraceCount}, places, std::int64_t{mostAutoTraces}}));
}

void PKernelCollection::AddAutoTraces()
{
    const int most = MostAutoTraces();
    for (int i = 0; i < most;)
    {
        if (auto trace = addSuggestedRegion())
        {
            Insert(std::move(trace), Count());
            if (parameters.advancedOpen || i == 0)
                Activate(i);
            ++i;
        }
        else if (kernels.empty() && parameters.defaultSettings.size != lastResortSize && !analysis->stopped())
        {
            parameters.defaultSettings.size = lastResortSize;
        }
        else
        {
            return;
        }
    }
}

bool PKernelCollection::AutoEstimate()
{
    Clear();
    FindDefaultSize();
    lone = addSuggestedRegion();
    if (!lone)
        return false;
    active.push_back(lone.get());
    try
    {
        lone->StartEstimation(PEstimationRun::Background);
    }
    catch (...)
    {
        Clear();
        throw;
    }
    events.MarkDirty({false, false, true});
    return true;
}

} // namespace Project
