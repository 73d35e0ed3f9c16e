#include "shell/plugin/hostAlerts.h"

namespace Sarnik
{

CAlertAnswer CHostAlerts::Show(const CAlert &alert)
{
    if (procs == nullptr || procs->show == nullptr)
        return text.Show(alert);
    const int kind = alert.kind == CAlertKind::YesNo ? TNAlertYesNo : TNAlertOk;
    const int answer =
        procs->show(procs->context, kind, alert.title.c_str(), alert.first.c_str(), alert.second.c_str());
    // Whatever is not a Yes to a question is a No.
    return answer == TNAnswerOk || alert.kind == CAlertKind::Ok ? CAlertAnswer::Ok : CAlertAnswer::No;
}

void CHostAlerts::Beep()
{
    if (procs != nullptr && procs->beep != nullptr)
        procs->beep(procs->context);
    else
        text.Beep();
}

void CHostAlerts::WaitCursor(bool on)
{
    if (procs != nullptr && procs->waitCursor != nullptr)
        procs->waitCursor(procs->context, on ? 1 : 0);
}

} // namespace Sarnik
