#include "framework/controls/alerts/messageAlert.h"

#include "framework/base/localisedString.h"
#include "framework/controls/alerts/alertPicture.h"
#include "framework/controls/buttons/pushButton.h"
#include "framework/views/application.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace Sarnik
{
namespace
{

constexpr std::int32_t margin = 16, gap = 12, pictureSide = 36, textWidth = 340;
constexpr std::int32_t buttonHeight = 26, leastButtonWidth = 84, buttonGap = 8;

/// A text in lines, drawn as it is.
class messageText final : public CPane
{
public:
    messageText(const std::string &text, std::int32_t fontNumber, std::int32_t width, std::int32_t mostHeight)
        : block(text, CDrawTools::Font(fontNumber), {.width = static_cast<double>(width), .lines = true})
    {
        const double height = std::min<double>(std::ceil(block.height()), mostHeight);
        SetFrame({0, 0, width, static_cast<std::int32_t>(height)});
    }
    void Draw(CPort &port) override
    {
        CDrawTools::Text(port, toCanvas(Bounds()), block, CDrawTools::Colours().text, kAlign_Near, kAlign_Near);
    }

private:
    Platform::textBlock block;
};

} // namespace

const CObjID CAlertButton::Ok("Sarnik/Alert/Ok"), CAlertButton::Cancel("Sarnik/Alert/Cancel"),
    CAlertButton::Other("Sarnik/Alert/Other"), CAlertButton::Other2("Sarnik/Alert/Other2");

std::vector<CAlertButton> alertOk()
{
    return {{CAlertButton::Ok, "$$$/Sarnik/Alert/OkButton=OK"}};
}

std::vector<CAlertButton> alertOkCancel()
{
    return {{CAlertButton::Ok, "$$$/Sarnik/Alert/OkButton=OK"},
            {CAlertButton::Cancel, "$$$/Sarnik/Alert/CancelButton=Cancel"}};
}

std::vector<CAlertButton> alertYesNo()
{
    return {{CAlertButton::Ok, "$$$/Sarnik/Alert/YesButton=&Yes"},
            {CAlertButton::Cancel, "$$$/Sarnik/Alert/NoButton=&No"}};
}

CMessageAlert::CMessageAlert(CWindow *parentWindow, CAlertIcon icon, std::vector<CAlertButton> with,
                             const std::string &text, const std::string &subtext, const std::string &title,
                             CObjID defaultAnswer)
    : CDialog({.title = title, .features = kWin_CanClose | kWin_CanMove, .background = CDrawTools::Colours().window}),
      parent(parentWindow), buttons(std::move(with)), texts{Localize(text), Localize(subtext)}
{
    const bool cancels = std::any_of(buttons.begin(), buttons.end(),
                                     [](const CAlertButton &b) { return b.answer == CAlertButton::Cancel; });
    escape = cancels ? CAlertButton::Cancel : buttons.back().answer;
    Build(icon, defaultAnswer ? defaultAnswer : buttons.front().answer);
}

void CMessageAlert::Build(CAlertIcon icon, CObjID defaultAnswer)
{
    const std::int32_t left = icon == CAlertIcon::none ? margin : margin + pictureSide + gap;
    if (icon != CAlertIcon::none)
        Make<CAlertPicture>(icon, CRect{margin, margin, margin + pictureSide, margin + pictureSide});

    const Platform::rectangle area = CApplication::Current()->Display().workArea();
    const auto room = static_cast<std::int32_t>(std::max(100.0, area.height() - 200) / 2);
    std::int32_t bottom = margin;
    for (int i = 0; i < 2; ++i)
    {
        if (texts[i].empty())
            continue;
        auto &line = Make<messageText>(texts[i], i == 0 ? kFont_UIMediumBold : kFont_UIMedium, textWidth, room);
        const std::int32_t top = bottom == margin ? margin : bottom + gap / 2;
        line.SetFrame(line.Frame().Moved(left, top));
        bottom = line.Frame().bottom;
    }
    if (icon != CAlertIcon::none)
        bottom = std::max(bottom, margin + pictureSide);

    // From the right: the first button, the one that goes on, is the outermost.
    const std::int32_t top = bottom + margin;
    const CDrawMeasure measure;
    std::vector<std::int32_t> widths;
    std::int32_t total = 0;
    for (const CAlertButton &button : buttons)
    {
        widths.push_back(std::max(leastButtonWidth, measure.Measure(Localize(button.text), kFont_UIMedium).width + 32));
        total += widths.back() + buttonGap;
    }
    const std::int32_t width = std::max(left + textWidth + margin, total - buttonGap + 2 * margin);
    std::int32_t right = width - margin;
    CPushButton *pressedByEnter = nullptr;
    for (std::size_t i = 0; i < buttons.size(); ++i)
    {
        auto &button = Make<CPushButton>(CRect{right - widths[i], top, right, top + buttonHeight});
        button.SetId(buttons[i].answer);
        button.SetText(buttons[i].text);
        if (buttons[i].answer == defaultAnswer)
            pressedByEnter = &button;
        if (buttons[i].answer == escape)
            button.SetCancel(true);
        right -= widths[i] + buttonGap;
    }
    CWindowSettings with = Settings();
    with.frame = {-50, -33, -50 + width, -33 + top + buttonHeight + margin};
    SetSettings(std::move(with));
    if (pressedByEnter == nullptr)
        return;
    pressedByEnter->SetDefault(true);
    SetFocus(pressedByEnter);
}

CObjID CMessageAlert::Run()
{
    const CObjID answer = RunModal(parent);
    return answer ? answer : escape;
}

bool CMessageAlert::ReceiveCommand(CCommandMessage &message)
{
    const bool known =
        std::any_of(buttons.begin(), buttons.end(), [&](const CAlertButton &b) { return b.answer == message.Id(); });
    if (known)
        EndModal(message.Id());
    return known || CDialog::ReceiveCommand(message);
}

bool CMessageAlert::KeyboardFilter(CKeyboardMessage &message)
{
    const bool copy = message.IsDown() && message.Key() == Platform::key::c &&
                      message.Modifiers() == std::uint32_t{Platform::ctrlModifier};
    if (copy)
        CApplication::Current()->Display().setClipboard(texts[1].empty() ? texts[0] : texts[0] + "\n" + texts[1]);
    return copy;
}

CAlertAnswer CWindowAlerts::Show(const CAlert &alert)
{
    CApplication *const application = CApplication::Current();
    if (application == nullptr || application->Display().lost())
        return text.Show(alert);
    const bool question = alert.kind == CAlertKind::YesNo;
    CMessageAlert window(application->Active(), question ? CAlertIcon::question : CAlertIcon::warning,
                         question ? alertYesNo() : alertOk(), alert.first, alert.second, alert.title);
    return window.Run() == CAlertButton::Ok ? CAlertAnswer::Ok : CAlertAnswer::No;
}

void CWindowAlerts::Beep()
{
    if (CApplication *const application = CApplication::Current())
        application->Display().beep();
    else
        text.Beep();
}

void CWindowAlerts::WaitCursor(bool on)
{
    if (CApplication *const application = CApplication::Current())
        application->Display().setCursor({on ? Platform::cursorShape::wait : Platform::cursorShape::arrow});
}

} // namespace Sarnik
