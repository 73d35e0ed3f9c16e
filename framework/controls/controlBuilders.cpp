#include "framework/controls/controlBuilders.h"

#include "framework/controls/buttons/checkButton.h"
#include "framework/controls/buttons/iconButton.h"
#include "framework/controls/buttons/pushButton.h"
#include "framework/controls/buttons/toolButton.h"
#include "framework/controls/dialog.h"
#include "framework/controls/fields/editNumber.h"
#include "framework/controls/layoutPane.h"
#include "framework/controls/menus/comboBox.h"
#include "framework/controls/menus/menuBar.h"
#include "framework/controls/menus/menuPopup.h"
#include "framework/controls/menus/radioPopup.h"
#include "framework/controls/menus/zoomProgressCombo.h"
#include "framework/controls/panes/framePane.h"
#include "framework/controls/panes/groupPane.h"
#include "framework/controls/panes/progressBar.h"
#include "framework/controls/panes/staticImage.h"
#include "framework/controls/panes/staticText.h"
#include "framework/controls/panes/switchPane.h"
#include "framework/controls/scrolling/listBox.h"
#include "framework/controls/sliders/angleSlider.h"
#include "framework/controls/sliders/editSlider.h"

namespace Sarnik
{

void enterControlBuilders()
{
    static const CPaneBuilder<CLayoutPane> pane("CPane");
    static const CPaneBuilder<CEditString> editString("CEditString");
    static const CPaneBuilder<CEditNumber> editNumber("CEditNumber");
    static const CPaneBuilder<CCustomSlider> customSlider("CCustomSlider");
    static const CPaneBuilder<CEditSlider> editSlider("CEditSlider");
    static const CPaneBuilder<CAngleSlider> angleSlider("CAngleSlider");
    static const CPaneBuilder<CButton> button("CButton");
    static const CPaneBuilder<CPushButton> pushButton("CPushButton");
    static const CPaneBuilder<CCheckButton> checkButton("CCheckButton");
    static const CPaneBuilder<CRadioButton> radioButton("CRadioButton");
    static const CPaneBuilder<CIconButton> iconButton("CIconButton");
    static const CPaneBuilder<CToolButton> toolButton("CToolButton");
    static const CPaneBuilder<CStaticText> staticText("CStaticText");
    static const CPaneBuilder<CStaticImage> staticImage("CStaticImage");
    static const CPaneBuilder<CFramePane> framePane("CFramePane");
    static const CPaneBuilder<CGroupPane> groupPane("CGroupPane");
    static const CPaneBuilder<CSwitchPane> switchPane("CSwitchPane");
    static const CPaneBuilder<CCasePane> casePane("CCasePane");
    static const CPaneBuilder<CProgressBar> progressBar("CProgressBar");
    static const CPaneBuilder<CMenuBarPane> menuBarPane("CMenuBarPane");
    static const CPaneBuilder<CMenuPopup> menuPopup("CMenuPopup");
    static const CPaneBuilder<CFlyoutPopup> flyoutPopup("CFlyoutPopup");
    static const CPaneBuilder<CRadioPopup> radioPopup("CRadioPopup");
    static const CPaneBuilder<CComboBox> comboBox("CComboBox");
    static const CPaneBuilder<CZoomProgressCombo> zoomProgressCombo("CZoomProgressCombo");
    static const CPaneBuilder<CScrollBar> scrollBar("CScrollBar"), customScrollbar("CCustomScrollbar");
    static const CPaneBuilder<CScroller> scroller("CScroller");
    static const CPaneBuilder<CCellSheet> cellSheet("CCellSheet");
    static const CPaneBuilder<CListSheet> listSheet("CListSheet");
    static const CPaneBuilder<CListBox> listBox("CListBox");
    static const CWindowBuilder<CDialog> dialog("CDialog"), window("CWindow");
}

} // namespace Sarnik
