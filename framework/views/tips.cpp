#include "framework/views/tips.h"

#include "framework/base/localisedString.h"
#include "framework/views/application.h"
#include "framework/views/view.h"
#include "framework/views/window.h"

#include <cmath>

namespace Sarnik
{
namespace
{

constexpr double letters = 11;
constexpr double widest = 320, cushion = 4;

Platform::textBlock laidOut(const std::string &text)
{
    // As wide as the text where that is not much.
    Platform::textBlock line(text, {.size = letters});
    return line.width() <= widest ? std::move(line)
                                  : Platform::textBlock(text, {.size = letters}, {.width = widest, .lines = true});
}

class CTipPane final : public CPane
{
public:
    CTipPane(const CRect &viewFrame, Platform::textBlock block) : CPane(viewFrame), text(std::move(block)) {}

    void Draw(CPort &port) override
    {
        const Platform::rectangle r = toCanvas(Bounds());
        port.Canvas().fillRectangle(r, {30, 30, 30});
        port.Canvas().drawRectangle({r.left + 0.5, r.top + 0.5, r.right - 0.5, r.bottom - 0.5},
                                    {.ink = {110, 110, 110}});
        port.Canvas().drawText(text, {cushion, cushion}, {230, 230, 230});
    }

private:
    Platform::textBlock text;
};

} // namespace

CTipWatch::CTipWatch(CWindow &watched) : window(watched), timer(delay, TimerFired, this)
{
}

CTipWatch::~CTipWatch() = default;

void CTipWatch::TimerFired(void *watch)
{
    auto &self = *static_cast<CTipWatch *>(watch);
    if (self.shown != nullptr)
        self.Hide();
    else
        self.ShowNow();
}

void CTipWatch::Moved(CView *view, CPoint to)
{
    // The first who has one gives the tip, with its rectangle in the window, and the first who has one the help.
    CTip tip;
    const auto missing = [&] { return tip.text.empty() || tip.help.empty(); };
    const auto take = [&](CTip &answer, const CRect &inWindow) {
        if (tip.text.empty() && !answer.text.empty())
        {
            tip.text = std::move(answer.text);
            tip.rect = inWindow;
        }
        if (tip.help.empty())
            tip.help = std::move(answer.help);
    };
    for (CView *asked = view; asked != nullptr && missing(); asked = asked->ParentView())
        if (CTip answer; asked->GetTip(asked->FromWindow(to), answer))
            take(answer, asked->ToWindow(answer.rect));
    if (CTip answer; missing() && window.PointerInside() && window.GetTip(to, answer))
        take(answer, answer.rect);

    std::string newHelp = Localize(tip.help);
    if (newHelp != help)
        window.SetHelp(help = std::move(newHelp));

    at = to;
    if (tip.text != text || tip.rect != rect)
    {
        Hide();
        text = std::move(tip.text);
        rect = tip.rect;
        done = false;
    }
    // The delay counts from the last move.
    if (text.empty() || done)
        return;
    timer.SetPeriod(delay);
    timer.Start();
}

void CTipWatch::Hide()
{
    timer.Stop();
    shown.reset();
    done = true;
}

void CTipWatch::ShowNow()
{
    timer.Stop();
    done = true;
    if (text.empty() || !window.IsVisible())
        return;
    Platform::textBlock block = laidOut(Localize(text));
    const auto width = static_cast<std::int32_t>(std::ceil(block.width() + 2 * cushion));
    const auto height = static_cast<std::int32_t>(std::ceil(block.height() + 2 * cushion));

    // Below the pointer, and within the screen: above it where there is no room.
    const Platform::rectangle area = CApplication::Current()->Display().workArea();
    const CPoint corner = window.ToScreen({at.x, at.y});
    double left = std::max(area.left, std::min(corner.x, area.right - width));
    double top = corner.y + 20;
    if (top + height > area.bottom)
        top = corner.y - 4 - height;
    const auto x = static_cast<std::int32_t>(left), y = static_cast<std::int32_t>(top);
    shown = std::make_unique<CWindow>(
        CWindowSettings{{}, Platform::windowKind::tip, 0, {x, y, x + width, y + height}, {30, 30, 30}});
    shown->Make<CTipPane>(CRect{0, 0, width, height}, std::move(block));
    shown->Open(&window);
    timer.SetPeriod(duration);
    timer.Start();
}

} // namespace Sarnik
