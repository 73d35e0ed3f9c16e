#include "framework/controls/fields/editString.h"
#include "framework/views/application.h"
#include "framework/views/tracker.h"
#include "framework/views/window.h"
#include "platform/utf8.h"

#include <algorithm>
#include <cmath>

namespace Sarnik
{
namespace
{

using Platform::key;

const CCommandID cutCommand("sarnik/command/cut"), copyCommand("sarnik/command/copy"),
    pasteCommand("sarnik/command/paste"), clearCommand("sarnik/command/clear"),
    selectAllCommand("sarnik/command/selectAll"), undoCommand("sarnik/command/undo"),
    redoCommand("sarnik/command/redo");

/// Seconds between the steps of a text that scrolls under a selection, and units of a step.
constexpr double scrollPeriod = 0.04, scrollStep = 12;

Platform::display *currentDisplay()
{
    CApplication *const application = CApplication::Current();
    return application == nullptr ? nullptr : &application->Display();
}

} // namespace

/// Selects by dragging; what lies outside scrolls in.
class CTextTracker final : public CTracker
{
public:
    CTextTracker(CEditString &of, bool byWords)
        : CTracker(of), field(of), words(byWords), origin{of.Editor().From(), of.Editor().To()},
          timer(scrollPeriod, Scroll, this)
    {
    }

protected:
    bool Begin() override
    {
        timer.Start();
        return true;
    }

    void Track() override
    {
        const std::size_t at = field.OffsetAt(CurrentPoint());
        const CTextEditor &editor = field.Editor();
        if (!words)
            return field.MoveTo(at, true);
        const CTextEditor::range word = editor.WordAt(at);
        if (at < origin.from)
            field.Select(origin.to, word.from);
        else
            field.Select(origin.from, at > origin.to ? word.to : origin.to);
    }

private:
    static void Scroll(void *tracker)
    {
        auto &self = *static_cast<CTextTracker *>(tracker);
        if (!self.Running() || self.View() == nullptr)
            return;
        const Platform::rectangle room = self.field.TextRoom();
        const CPoint p = self.CurrentPoint();
        const bool several = self.field.SeveralLines();
        const double below = several ? p.y - room.bottom : p.x - room.right;
        const double above = several ? room.top - p.y : room.left - p.x;
        if (below <= 0 && above <= 0)
            return;
        CPoint to = self.field.scroll;
        (several ? to.y : to.x) += below > 0 ? scrollStep : -scrollStep;
        self.field.ScrollTo(to);
        // The caret follows the pointer and is brought into sight: the further outside, the faster.
        self.Track();
    }

