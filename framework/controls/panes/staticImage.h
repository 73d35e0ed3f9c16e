#pragma once

#include "framework/controls/iconSource.h"
#include "framework/controls/layoutPane.h"

#include <string>

namespace Sarnik
{

/// A picture in the middle of its view: one of the program's by its name (`icon`), or any other.
class CStaticImage : public CLayoutPane
{
public:
    using CLayoutPane::CLayoutPane;

    void SetIcon(std::string name);
    void SetImage(CIcon picture);

    void StateChanged() override { Invalidate(); }
    void Draw(CPort &port) override;

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;

private:
    std::string icon;
    CIcon image;
};

} // namespace Sarnik
