#include "framework/layout/layoutConstants.h"

namespace Sarnik
{
namespace
{

// Alignments and placements are read by the layout engine itself (layoutFrame.h has them as enumerations), all others
// by the builders of the classes. Bits of a flag word have several names where they stand for several things, and some
// names are sums of others.
// clang-format off
constexpr CLayoutConstant constants[] = {
    {"true", 1}, {"false", 0},
    {"align_fill", 1}, {"align_center", 2}, {"align_proportional", 3}, {"align_left", 4}, {"align_top", 4},
    {"align_right", 5}, {"align_bottom", 5},
    {"frame_none", 0}, {"frame_bevel", 1}, {"frame_rectangle", 2},
    {"place_column", 0}, {"place_row", 1}, {"place_offscreen", 2},

    {"kView_NoOptions", 0}, {"kView_Invisible", 1}, {"kView_Disabled", 2}, {"kView_Target", 4},
    {"kView_Bullseye", 8}, {"kView_TabStop", 16}, {"kView_TargetRing", 32}, {"kView_ContextClick", 64},
    {"kView_InvalidOnActivate", 128}, {"kView_DrawBuffer", 256}, {"kView_DrawParts", 512},
    {"kView_ChunkyScroll", 1024}, {"kView_EntireScroll", 2048}, {"kView_BigCoordinates", 4096},
    {"kView_IgnoreMouseEvents", 8192}, {"kView_MultiOnMouseUp", 16384}, {"kView_NoFocusOnClick", 32768},
    {"kView_NoTabNavigate", 0x10000}, {"kView_SupressSurrenders", 0x20000},

    {"kBind_XSizeable", 1}, {"kBind_YSizeable", 2}, {"kBind_XCenter", 4}, {"kBind_YCenter", 8}, {"kBind_Left", 16},
    {"kBind_Top", 32}, {"kBind_Right", 64}, {"kBind_Bottom", 128}, {"kBind_FixedLeft", 16}, {"kBind_FixedMidX", 4},
    {"kBind_FixedRight", 64}, {"kBind_FixedTop", 32}, {"kBind_FixedMidY", 8}, {"kBind_FixedBottom", 128},
    {"kBind_FixedCenterLeft", 20}, {"kBind_FixedCenterTop", 40}, {"kBind_FixedCenterRight", 68},
    {"kBind_FixedCenterBottom", 136}, {"kBind_SizeLeft", 17}, {"kBind_SizeMidX", 5}, {"kBind_SizeRight", 65},
    {"kBind_SizeTop", 34}, {"kBind_SizeMidY", 10}, {"kBind_SizeBottom", 130}, {"kBind_SizeCenterLeft", 21},
    {"kBind_SizeCenterTop", 42}, {"kBind_SizeCenterRight", 69}, {"kBind_SizeCenterBottom", 138}, {"kBind_Fixed", 0},
    {"kBind_Sizeable", 3}, {"kBind_FixedTopLeft", 48}, {"kBind_FixedTopMiddle", 36}, {"kBind_FixedTopRight", 96},
    {"kBind_FixedMiddleLeft", 24}, {"kBind_FixedMiddle", 12}, {"kBind_FixedMiddleRight", 72},
    {"kBind_FixedBottomLeft", 144}, {"kBind_FixedBottomMiddle", 132}, {"kBind_FixedBottomRight", 192},
    {"kBind_XScrollable", 256}, {"kBind_YScrollable", 512}, {"kBind_PinLeft", 1024}, {"kBind_PinTop", 2048},
    {"kBind_PinRight", 4096}, {"kBind_PinBottom", 8192}, {"kBind_XNoPin", 5120}, {"kBind_YNoPin", 10240},
    {"kBind_LimitLeft", 16384}, {"kBind_LimitTop", 32768}, {"kBind_LimitRight", 0x10000},
    {"kBind_LimitBottom", 0x20000}, {"kBind_PortCoordinates", 0x40000}, {"kBind_Scrollable", 768},
    {"kBind_PinTopLeft", 3072}, {"kBind_PinTopRight", 6144}, {"kBind_PinBottomLeft", 9216},
    {"kBind_PinBottomRight", 12288}, {"kBind_NoPin", 15360}, {"kBind_LimitTopLeft", 49152},
    {"kBind_LimitTopMiddle", 32768}, {"kBind_LimitTopRight", 0x18000}, {"kBind_LimitMiddleLeft", 16384},
    {"kBind_LimitMiddle", 0}, {"kBind_LimitMiddleRight", 0x10000}, {"kBind_LimitBottomLeft", 0x24000},
    {"kBind_LimitBottomMiddle", 0x20000}, {"kBind_LimitBottomRight", 0x30000}, {"kBind_ScrollTopLeft", 3840},
    {"kBind_ScrollTopRight", 6912}, {"kBind_ScrollBottomLeft", 9984}, {"kBind_ScrollBottomRight", 13056},

    {"kTip_PlaceDefault", 0}, {"kTip_PlaceAbsoluteCenter", 1}, {"kTip_PlaceAbove", 2}, {"kTip_PlaceBelow", 3},
    {"kTip_PlaceLeft", 4}, {"kTip_PlaceRight", 5},

    {"kWin_Document", 1}, {"kWin_Alert", 2}, {"kWin_Dialog", 3}, {"kWin_Palette", 4}, {"kWin_Toolbar", 5},
    {"kWin_Popup", 6}, {"kWin_MDIFrame", 7}, {"kWin_MDIDocument", 8}, {"kWin_DocumentSeamless", 12},
    {"kWin_CanClose", 1}, {"kWin_CanMove", 2}, {"kWin_CanSize", 4}, {"kWin_HasSizeBox", 8}, {"kWin_LiveResize", 16},
    {"kWin_CanZoom", 32}, {"kWin_CanCollapse", 64}, {"kWin_CanMaximize", 32}, {"kWin_CanMinimize", 64},
    {"kWin_CanTarget", 128}, {"kWin_CanBullseye", 256}, {"kWin_CanTabStop", 512}, {"kWin_OpenHidden", 1024},
    {"kWin_AutoDelete", 2048}, {"kWin_DisableOwner", 4096}, {"kWin_DropFiles", 8192},
    {"kWin_ResolutionIndependent", 16384}, {"kWin_NoFeatures", 0}, {"kWin_AllFeatures", 127},
    {"kWin_AllTargeting", 896},

    {"kWinState_Default", 0}, {"kWinState_Normal", 1}, {"kWinState_Minimized", 2}, {"kWinState_Maximized", 3},

    {"kMonitor_Main", 0}, {"kMonitor_Big", 1}, {"kMonitor_Small", 2}, {"kMonitor_Deep", 3}, {"kMonitor_Shallow", 4},
    {"kMonitor_Tall", 5}, {"kMonitor_Short", 6}, {"kMonitor_Wide", 7}, {"kMonitor_Thin", 8},

    {"kInterior_ScrollerPane", 0}, {"kInterior_ScrollerGapLeft", 5}, {"kInterior_ScrollerGapTop", 6},
    {"kInterior_ScrollerGapRight", 7}, {"kInterior_ScrollerGapBottom", 8}, {"kInterior_FrameInterior", 0},
    {"kInterior_FrameInsertTop", 1}, {"kInterior_FrameInsertLeft", 2}, {"kInterior_FrameInsertBottom", 3},
    {"kInterior_FrameInsertRight", 4},

    {"kAlign_Default", 0}, {"kAlign_Left", 1}, {"kAlign_Top", 1}, {"kAlign_Center", 2}, {"kAlign_Right", 3},
    {"kAlign_Bottom", 3}, {"kAlign_Full", 4},

    {"kTrim_None", 0}, {"kTrim_Start", 1}, {"kTrim_Middle", 2}, {"kTrim_End", 3},

    {"kFont_System", 0}, {"kFont_Application", 1}, {"kFont_UI", 2}, {"kFont_UIBold", 3}, {"kFont_UIItalic", 4},
    {"kFont_UIBoldItalic", 5}, {"kFont_UILarge", 6}, {"kFont_UILargeBold", 7}, {"kFont_UILargeItalic", 8},
    {"kFont_UILargeBoldItalic", 9}, {"kFont_UIMedium", 10}, {"kFont_UIMediumBold", 11},
    {"kFont_UIMediumItalic", 12}, {"kFont_UIMediumBoldItalic", 13}, {"kFont_UISmall", 14},
    {"kFont_UISmallBold", 15}, {"kFont_UISmallItalic", 16}, {"kFont_UISmallBoldItalic", 17}, {"kFont_UIMicro", 18},
    {"kFont_UIMicroBold", 19}, {"kFont_UIMicroItalic", 20}, {"kFont_UIMicroBoldItalic", 21},

    {"kNumber_Default", 0}, {"kNumber_Integer", 0}, {"kNumber_Decimal", 1}, {"kNumber_FixedDecimal", 2},
    {"kNumber_PadInteger", 4}, {"kNumber_ShowPlus", 8}, {"kNumber_WrapAround", 16},

    {"kScroller_XBar", 1}, {"kScroller_YBar", 2}, {"kScroller_SizeBox", 4}, {"kScroller_WellFrame", 8},
    {"kScroller_AutoHideScrollBars", 16}, {"kScroller_NoControls", 0}, {"kScroller_AllControls", 7},

    {"kControlSize_Normal", 0}, {"kControlSize_Small", 1}, {"kControlSize_Large", 2},

    {"kControlOrient_Default", 0}, {"kControlOrient_Horizontal", 1}, {"kControlOrient_Vertical", 2},
    {"kControlOrient_Left", 3}, {"kControlOrient_Right", 4}, {"kControlOrient_Up", 5}, {"kControlOrient_Down", 6},

    {"kButtonStyle_Default", 0}, {"kButtonStyle_Bevel", 1}, {"kButtonStyle_Push", 2}, {"kButtonStyle_Check", 3},
    {"kButtonStyle_Radio", 4}, {"kButtonStyle_Round", 5}, {"kButtonStyle_SmallCheck", 6},
    {"kButtonStyle_SmallRadio", 7}, {"kButtonStyle_SmallRound", 8}, {"kButtonStyle_Disclosure", 9},
    {"kButtonStyle_Tool", 10}, {"kButtonStyle_None", 11},

    {"kEdit_NoOptions", 0}, {"kEdit_MultiLine", 1}, {"kEdit_AutoGrow", 2}, {"kEdit_NoFrame", 4},
    {"kEdit_ReadOnly", 8}, {"kEdit_Password", 16}, {"kEdit_CanScroll", 32}, {"kEdit_ReturnIsEnter", 64},
    {"kEdit_IgnoreFKeys", 128}, {"kEdit_NoRangeAlert", 256},

    {"kStatic_NoOptions", 0}, {"kStatic_Wrap", 1}, {"kStatic_GroupTitle", 2},

    {"kSlider_Standard", 0}, {"kSlider_Block", 1}, {"kSlider_Duskfold", 2}, {"kSlider_AutoOrient", 0},
    {"kSlider_Horizontal", 1}, {"kSlider_Vertical", 2},

    {"kTicks_None", 0}, {"kTicks_OneLoc", 1},

    {"kSliderFill_None", 0}, {"kSliderFill_Custom", 1}, {"kSliderFill_SolidRGB", 2}, {"kSliderFill_SolidCMY", 3},
    {"kSliderFill_SolidHSV", 4}, {"kSliderFill_GradientRGB", 5}, {"kSliderFill_GradientCMY", 6},
    {"kSliderFill_GradientHSV", 7},

    {"kAngleSlider_Default", 0}, {"kAngleSlider_CCW", 0}, {"kAngleSlider_CW", 1}, {"kAngleSlider_BiDirectional", 2},
    {"kAngleSlider_PinValue", 4},

    {"kScrollbarStyle_Default", 0}, {"kScrollbarStyle_Outline", 1}, {"kScrollbarStyle_Fernway", 2},
    {"kScrollbarStyle_FernwayMini", 3},

    {"kTabStyle_Default", 0}, {"kTabStyle_IconBar", 1},

    {"kCellSheet_NoOptions", 0}, {"kCellSheet_FlowRight", 1}, {"kCellSheet_OneDimension", 2},
    {"kCellSheet_SizeVariable", 4}, {"kCellSheet_VariableResizes", 8}, {"kCellSheet_FillEmpty", 16},
    {"kCellSheet_MultiSelect", 32}, {"kCellSheet_ContiguousSelect", 64}, {"kCellSheet_TrackSelect", 128},
    {"kCellSheet_TrackRange", 256}, {"kCellSheet_DeselectOutside", 512},

    {"kRadio_NoOptions", 0}, {"kRadio_CustomItems", 1}, {"kRadio_ReportAll", 2},

    {"kCombo_NoOptions", 0}, {"kCombo_Editable", 1}, {"kCombo_CustomItems", 2},

    {"kListBox_NoOptions", 0}, {"kListBox_MultiSelect", 1}, {"kListBox_ContiguousSelect", 2},
    {"kListBox_TrackSelect", 4}, {"kListBox_TrackRange", 8}, {"kListBox_DeselectOutside", 16},

    {"kPos_TopLeft", 0}, {"kPos_TopMiddle", 1}, {"kPos_TopRight", 2}, {"kPos_MiddleLeft", 3}, {"kPos_Center", 4},
    {"kPos_MiddleRight", 5}, {"kPos_BottomLeft", 6}, {"kPos_BottomMiddle", 7}, {"kPos_BottomRight", 8},

    {"kFrameEmpty", 0}, {"kFramePrimaryGroup", 1}, {"kFrameSecondaryGroup", 2}, {"kFrameSolidDark", 3},
    {"kFrameSolidGray", 4}, {"kFrameSolidLight", 5}, {"kFrameActiveBorder", 6}, {"kFrameDimBorder", 7},
    {"kFrameOut3D", 8}, {"kFrameIn3D", 9}, {"kFrameScrollerWell", 10}, {"kFrameEtched", 11},
    {"kFrameTargetRing", 12}, {"kFramePlacard", 13},

    {"kDividerLeft", 50}, {"kDividerTop", 51}, {"kDividerRight", 52}, {"kDividerBottom", 53},
    {"kDividerLeftRight", 54}, {"kDividerTopBottom", 55}, {"kDividerLeftUIB", 60}, {"kDividerTopUIB", 61},
    {"kDividerRightUIB", 62}, {"kDividerBottomUIB", 63},

    {"kPushButton", 0}, {"kCheckButton", 1}, {"kRadioButton", 2}, {"kCTAGroupButton", 3}, {"kOff", 0},
    {"kNeutral", 2},
};
// clang-format on

} // namespace

std::span<const CLayoutConstant> LayoutConstants()
{
    return constants;
}

} // namespace Sarnik
