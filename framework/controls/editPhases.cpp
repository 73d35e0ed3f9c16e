#include "framework/controls/editPhases.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{

void CEditPhases::BeginEdit()
{
    timer.Stop();
    if (open)
        return;
    open = true;
    SendPhase(kValue_EditBegin);
}

void CEditPhases::EndEdit()
{
    timer.Stop();
    if (!open)
        return;
    open = false;
    SendPhase(kValue_EditEnd);
}

double CEditPhases::WholeNotches(double turned)
{
    turnedSoFar += std::isfinite(turned) ? std::clamp(turned, -100.0, 100.0) : 0;
    const double whole = std::trunc(turnedSoFar);
    turnedSoFar -= whole;
    return whole;
}

void CEditPhases::Rested(void *phases)
{
    static_cast<CEditPhases *>(phases)->EndEdit();
}

} // namespace Sarnik
