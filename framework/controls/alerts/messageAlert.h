#pragma once

#include "framework/base/alerts.h"
#include "framework/controls/dialog.h"

#include <string>
#include <vector>

namespace Sarnik
{

enum class CAlertIcon
{
    none,
    information,
    question,
    warning,
    error
};

/// A button of an alert: what it answers, and its label, to be localised.
struct CAlertButton
{
    CObjID answer;
    std::string text;

    static const CObjID Ok, Cancel, Other, Other2; ///< Sarnik/Alert/Ok and so on
};

/// The usual sets; the first button is the one that goes on.
std::vector<CAlertButton> alertOk();
std::vector<CAlertButton> alertOkCancel();
std::vector<CAlertButton> alertYesNo();

/// A question or a message in a window of its own. Enter presses the default button; Escape, and the window's closing,
/// answer Cancel where there is such a button, otherwise the only one or the last. Ctrl+C copies the texts.
///
///     if (CMessageAlert(&window, CAlertIcon::question, alertYesNo(), text).Run() == CAlertButton::Ok) ...
class CMessageAlert : public CDialog
{
public:
    /// All texts are to be localised; text is the message, subtext says more in smaller letters. Long texts are
    /// wrapped, and cut at the height of the screen. `defaultAnswer`: none for the first button. At least one button.
    CMessageAlert(CWindow *parent, CAlertIcon icon, std::vector<CAlertButton> buttons, const std::string &text,
                  const std::string &subtext = {}, const std::string &title = {}, CObjID defaultAnswer = {});

    /// Shows it until a button is pressed. Throws CError where there is no display.
    CObjID Run();

    bool ReceiveCommand(CCommandMessage &message) override;
    bool KeyboardFilter(CKeyboardMessage &message) override;

private:
    void Build(CAlertIcon icon, CObjID defaultAnswer);

    CWindow *parent;
    std::vector<CAlertButton> buttons;
    CObjID escape;
    std::string texts[2];
};

/// Alerts of the program in windows, while a window can be opened; until then and afterwards on stderr. The sound is
/// the display's; the wait cursor is shown until the pointer moves into another view.
class CWindowAlerts final : public CAlertPort
{
public:
    CAlertAnswer Show(const CAlert &alert) override;
    void Beep() override;
    void WaitCursor(bool on) override;

private:
    CTextAlerts text;
};

} // namespace Sarnik
