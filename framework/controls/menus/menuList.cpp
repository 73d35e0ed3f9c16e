#include "framework/controls/menus/menuList.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

/// Room for the check mark, between text and shortcut, and after them.
constexpr std::int32_t markWidth = 26, gap = 28, endWidth = 18;
/// Wider texts are trimmed.
constexpr std::int32_t widest = 600;

std::int32_t widthOf(const std::string &text, const Platform::font &font)
{
    return text.empty() ? 0 : static_cast<std::int32_t>(std::ceil(Platform::textBlock(text, font).width()));
}

} // namespace

CMenuList::CMenuList(std::vector<CMenuRow> menuRows, std::int32_t fontNumber)
    : rows(std::move(menuRows)), font(fontNumber),
      timer(
          scrollPeriod,
          [](void *list) {
              auto &self = *static_cast<CMenuList *>(list);
              if (!self.ScrollTo(self.offset + self.scrolling * rowHeight / 2))
                  self.timer.Stop();
          },
          this)
{
    const Platform::font face = CDrawTools::Font(font);
    std::int32_t texts = 0, y = cushion;
    for (const CMenuRow &row : rows)
    {
        tops.push_back(y);
        y += row.separator ? separatorHeight : rowHeight;
        texts = std::max(texts, widthOf(row.text.text, face));
        keysWidth = std::max(keysWidth, widthOf(row.keys, face));
    }
    tops.push_back(y);
    constexpr std::int32_t frame = 2;
    width = std::min(widest, frame + markWidth + texts + (keysWidth > 0 ? gap + keysWidth : 0) + endWidth);
}

bool CMenuList::CanChoose(int row) const
{
    return row >= 0 && row < static_cast<int>(rows.size()) && !rows[static_cast<std::size_t>(row)].separator &&
           rows[static_cast<std::size_t>(row)].enabled;
}

std::int32_t CMenuList::WantedHeight() const
{
    return tops.back() + cushion;
}

std::int32_t CMenuList::Largest() const
{
    return std::max(0, WantedHeight() - Bounds().bottom);
}

std::int32_t CMenuList::RoomBottom() const
{
    return Bounds().bottom - (MoreBelow() ? arrowHeight : 0);
}

CRect CMenuList::RowRect(int row) const
{
    const auto i = static_cast<std::size_t>(row);
    return {1, tops[i] - offset, Bounds().right - 1, tops[i + 1] - offset};
}

int CMenuList::RowAt(CPoint p) const
{
    if (p.x < 0 || p.x >= Bounds().right || p.y < RoomTop() || p.y >= RoomBottom())
        return none;
    for (std::size_t i = 0; i < rows.size(); ++i)
        if (p.y >= tops[i] - offset && p.y < tops[i + 1] - offset)
            return static_cast<int>(i);
    return none;
}

bool CMenuList::ScrollTo(std::int32_t to)
{
    to = std::clamp(to, 0, Largest());
    if (to == offset)
        return false;
    offset = to;
    Invalidate();
    return true;
}

void CMenuList::Light(int row)
{
    if (!CanChoose(row))
        row = none;
    if (row != lit)
    {
        for (const int changed : {lit, row})
            if (changed != none)
                Invalidate(RowRect(changed));
        lit = row;
    }
    if (row == none)
        return;
    // The arrows come and go with the offset: both are allowed for.
    const auto i = static_cast<std::size_t>(row);
    if (tops[i] - offset < RoomTop())
        ScrollTo(row == 0 ? 0 : tops[i] - arrowHeight);
    else if (tops[i + 1] - offset > RoomBottom())
        ScrollTo(tops[i + 1] + arrowHeight - Bounds().bottom);
}

int CMenuList::Neighbour(int row, bool forward) const
{
    const int count = static_cast<int>(rows.size());
    int at = row == none && !forward ? 0 : row;
    for (int i = 0; i < count; ++i)
    {
        at = (at + (forward ? 1 : count - 1)) % count;
        if (CanChoose(at))
            return at;
    }
    return none;
}

int CMenuList::PageFrom(int row, bool down) const
{
    const int pageRows = std::max(1, (Bounds().bottom - 2 * arrowHeight) / rowHeight - 1);
    int best = row;
    for (int i = 0; i < pageRows; ++i)
    {
        const int next = Neighbour(best, down);
        if (next == none || (best != none && (next > best) != down))
            break;
        best = next;
    }
    return best;
}

