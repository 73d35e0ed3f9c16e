#include "deblur/estimate/traceSize.h"

#include <algorithm>

namespace CorvaneDeblur
{

int maxKernelSize(int imageCols, int imageRows)
{
    int size = std::min(std::min(imageCols, imageRows) / 3, 199);
    if (size % 2 == 0)
        --size;
    return size < 10 ? 11 : size;
}

int sizeForPreset(sizePreset preset, int imageCols, int imageRows)
{
    const float smaller = static_cast<float>(std::min(imageCols, imageRows));
    int size = 45;
    switch (preset)
    {
    case sizePreset::small:
        size = static_cast<int>(smaller / 20.0f);
        break;
    case sizePreset::medium:
        size = static_cast<int>(smaller / 10.0f);
        break;
    case sizePreset::large:
        size = static_cast<int>(smaller / 5.0f);
        break;
    case sizePreset::fixed:
        break;
    }
    return std::min(size, maxKernelSize(imageCols, imageRows));
}

regionRect limitRegion(const regionRect &region)
{
    constexpr int reach = 1000;
    const int left = std::max(region.x, region.centreX() - reach);
    const int top = std::max(region.y, region.centreY() - reach);
    const int right = std::min(region.centreX() + reach, region.x + region.width);
    const int bottom = std::min(region.centreY() + reach, region.y + region.height);
    const regionRect limited{left, top, right - left, bottom - top};
    return limited.empty() ? regionRect{} : limited;
}

} // namespace CorvaneDeblur
