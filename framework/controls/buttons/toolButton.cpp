#include "framework/controls/buttons/toolButton.h"

namespace Sarnik
{
namespace
{

void addTools(const CContext &in, CObjID set, std::vector<CButton *> &to)
{
    for (const auto &child : in.Children())
    {
        if (auto *const tool = dynamic_cast<CToolButton *>(child.get()); tool != nullptr && tool->ToolSet() == set)
            to.push_back(tool);
        addTools(*child, set, to);
    }
}

} // namespace

const CObjID CToolClick::Message("Sarnik/ToolButton/Click");

void CToolButton::Choose(const CContext &in, CObjID set, CObjID tool)
{
    std::vector<CButton *> tools;
    addTools(in, set, tools);
    for (CButton *const button : tools)
        button->SetValue(button->Id() == tool ? kOn : kOff);
}

std::vector<CButton *> CToolButton::Group()
{
    std::vector<CButton *> tools;
    if (const CWindow *const window = Window())
        addTools(*window, toolSet, tools);
    return tools;
}

void CToolButton::Click(int clicks)
{
    if (IsOn())
    {
        CToolClick message(Id(), clicks);
        Dispatch(message);
        return;
    }
    SetValue(kOn);
    CValMsg<CObjID> message(toolSet, kValue_Click, Id());
    Dispatch(message);
}

void CToolButton::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CIconButton::ReadProperties(placement, properties);
    toolSet = CObjID(properties.Text("tool_set"));
}

} // namespace Sarnik
