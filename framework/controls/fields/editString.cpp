#include "framework/controls/fields/editString.h"

#include "framework/base/localisedString.h"
#include "framework/layout/layoutFlags.h"
#include "framework/views/application.h"
#include "framework/views/window.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

/// Between the frame and the text.
constexpr double insetX = 5, insetY = 2;
/// Of several lines, however narrow the field.
constexpr double leastWidth = 30;
/// Seconds between the caret's coming and going, and how often until it stands still.
constexpr double blinkPeriod = 0.53;
constexpr int mostBlinks = 40;

} // namespace

CEditString::CEditString(const CRect &viewFrame, std::uint32_t viewOptions)
    : CControl(viewFrame, viewOptions), blink(blinkPeriod, Blink, this)
{
}

void CEditString::SetValue(std::string_view utf8)
{
    if (editor.Cleaned(utf8) == editor.Text())
        return;
    ReplaceText(utf8);
    restored = editor.Text();
}

void CEditString::ReplaceText(std::string_view utf8)
{
    editor.SetText(utf8);
    scroll = {};
    if (HasFocus())
        Reveal();
    else if (SeveralLines())
    {
        // From the beginning. One line has no bar, and is laid out when it is drawn.
        editor.Select(0, 0);
        ScrollTo({});
    }
    Grow();
    Invalidate();
}

void CEditString::SetEditOptions(std::uint32_t bits)
{
    editBits = bits;
    SetMaxCharacters(maxCharacters);
}

void CEditString::SetMaxCharacters(std::size_t most)
{
    maxCharacters = most;
    editor.SetRules(SeveralLines(), most);
    ScrollTo(scroll);
    Invalidate();
}

void CEditString::SetTextAlign(EAlign toWhere)
{
    align = toWhere;
    Invalidate();
}

void CEditString::Select(std::size_t from, std::size_t to)
{
    editor.Select(from, to);
    Reveal();
}

void CEditString::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CControl::ReadProperties(placement, properties);
    editBits = static_cast<std::uint32_t>(ReadFlags(properties, "text_options"));
    SetMaxCharacters(static_cast<std::size_t>(std::max(0, properties.Integer("max_characters"))));
    std::int32_t where = kAlign_Default;
    properties.ReadAny({"text_align_x", "text_align"}, &where);
    align = static_cast<EAlign>(std::clamp<std::int32_t>(where, kAlign_Default, kAlign_Full));
    growLines[0] = std::clamp(properties.Integer("min_grow_lines", 1), 1, 1000);
    growLines[1] = std::clamp(properties.Integer("max_grow_lines", 8), growLines[0], 1000);
    growWidth[0] =
        std::clamp(properties.Integer("min_grow_width", static_cast<std::int32_t>(Frame().Width())), 1, 10000);
    growWidth[1] = std::clamp(properties.Integer("max_grow_width", 400), growWidth[0], 10000);
    SetValue(Localize(Text()));
}

CLayoutSize CEditString::NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure)
{
    const std::int32_t font = ReadFont(properties, "edit_font");
    const CLayoutSize line = measure.Measure("0", font);
    const std::int32_t edges = 2 * CDrawTools::ringRoom + 2 * static_cast<std::int32_t>(insetX);
    const std::int32_t characters = std::clamp(properties.Integer("text_characters", 16), 1, 1000);
    const bool several = (ReadFlags(properties, "text_options") & kEdit_MultiLine) != 0;
    const std::int32_t lines = several ? std::clamp(properties.Integer("text_lines", 3), 1, 1000) : 1;
    const std::int32_t width = std::clamp(properties.Integer("text_width", characters * line.width), 1, 10000);
    return {width + edges + (several ? BarThickness() : 0),
            std::max(naturalHeight, line.height * lines + 2 * CDrawTools::ringRoom + 4)};
}

// Places.

const CTextLines &CEditString::Lines() const
{
    const bool several = SeveralLines();
    layout.Set(editor.Text(), {.font = Font(),
                               .lines = several,
                               .dotted = Has(kEdit_Password),
                               .width = several ? std::max(leastWidth, TextRoom().width() - 1) : 0,
                               .align = align == kAlign_Center ? Platform::textAlign::centre
                                        : align == kAlign_Far  ? Platform::textAlign::right
                                                               : Platform::textAlign::left});
    return layout;
}

Platform::rectangle CEditString::TextRoom() const
{
    const Platform::rectangle all = Room();
    const bool framed = !Has(kEdit_NoFrame), several = SeveralLines();
    const double x = framed ? CDrawTools::ringRoom + insetX : 0;
    const double y = framed ? CDrawTools::ringRoom + (several ? insetY : 1) : 0;
    // The bar's room is never the text's, so that lines do not break elsewhere as it comes and goes.
    const double right = several ? BarEdge() + BarThickness() + 2 : x;
    return {all.left + x, all.top + y, all.right - right, all.bottom - y};
}

