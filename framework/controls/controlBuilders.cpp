#include "framework/controls/controlBuilders.h"

#include "framework/controls/dialog.h"
#include "framework/controls/fields/editNumber.h"
#include "framework/controls/layoutPane.h"
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
    static const CWindowBuilder<CDialog> dialog("CDialog"), window("CWindow");
}

} // namespace Sarnik
