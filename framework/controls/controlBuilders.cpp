#include "framework/controls/controlBuilders.h"

#include "framework/controls/dialog.h"
#include "framework/controls/layoutPane.h"

namespace Sarnik
{

void enterControlBuilders()
{
    static const CPaneBuilder<CLayoutPane> pane("CPane");
    static const CWindowBuilder<CDialog> dialog("CDialog"), window("CWindow");
}

} // namespace Sarnik