CPoint CEditString::Origin() const
{
    const Platform::rectangle room = TextRoom();
    if (SeveralLines())
        return {room.left, room.top - scroll.y};
    const CTextLines &lines = Lines();
    // One place right of the text is the caret's.
    const double spare = room.width() - lines.Width() - 1;
    const double shift = spare <= 0 ? 0 : align == kAlign_Center ? spare / 2 : align == kAlign_Far ? spare : 0;
    return {room.left + shift - scroll.x, std::round(room.top + (room.height() - lines.LineHeight()) / 2)};
}

std::size_t CEditString::OffsetAt(CPoint at) const
{
    const CPoint origin = Origin();
    return Lines().OffsetAt({at.x - origin.x, at.y - origin.y});
}

void CEditString::Grow()
{
    if (!Has(kEdit_AutoGrow))
        return;
    CRect frame = Frame();
    const CTextLines &lines = Lines();
    const double chrome = SeveralLines() ? frame.Height() - TextRoom().height() : frame.Width() - TextRoom().width();
    const auto limited = [&](double wanted, double least, double most) {
        return static_cast<std::int32_t>(std::ceil(std::clamp(wanted, least, most) + chrome));
    };
    if (SeveralLines())
    {
        const double line = lines.LineHeight();
        frame.bottom = frame.top + limited(lines.Height(), growLines[0] * line, growLines[1] * line);
    }
    else
        frame.right = frame.left + limited(lines.Width() + 1, growWidth[0] - chrome, growWidth[1] - chrome);
    SetFrame(frame);
}

// Drawing.

void CEditString::Draw(CPort &port)
{
    const CPalette &colours = CDrawTools::Colours();
    const Platform::rectangle all = Room();
    constexpr double ring = CDrawTools::ringRoom;
    const Platform::rectangle box{all.left + ring, all.top + ring, all.right - ring, all.bottom - ring};
    if (!Has(kEdit_NoFrame))
    {
        CDrawTools::Field(port, box, IsEnabled() && !Has(kEdit_ReadOnly), IsEnabled() && IsHot() && !HasFocus());
        if (HasFocus())
            CDrawTools::FocusRing(port, box);
    }

    Platform::canvas &canvas = port.Canvas();
    const CTextLines &lines = Lines();
    const CPoint origin = Origin();
    Platform::rectangle room = TextRoom();
    room.right += 1; // the caret behind the last character
    canvas.save();
    canvas.clip(room);
    const CTextPieces::span sight{room.top - origin.y, room.bottom - origin.y};
    if (HasFocus())
        for (const Platform::rectangle &part : lines.Covered(editor.From(), editor.To(), sight))
            canvas.fillRectangle(canvas.sharp(Platform::rectangle{origin.x + part.left, origin.y + part.top,
                                                                  origin.x + part.right, origin.y + part.bottom}),
                                 colours.accent);
    const double base = lines.Pieces().Baseline();
    const Platform::point begin = canvas.sharp(Platform::point{origin.x, origin.y + base});
    lines.Pieces().Draw(canvas, {begin.x, begin.y - base}, sight, Ink());
    if (caretShown)
        canvas.fillRectangle(toCanvas(CaretRect()), colours.text);
    canvas.restore();
}

CRect CEditString::CaretRect() const
{
    if (!HasFocus() || Has(kEdit_ReadOnly))
        return {};
    const CPoint origin = Origin();
    const Platform::rectangle caret = Lines().Caret(editor.Caret());
    const auto left = static_cast<std::int32_t>(std::lround(origin.x + caret.left));
    const auto top = static_cast<std::int32_t>(std::lround(origin.y + caret.top));
    return {left, top, left + 1, top + static_cast<std::int32_t>(std::lround(caret.height()))};
}

void CEditString::Blink(void *field)
{
    auto &self = *static_cast<CEditString *>(field);
    self.caretShown = !self.caretShown || ++self.blinks >= mostBlinks;
    if (self.blinks >= mostBlinks)
        self.blink.Stop();
    self.Invalidate(self.CaretRect());
}

void CEditString::ShowCaret()
{
    const bool has = HasFocus();
    caretShown = has;
    blinks = 0;
    if (has)
        blink.Start();
    else
        blink.Stop();
}

void CEditString::FocusChanged(bool has)
{
    if (has)
    {
        restored = editor.Text();
        // In several lines, what can be seen and the caret stay where they are.
        if (!SeveralLines())
            editor.SelectAll();
        ShowCaret();
        Invalidate();
        return;
    }
    blink.Stop();
    caretShown = false;
    scroll.x = 0;
    wantedX = -1;
    editor.Select(editor.Caret(), editor.Caret());
    Invalidate();
    const std::weak_ptr<const void> alive = Life();
    Commit();
    if (!alive.expired() && !HasFocus())
        editor.ForgetHistory();
}

void CEditString::Commit()
{
    restored = editor.Text();
    EndEdit();
}

void CEditString::SendPhase(EValuePhase phase)
{
    SendValue(phase, phase == kValue_EditBegin ? restored : Value());
}

void CEditString::Restore()
{
    if (editor.Text() != restored)
        ReplaceText(std::string(restored));
    if (HasFocus())
        editor.SelectAll();
    Invalidate();
    EndEdit();
}

void CEditString::Beep()
{
    if (CApplication *const application = CApplication::Current())
        application->Display().beep();
}

} // namespace Sarnik
