#include "framework/controls/panes/staticImage.h"

#include "framework/controls/drawTools.h"

#include <cmath>
#include <utility>

namespace Sarnik
{

void CStaticImage::SetIcon(std::string name)
{
    icon = std::move(name);
    image = {};
    Invalidate();
}

void CStaticImage::SetImage(CIcon picture)
{
    icon.clear();
    image = std::move(picture);
    Invalidate();
}

void CStaticImage::Draw(CPort &port)
{
    CDrawTools::Icon(port, toCanvas(Bounds()), image ? image : CIconSource::Icon(icon, port.Scale()), kAlign_Center,
                     IsEnabled() ? 1 : 0.4);
}

CLayoutSize CStaticImage::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &)
{
    const CIcon picture = CIconSource::Icon(properties.Text("icon"), 1);
    return {static_cast<std::int32_t>(std::ceil(picture.Width())),
            static_cast<std::int32_t>(std::ceil(picture.Height()))};
}

void CStaticImage::ReadProperties(const CLayoutPlacement &, const CWyraVariablePropertyList &properties)
{
    icon = properties.Text("icon");
}

} // namespace Sarnik
