#pragma once

#include "framework/base/alerts.h"
#include "shell/tintorel.h"

namespace Sarnik
{

/// Alerts, the alert sound and the wait cursor through the host, while the object lives; where the host has no function
/// for one, by text. Main thread.
class CHostAlerts final : public CAlertPort
{
public:
    explicit CHostAlerts(const TNAlertProcs *table) : procs(table), before(SetAlerts(this)) {}
    CHostAlerts(const CHostAlerts &) = delete;
    CHostAlerts &operator=(const CHostAlerts &) = delete;
    ~CHostAlerts() { SetAlerts(before); }

    CAlertAnswer Show(const CAlert &alert) override;
    void Beep() override;
    void WaitCursor(bool on) override;

private:
    const TNAlertProcs *procs;
    CAlertPort *before;
    CTextAlerts text;
};

} // namespace Sarnik
