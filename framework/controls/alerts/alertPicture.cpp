#include "framework/controls/alerts/alertPicture.h"

#include "framework/controls/drawTools.h"

namespace Sarnik
{
namespace
{

constexpr Platform::colour amber{240, 178, 50}, red{222, 76, 66}, dark{40, 40, 40};

/// "!" or "i": a bar and a dot, from the top down or the other way round, around a middle.
void drawStroke(Platform::canvas &canvas, Platform::point middle, double unit, bool dotOnTop, Platform::colour ink)
{
    const double sign = dotOnTop ? -1 : 1;
    const double dot = middle.y + sign * 7 * unit;
    canvas.drawLine({middle.x, middle.y - sign * 7.5 * unit}, {middle.x, middle.y + sign * 2 * unit},
                    {.ink = ink, .width = 3.4 * unit, .roundEnds = true});
    canvas.fillEllipse({middle.x - 2 * unit, dot - 2 * unit, middle.x + 2 * unit, dot + 2 * unit}, ink);
}

} // namespace

void CAlertPicture::Draw(CPort &port)
{
    Platform::canvas &canvas = port.Canvas();
    const Platform::rectangle room = toCanvas(Bounds());
    const double unit = room.width() / 36;
    const Platform::point middle{room.width() / 2, room.height() / 2};
    if (icon == CAlertIcon::warning)
    {
        Platform::path triangle;
        triangle.moveTo({18 * unit, 4 * unit}).lineTo({33.5 * unit, 31 * unit}).lineTo({2.5 * unit, 31 * unit}).close();
        canvas.fill(triangle, amber);
        canvas.stroke(triangle, {.ink = amber, .width = 4 * unit, .roundJoins = true});
        drawStroke(canvas, {middle.x, middle.y + 3 * unit}, unit * 0.95, false, dark);
        return;
    }
    const Platform::colour fill = icon == CAlertIcon::error ? red : CDrawTools::Colours().accent;
    canvas.fillEllipse({unit, unit, 35 * unit, 35 * unit}, fill);
    const Platform::colour white{255, 255, 255};
    if (icon == CAlertIcon::information)
        drawStroke(canvas, {middle.x, middle.y + 0.5 * unit}, unit, true, white);
    else if (icon == CAlertIcon::error)
        drawStroke(canvas, middle, unit, false, white);
    else if (icon == CAlertIcon::question)
    {
        const Platform::textBlock mark("?", {.size = 24 * unit, .bold = true});
        CDrawTools::Text(port, room, mark, white, kAlign_Center, kAlign_Center);
    }
}

} // namespace Sarnik
