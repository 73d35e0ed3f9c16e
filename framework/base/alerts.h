#pragma once

#include <cstdint>
#include <string>

namespace Sarnik
{

enum class CAlertKind
{
    Ok,
    YesNo
};

enum class CAlertAnswer
{
    Ok, ///< and Yes
    No
};

/// What an alert says; all of it localised. `second` may be empty.
struct CAlert
{
    CAlertKind kind = CAlertKind::Ok;
    std::string title, first, second;
};

/// Where alerts, the alert sound and the wait cursor go: to the host, to a dialog, to a test. Main thread.
class CAlertPort
{
public:
    virtual CAlertAnswer Show(const CAlert &alert) = 0;
    virtual void Beep() = 0;
    virtual void WaitCursor(bool on) = 0;

protected:
    ~CAlertPort() = default;
};

/// Without a screen: an alert is a line on stderr, and every question is answered the same. There is no cursor.
class CTextAlerts final : public CAlertPort
{
public:
    explicit CTextAlerts(CAlertAnswer toQuestions = CAlertAnswer::No) : answer(toQuestions) {}

    CAlertAnswer Show(const CAlert &alert) override;
    void Beep() override;
    void WaitCursor(bool) override {}

private:
    CAlertAnswer answer;
};

/// The port in use; a CTextAlerts until another is set.
CAlertPort &Alerts() noexcept;
/// Null goes back to the text port. The port is the caller's and outlives its use. Answers the one that was set before,
/// null for the text port.
CAlertPort *SetAlerts(CAlertPort *port) noexcept;

} // namespace Sarnik
