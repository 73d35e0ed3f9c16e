#pragma once

#include "framework/controls/menus/menu.h"
#include "framework/views/timer.h"
#include "framework/views/view.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <vector>

namespace Sarnik
{

/// The rows of an open menu: where they lie, which one is lit, and how far they are scrolled where there are more than
/// there is room for. Rests of a press are its window's business.
class CMenuList final : public CPane
{
public:
    static constexpr int none = -1;
    static constexpr std::int32_t rowHeight = 22, separatorHeight = 9, cushion = 4;
    static constexpr std::int32_t arrowHeight = 18; ///< at an end where more rows follow

    CMenuList(std::vector<CMenuRow> menuRows, std::int32_t fontNumber);

    const std::vector<CMenuRow> &Rows() const { return rows; }
    bool CanChoose(int row) const;
    /// Of all rows, with the frame.
    std::int32_t WantedWidth() const { return width; }
    std::int32_t WantedHeight() const;

    int Lit() const { return lit; }
    /// A row that cannot be chosen lights none. Scrolls as far as the row needs.
    void Light(int row);
    /// The next row that can be chosen, around the ends; from none to the first or the last. None where there is none.
    int Neighbour(int row, bool forward) const;
    /// A page down or up, or the last that can be chosen.
    int PageFrom(int row, bool down) const;

    /// The row at a point of the pane, none in the arrows and outside.
    int RowAt(CPoint p) const;
    CRect RowRect(int row) const;
    /// The pointer is at a point, or has left: lights its row, and scrolls while it is on an arrow.
    void PointTo(CPoint p);
    void PointNowhere();

    void Draw(CPort &port) override;
    /// The pointer's place counts only once it has moved: keys have opened the menu, perhaps under a pointer that
    /// rests.
    void WaitForPointer() { waiting = true; }
    void MouseMove(const CMouseEvent &e) override;
    void MouseLeave() override { PointNowhere(); }
    bool MouseDown(const CMouseEvent &e) override;
    void MouseUp(const CMouseEvent &e) override;
    bool MouseWheel(const CMouseEvent &e) override;

    /// A row was chosen by the pointer. The list may be gone afterwards.
    std::function<void(int row)> chosen;

private:
    static constexpr double scrollPeriod = 1.0 / 25;

    std::int32_t RoomTop() const { return MoreAbove() ? arrowHeight : 0; }
    std::int32_t RoomBottom() const;
    bool MoreAbove() const { return offset > 0; }
    bool MoreBelow() const { return offset < Largest(); }
    std::int32_t Largest() const;
    bool ScrollTo(std::int32_t to);
    void DrawRow(CPort &port, const CMenuRow &row, const CRect &r, bool isLit) const;

    std::vector<CMenuRow> rows;
    std::vector<std::int32_t> tops; ///< of each row, unscrolled; one more for the end
    std::int32_t font;
    std::int32_t width = 0, keysWidth = 0;
    std::int32_t offset = 0;
    int lit = none;
    int scrolling = 0; ///< -1 up, 1 down
    bool waiting = false;
    std::optional<CPoint> resting; ///< where the pointer was first seen, while waiting
    CTimer timer;
};

} // namespace Sarnik
