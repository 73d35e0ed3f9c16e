#pragma once

#include <cstdint>
#include <string_view>

namespace Sarnik
{

/// Numbers of the cursors.
enum ECursor : std::uint32_t
{
    kCursor_Arrow = 26000,
    kCursor_Region = 26004,     ///< draws a region, places the loupe
    kCursor_Hand = 26005,       ///< could take hold
    kCursor_HandClosed = 26006, ///< has taken hold
    kCursor_ZoomIn = 26008,
    kCursor_ZoomOut = 26009,
    kCursor_ZoomLimit = 26010, ///< can go no further
    kCursor_SizeVertical = 26017,
    kCursor_SizeHorizontal = 26018,
    kCursor_SizeFalling = 26019, ///< from top left to bottom right
    kCursor_SizeRising = 26020,
    kCursor_Move = 26030,
    kCursor_Direction = 26032, ///< draws a straight trace
    kCursor_Outside = 26046,   ///< beside what a tool works on
    kCursor_MoveEnd = 26070    ///< over an end of a straight trace
};

/// Numbers of the icons. Each lies in the room that is given here, in view units.
enum EIconNumber : std::uint32_t
{
    kIcon_LockDetail = 15006,        ///< 14 x 14, below the loupe
    kIcon_LockDetailPressed = 15007, ///< 14 x 14
    kIcon_LockDetailLocked = 15008,  ///< 14 x 14
    kIcon_Enhance = 15019,           ///< 28 x 28, over the loupe's picture
    kIcon_EnhancePressed = 15020,    ///< 28 x 28
    kIcon_EnhanceArmed = 15021,      ///< 28 x 28
    kIcon_FixedTrace = 15027,        ///< 16 x 16, over the photo: a trace that nothing estimates again
    kIcon_FixedTraceHot = 15028,     ///< 16 x 16
    kIcon_PoorTrace = 16008,         ///< 22 x 18, over the photo and thumbnails: not applied
    kIcon_PoorTraceApplied = 16009,  ///< 22 x 18: applied all the same
    kIcon_Expand = 16010,            ///< 20 x 13, over a thumbnail
    kIcon_CheckOff = 16011,          ///< 15 x 15, below a thumbnail
    kIcon_CheckOn = 16012,           ///< 15 x 15
    kIcon_CheckOffPressed = 16013,   ///< 15 x 15
    kIcon_CheckOnPressed = 16014,    ///< 15 x 15
    kIcon_Failed = 16015             ///< 12 x 12, over the loupe's picture
};

/// Names of the icons that the program draws itself; layouts name the others.
namespace iconName
{

inline constexpr std::string_view discloseOn = "DiscloseAdvancedPaneOn";
inline constexpr std::string_view discloseOff = "DiscloseAdvancedPaneOff";
inline constexpr std::string_view zoomIn = "ZoomIn";                  ///< 12 x 12
inline constexpr std::string_view zoomOut = "ZoomOut";                ///< 12 x 12
inline constexpr std::string_view undockDetail = "UndockDetail";      ///< 17 x 13, below the loupe
inline constexpr std::string_view dockDetail = "DockDetail";          ///< 17 x 13, over the floating loupe
inline constexpr std::string_view start = "StartEstimation";          ///< 12 x 12, over a thumbnail
inline constexpr std::string_view reducedQuality = "ReducedQuality";  ///< 16 x 16
inline constexpr std::string_view closePreview = "CloseMultiPreview"; ///< 16 x 16
inline constexpr std::string_view useTrace = "UseTrace";              ///< 16 x 16

} // namespace iconName

/// Every number and name above that stands for a picture of the program's own. kCursor_Arrow and kCursor_Outside do
/// not: they are the arrow of the user's own display.
inline constexpr std::uint32_t numberedIcons[] = {
    kCursor_Region,         kCursor_Hand,          kCursor_HandClosed,     kCursor_ZoomIn,      kCursor_ZoomOut,
    kCursor_ZoomLimit,      kCursor_SizeVertical,  kCursor_SizeHorizontal, kCursor_SizeFalling, kCursor_SizeRising,
    kCursor_Move,           kCursor_Direction,     kCursor_MoveEnd,        kIcon_LockDetail,    kIcon_LockDetailPressed,
    kIcon_LockDetailLocked, kIcon_Enhance,         kIcon_EnhancePressed,   kIcon_EnhanceArmed,  kIcon_FixedTrace,
    kIcon_FixedTraceHot,    kIcon_PoorTrace,       kIcon_PoorTraceApplied, kIcon_Expand,        kIcon_CheckOff,
    kIcon_CheckOn,          kIcon_CheckOffPressed, kIcon_CheckOnPressed,   kIcon_Failed};
inline constexpr std::string_view namedIcons[] = {
    iconName::discloseOn,   iconName::discloseOff, iconName::zoomIn, iconName::zoomOut,
    iconName::undockDetail, iconName::dockDetail,  iconName::start,  iconName::reducedQuality,
    iconName::closePreview, iconName::useTrace};

} // namespace Sarnik
