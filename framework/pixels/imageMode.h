#pragma once

namespace Sarnik
{

/// What the samples of a picture are.
enum class CPixelKind
{
    rgb = 0,
    other1 = 1, ///< three planes; never reaches the filter
    cmyk = 2,
    lab = 3,
    grey = 4,   ///< and everything else of one plane
    other5 = 5, ///< three planes; never reaches the filter
};

/// What an image mode, in the host's numbering, says about its samples.
struct CImageFormat
{
    CPixelKind kind = CPixelKind::rgb;
    int depth = 8;  ///< bits a sample
    int planes = 1; ///< colour planes, without transparency
};

/// Any number is answered; those that the host does not define as 8-bit RGB of one plane.
constexpr CImageFormat imageFormat(int mode)
{
    switch (mode)
    {
    case 0:
        return {CPixelKind::grey, 1, 1};
    case 1:
    case 7:
    case 8:
        return {CPixelKind::grey, 8, 1};
    case 10:
    case 14:
    case 15:
        return {CPixelKind::grey, 16, 1};
    case 17:
        return {CPixelKind::grey, 32, 1};
    case 3:
        return {CPixelKind::rgb, 8, 3};
    case 11:
        return {CPixelKind::rgb, 16, 3};
    case 16:
        return {CPixelKind::rgb, 32, 3};
    case 4:
        return {CPixelKind::cmyk, 8, 4};
    case 13:
        return {CPixelKind::cmyk, 16, 4};
    case 9:
        return {CPixelKind::lab, 8, 3};
    case 12:
        return {CPixelKind::lab, 16, 3};
    case 5:
        return {CPixelKind::other5, 8, 3};
    case 6:
        return {CPixelKind::other1, 8, 3};
    default:
        return {};
    }
}

} // namespace Sarnik
