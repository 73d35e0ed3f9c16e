#pragma once

#include "framework/controls/drawTools.h"
#include "framework/controls/layoutPane.h"
#include "framework/messages/messages.h"
#include "framework/views/window.h"

#include <cstdint>
#include <memory>
#include <string>
#include <utility>

namespace Sarnik
{

/// A pane that the user works with: it has a font, perhaps a label, and tells its parents about changes of its value.
/// Whoever changes the value from the program calls the class's SetValue, which tells nobody.
class CControl : public CLayoutPane
{
public:
    explicit CControl(const CRect &viewFrame = {}, std::uint32_t viewOptions = kView_Target | kView_TabStop)
        : CLayoutPane(viewFrame, viewOptions)
    {
    }

    /// To be localised; "&" marks the access key.
    void SetText(std::string text);
    const std::string &Text() const { return rawText; }
    const CDrawTools::label &Label() const { return label; }
    void SetFont(std::int32_t number);
    std::int32_t FontNumber() const { return fontNumber; }
    Platform::font Font() const { return CDrawTools::Font(fontNumber); }

    char32_t AccessKey() const override { return label.key; }

    void MouseEnter() override { SetHot(true); }
    void MouseLeave() override { SetHot(false); }
    void FocusChanged(bool) override { Invalidate(); }
    void StateChanged() override { Invalidate(); }

    /// Expires with the control: whoever goes on after a message of it looks here first.
    std::weak_ptr<const void> Life() const { return life; }

protected:
    /// text and the font that `fontProperty` names, or control_font, or text_font.
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    /// The property that names the class's own font; empty for none.
    virtual std::string_view FontProperty() const { return {}; }
    static std::int32_t ReadFont(const CWyraVariablePropertyList &properties, std::string_view ownProperty);

    bool IsHot() const { return hot; }
    /// Whether the focus ring is to be drawn: it has the focus, and the user finds the way by keyboard.
    bool ShowsRing() const { return HasFocus() && Window()->ShowsFocus(); }
    void SetHot(bool isHot);
    Platform::colour Ink() const { return IsEnabled() ? CDrawTools::Colours().text : CDrawTools::Colours().textDim; }
    /// The room of the view in its own coordinates.
    Platform::rectangle Room() const { return toCanvas(Bounds()); }

    /// Climbs from this control up the tree. The control may be gone afterwards.
    template <class T> bool SendValue(EValuePhase phase, T value)
    {
        CValMsg<T> message(Id(), phase, std::move(value));
        return Dispatch(message);
    }
    /// As a command of the id, from this control upwards. The control may be gone afterwards.
    bool SendCommand(CObjID command);

private:
    std::shared_ptr<const void> life = std::make_shared<char>();
    std::string rawText;
    CDrawTools::label label;
    std::int32_t fontNumber = kFont_UIMedium;
    bool hot = false;
};

} // namespace Sarnik