    CEditString &field;
    bool words;
    CTextEditor::range origin;
    CTimer timer;
};

bool CEditString::MouseDown(const CMouseEvent &e)
{
    const std::size_t at = OffsetAt(e.at);
    if (e.clicks >= 3)
    {
        // The text stays where it is.
        editor.SelectAll();
        Invalidate();
        return true;
    }
    if (e.clicks == 2)
    {
        const CTextEditor::range word = editor.WordAt(at);
        Has(kEdit_Password) ? Select(0, Value().size()) : Select(word.from, word.to);
    }
    else
        MoveTo(at, e.Shift());
    CTextTracker tracker(*this, e.clicks == 2 && !Has(kEdit_Password));
    tracker.Run(e);
    return true;
}

bool CEditString::ReceiveKeyboard(CKeyboardMessage &message)
{
    if (!IsEnabled())
        return false;
    if (message.IsDown())
        return KeyDown(message);
    const char32_t c = message.Character();
    if (message.Id() != CKeyboardMessage::KeyChar || (message.Modifiers() & Platform::ctrlModifier) != 0 || c < ' ' ||
        c == 127 || Has(kEdit_ReadOnly))
        return false;
    Type(Platform::utf8Of(c), CTextEditor::change::typed);
    return true;
}

bool CEditString::KeyDown(CKeyboardMessage &message)
{
    const bool ctrl = (message.Modifiers() & Platform::ctrlModifier) != 0;
    if ((message.Modifiers() & Platform::altModifier) != 0)
        return false;
    if (message.Key() == key::escape && IsEditing())
    {
        Restore();
        return true;
    }
    if (message.Key() == key::tab || message.Key() == key::escape)
        return false;
    if (ClipboardKey(message) || MoveKey(message) || EditKey(message))
        return true;
    // What it writes comes as its own message, and is no shortcut meanwhile.
    if (ctrl || message.Character() < ' ' || message.Character() == 127 || Has(kEdit_ReadOnly))
        return false;
    message.WantText();
    return true;
}

bool CEditString::MoveKey(const CKeyboardMessage &message)
{
    const bool ctrl = (message.Modifiers() & Platform::ctrlModifier) != 0;
    const bool shift = (message.Modifiers() & Platform::shiftModifier) != 0;
    const bool several = SeveralLines();
    const std::size_t caret = editor.Caret(), end = Value().size();
    const CTextLines &lines = Lines();
    const double line = lines.LineHeight(), page = std::max(line, std::floor(TextRoom().height() / line) * line);
    const bool collapses = editor.HasSelection() && !shift && !ctrl;
    switch (message.Key())
    {
    case key::left:
        MoveTo(collapses ? editor.From() : ctrl ? lines.PreviousWord(caret) : lines.Previous(caret), shift);
        return true;
    case key::right:
        MoveTo(collapses ? editor.To() : ctrl ? lines.NextWord(caret) : lines.Next(caret), shift);
        return true;
    case key::home:
        MoveTo(ctrl ? 0 : lines.LineStart(caret), shift);
        return true;
    case key::end:
        MoveTo(ctrl ? end : lines.LineEnd(caret), shift);
        return true;
    case key::up:
    case key::down:
    case key::pageUp:
    case key::pageDown:
        break;
    default:
        return false;
    }
    if (!several)
        return StepKey(message);
    const bool up = message.Key() == key::up || message.Key() == key::pageUp;
    const bool paged = message.Key() == key::pageUp || message.Key() == key::pageDown;
    MoveDown((up ? -1 : 1) * (paged ? page : line), shift);
    return true;
}

bool CEditString::EditKey(const CKeyboardMessage &message)
{
    const bool ctrl = (message.Modifiers() & Platform::ctrlModifier) != 0;
    const bool shift = (message.Modifiers() & Platform::shiftModifier) != 0;
    switch (message.Key())
    {
    case key::backspace:
        Remove(direction::backwards, ctrl);
        return true;
    case key::del:
        Remove(direction::forwards, ctrl);
        return true;
    case key::enter:
        if (SeveralLines() && !Has(kEdit_ReadOnly) && !ctrl && (shift || !Has(kEdit_ReturnIsEnter)))
        {
            Type("\n", CTextEditor::change::whole);
            return true;
        }
        [[fallthrough]];
    case key::keypadEnter:
        if (!IsEditing())
            return false;
        editor.SelectAll();
        Invalidate();
        Commit();
        return true;
    default:
        return false;
    }
}

bool CEditString::ClipboardKey(const CKeyboardMessage &message)
{
    struct binding
    {
        CShortcut keys;
        CObjID command;
    };
    constexpr std::uint32_t ctrl = Platform::ctrlModifier, shift = Platform::shiftModifier;
    static const binding bindings[] = {
        {{key::x, ctrl}, cutCommand},       {{key::del, shift}, cutCommand}, {{key::c, ctrl}, copyCommand},
        {{key::insert, ctrl}, copyCommand}, {{key::v, ctrl}, pasteCommand},  {{key::insert, shift}, pasteCommand},
        {{key::a, ctrl}, selectAllCommand}, {{key::z, ctrl}, undoCommand},   {{key::z, ctrl | shift}, redoCommand},
        {{key::y, ctrl}, redoCommand},
    };
    for (const binding &b : bindings)
        if (b.keys == message.Shortcut())
        {
            bool able = false;
            CanDo(b.command, able);
            // What is not the field's to undo may be the window's.
            if (!able && (b.command == undoCommand || b.command == redoCommand))
                return false;
            if (able)
                Do(b.command);
            return true;
        }
    return false;
}

void CEditString::MoveTo(std::size_t offset, bool extending)
{
    editor.Select(extending ? editor.Anchor() : offset, offset);
    wantedX = -1;
    Reveal();
}

void CEditString::MoveDown(double by, bool extending)
{
    const double x = wantedX >= 0 ? wantedX : Lines().Caret(editor.Caret()).left;
    MoveTo(Lines().Below(editor.Caret(), x, by), extending);
    wantedX = x;
}

/// A change, which answers whether there was one, and what is told about it.
template <class Change> void CEditString::Edit(Change change)
{
    if (Has(kEdit_ReadOnly) || !change())
        return Beep();
    wantedX = -1;
    Grow();
    Reveal();
    const std::weak_ptr<const void> alive = Life();
    BeginEdit();
    if (!alive.expired())
        Edited();
}

void CEditString::Type(std::string_view utf8, CTextEditor::change kind)
{
    const std::string incoming = Acceptable(utf8);
    if (incoming.empty() && !utf8.empty())
        return Beep();
    Edit([&] { return editor.Insert(incoming, kind); });
}

void CEditString::Remove(direction where, bool word)
{
    const CTextLines &lines = Lines();
    std::size_t from = editor.From(), to = editor.To();
    const bool selected = from != to;
    if (!selected && where == direction::backwards)
        from = word ? lines.PreviousWord(from) : lines.Previous(from);
    else if (!selected)
        to = word ? lines.NextWord(to) : lines.Next(to);
    if (from == to)
        return;
    const bool single = !selected && !word;
    Edit([&] { return editor.Erase(from, to, single ? CTextEditor::change::erased : CTextEditor::change::whole); });
}

bool CEditString::CanDo(CObjID command, bool &able) const
{
    const bool writes = !Has(kEdit_ReadOnly), tells = !Has(kEdit_Password);
    if (command == cutCommand)
        able = writes && tells && editor.HasSelection();
    else if (command == copyCommand)
        able = tells && editor.HasSelection();
    else if (command == pasteCommand)
        able = writes && currentDisplay() != nullptr && !currentDisplay()->clipboard().empty();
    else if (command == clearCommand)
        able = writes && editor.HasSelection();
    else if (command == selectAllCommand)
        able = !Value().empty();
    else if (command == undoCommand)
        able = writes && editor.CanUndo();
    else if (command == redoCommand)
        able = writes && editor.CanRedo();
    else
        return false;
    return true;
}

bool CEditString::Do(CObjID command)
{
    if ((command == copyCommand || command == cutCommand) && currentDisplay() != nullptr)
        currentDisplay()->setClipboard(editor.Selected());
    if (command == cutCommand || command == clearCommand)
        Remove(direction::forwards, false);
    else if (command == pasteCommand && currentDisplay() != nullptr)
        Type(currentDisplay()->clipboard(), CTextEditor::change::whole);
    else if (command == selectAllCommand)
    {
        editor.SelectAll();
        Invalidate();
    }
    else if (command == undoCommand)
        Edit([&] { return editor.Undo(); });
    else if (command == redoCommand)
        Edit([&] { return editor.Redo(); });
    return true;
}

bool CEditString::ReceiveCommand(CCommandMessage &message)
{
    bool able = false;
    if (!CanDo(message.Id(), able))
        return false;
    if (able)
        return Do(message.Id());
    // Whoever is above may have something to undo.
    return message.Id() != undoCommand && message.Id() != redoCommand;
}

bool CEditString::UpdateCommand(CCommandMessage &message)
{
    bool able = false;
    if (!CanDo(message.Id(), able))
        return false;
    if (!able && (message.Id() == undoCommand || message.Id() == redoCommand))
        return false;
    message.enabled = able;
    if (message.Id() == undoCommand)
        message.text = "$$$/Sarnik/EditString/Undo=Undo Typing";
    else if (message.Id() == redoCommand)
        message.text = "$$$/Sarnik/EditString/Redo=Redo Typing";
    return true;
}

} // namespace Sarnik
