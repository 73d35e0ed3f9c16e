#pragma once

#include "framework/controls/buttons/iconButton.h"

namespace Sarnik
{

/// One of a set of tools: of all buttons in a window with the same tool_set one is on. Choosing one sends
/// CValMsg<CObjID>(set, kValue_Click, id of the button). A further click on the chosen one, and each click of a double
/// click but the first, sends a CToolClick. A press of the pointer leaves the focus where it is; arrows move the
/// choice.
class CToolButton : public CIconButton
{
public:
    explicit CToolButton(const CRect &viewFrame = {})
        : CIconButton(viewFrame, kRadioButton, kView_Target | kView_TabStop | kView_NoFocusOnClick)
    {
    }

    CObjID ToolSet() const { return toolSet; }
    void SetToolSet(CObjID to) { toolSet = to; }
    /// The program chooses the tool of a set: nobody is told. An id of no button leaves none on.
    static void Choose(const CContext &in, CObjID set, CObjID tool);

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
    {
        return CButton::NaturalSize(properties, measure, kButtonStyle_Tool, {});
    }

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    EButtonStyle OwnStyle() const override { return kButtonStyle_Tool; }
    void Click(int clicks) override;
    CObjID GroupId() const override { return toolSet; }
    std::vector<CButton *> Group() override;

private:
    CObjID toolSet;
};

/// A tool's button was clicked while the tool was chosen already. The id is Message, the source the button's.
class CToolClick : public CMessageEvent
{
public:
    CToolClick(CObjID tool, int clickCount) : CMessageEvent(Message, tool), clicks(clickCount) {}

    /// 2 for a double click, and so on.
    int Clicks() const { return clicks; }

    static const CObjID Message;

private:
    int clicks;
};

} // namespace Sarnik