void CMenuList::PointTo(CPoint p)
{
    const bool inside = toCanvas(Bounds()).contains(p);
    scrolling = inside && MoreAbove() && p.y < RoomTop() ? -1 : inside && MoreBelow() && p.y >= RoomBottom() ? 1 : 0;
    if (scrolling == 0)
        timer.Stop();
    else if (!timer.IsRunning())
        timer.Start();
    const int row = RowAt(p);
    // A row that shows in part is lit as it is; only keys bring it in.
    if (row == lit)
        return;
    const std::int32_t kept = offset;
    Light(row);
    ScrollTo(kept);
}

void CMenuList::MouseMove(const CMouseEvent &e)
{
    constexpr double slack = 2;
    if (!resting)
        resting = e.at;
    if (waiting && std::abs(e.at.x - resting->x) <= slack && std::abs(e.at.y - resting->y) <= slack)
        return;
    waiting = false;
    PointTo(e.at);
}

void CMenuList::PointNowhere()
{
    timer.Stop();
    Light(none);
}

bool CMenuList::MouseDown(const CMouseEvent &e)
{
    waiting = false;
    PointTo(e.at);
    return true;
}

void CMenuList::MouseUp(const CMouseEvent &e)
{
    const int row = RowAt(e.at);
    if (CanChoose(row) && chosen)
        chosen(row);
}

bool CMenuList::MouseWheel(const CMouseEvent &e)
{
    ScrollTo(offset - static_cast<std::int32_t>(std::lround(std::clamp(e.wheelY, -100.0, 100.0) * 3 * rowHeight)));
    PointTo(e.at);
    return true;
}

void CMenuList::DrawRow(CPort &port, const CMenuRow &row, const CRect &r, bool isLit) const
{
    const CPalette &c = CDrawTools::Colours();
    const Platform::rectangle place = toCanvas(r);
    if (row.separator)
    {
        const double y = (place.top + place.bottom) / 2;
        CDrawTools::Line(port, {place.left + 8, y}, {place.right - 8, y}, c.edgeLight.faded(0.6));
        return;
    }
    if (isLit)
        port.Canvas().fillRounded({place.left + 3, place.top, place.right - 3, place.bottom}, CDrawTools::corner,
                                  c.accent);
    const Platform::colour ink = row.enabled ? c.text : c.textDim;
    if (row.checked)
        CDrawTools::CheckMark(port, {place.left + 7, place.top + 4, place.left + 21, place.top + 18}, ink);
    const Platform::font face = CDrawTools::Font(font);
    const Platform::rectangle room{place.left + markWidth, place.top,
                                   place.right - endWidth - (keysWidth > 0 ? keysWidth + gap / 2 : 0), place.bottom};
    if (row.draw)
        row.draw(port, room, ink);
    else
        CDrawTools::Text(port, room, row.text, face, ink);
    // Shortcuts begin below one another.
    if (!row.keys.empty())
        CDrawTools::Text(port, {place.right - endWidth - keysWidth, place.top, place.right, place.bottom}, row.keys,
                         face, isLit || !row.enabled ? ink : ink.faded(0.8));
}

void CMenuList::Draw(CPort &port)
{
    const CPalette &c = CDrawTools::Colours();
    const Platform::rectangle all = toCanvas(Bounds());
    const double line = 1 / port.Scale();
    port.Canvas().fillRectangle(all, c.edgeLight);
    port.Canvas().fillRectangle({line, line, all.right - line, all.bottom - line}, c.menu);

    port.Canvas().save();
    port.Canvas().clip(
        {line, std::max<double>(line, RoomTop()), all.right - line, std::min<double>(all.bottom - line, RoomBottom())});
    for (std::size_t i = 0; i < rows.size(); ++i)
        if (const CRect r = RowRect(static_cast<int>(i)); port.Touches(r))
            DrawRow(port, rows[i], r, static_cast<int>(i) == lit);
    port.Canvas().restore();
    if (MoreAbove())
        CDrawTools::Chevron(port, {0, 0, all.right, arrowHeight}, CDrawTools::direction::up, c.text);
    if (MoreBelow())
        CDrawTools::Chevron(port, {0, all.bottom - arrowHeight, all.right, all.bottom}, CDrawTools::direction::down,
                            c.text);
}

} // namespace Sarnik
