#pragma once

#include "framework/controls/fields/editString.h"

#include <functional>

namespace Sarnik
{

/// The text of a control that opens a menu as well: a field without a frame of its own, whose changes go to the control
/// instead of up the tree.
class CComboField final : public CEditString
{
public:
    CComboField() { SetEditOptions(kEdit_NoFrame); }

    /// May delete the field.
    std::function<void(EValuePhase)> told;

    /// The frame around a field and the arrow to its right, and the room in it for the text.
    static void DrawAround(CPort &port, const CRect &face, EFace state, bool ring);
    static CRect RoomWithin(const CRect &face);
    static constexpr std::int32_t arrowWidth = 20;

protected:
    void SendPhase(EValuePhase phase) override
    {
        if (told)
            told(phase);
    }
};

} // namespace Sarnik
