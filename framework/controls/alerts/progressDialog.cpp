#include "framework/controls/alerts/progressDialog.h"

#include "framework/controls/buttons/pushButton.h"
#include "framework/controls/drawTools.h"
#include "framework/controls/panes/progressBar.h"
#include "framework/controls/panes/staticText.h"
#include "framework/views/application.h"

namespace Sarnik
{
namespace
{

constexpr std::int32_t width = 380, margin = 16, textHeight = 34, barHeight = 10, buttonWidth = 90, buttonHeight = 28;
constexpr std::int32_t barTop = margin + textHeight + 6, buttonTop = barTop + barHeight + margin;
const CCommandID cancelId("Sarnik/Progress/Cancel");

/// Between two shows: what came meanwhile, but no more than that.
constexpr int mostTurns = 64;

} // namespace

CProgressDialog::CProgressDialog(const std::string &title, const std::string &message)
    : CDialog({.title = title,
               .features = kWin_CanClose | kWin_CanMove,
               .frame = {-50, -33, -50 + width, -33 + buttonTop + buttonHeight + margin},
               .background = CDrawTools::Colours().window})
{
    auto &text = Make<CStaticText>(CRect{margin, margin, width - margin, margin + textHeight});
    text.SetStaticOptions(kStatic_Wrap);
    text.SetAlign(kAlign_Near, kAlign_Near);
    text.SetText(message);
    bar = &Make<CProgressBar>(CRect{margin, barTop, width - margin, barTop + barHeight});
    button =
        &Make<CPushButton>(CRect{width - margin - buttonWidth, buttonTop, width - margin, buttonTop + buttonHeight});
    button->SetId(cancelId);
    button->SetText("$$$/Sarnik/Alert/CancelButton=Cancel");
    button->SetCancel(true);
    SetFocus(button);
}

void CProgressDialog::Begin(CWindow *over)
{
    cancelled = false;
    button->Enable(true);
    session.emplace(*this, over);
    Show(0, 1);
}

void CProgressDialog::Show(std::uint64_t done, std::uint64_t total)
{
    bar->SetValue(total == 0 ? 1 : static_cast<double>(done) / static_cast<double>(total));
    CApplication &application = *CApplication::Current();
    for (int turn = 0; turn < mostTurns && application.ProcessOne(0); ++turn)
    {
    }
    application.PaintAll();
}

bool CProgressDialog::ReceiveCommand(CCommandMessage &message)
{
    if (message.Id() != cancelId)
        return CDialog::ReceiveCommand(message);
    Cancel();
    return true;
}

/// The window stays until the work has noticed.
void CProgressDialog::Cancel()
{
    cancelled = true;
    button->Enable(false);
}

} // namespace Sarnik
