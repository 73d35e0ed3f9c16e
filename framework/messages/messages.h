#pragma once

#include "framework/messages/objectId.h"
#include "platform/keys.h"

#include <cstdint>
#include <string>
#include <utility>

namespace Sarnik
{

/// What messengers are told. An id says what it is about; the class says which handler it goes to.
class CMessage
{
public:
    explicit CMessage(CObjID messageId) : id(messageId) {}
    virtual ~CMessage() = default;

    CObjID Id() const { return id; }

private:
    CObjID id;
};

/// Where in a change of its value a control is. Dragging and editing each begin once, go on any number of times, and
/// end once. The begin carries the value as it was, what follows the new ones, the end the final one, which is the old
/// one again where the user has given up.
enum EValuePhase : int
{
    kValue_Set = 1,       ///< by the program, not by the user
    kValue_Click = 2,     ///< by one click: buttons, popups, menus
    kValue_DragBegin = 3, ///< pressed; an undo step covers what follows
    kValue_Drag = 4,
    kValue_DragEnd = 5,
    kValue_EditBegin = 6, ///< typed, stepped by key or wheel; an undo step covers what follows
    kValue_Edit = 7,
    kValue_EditEnd = 8
};

constexpr bool isFinal(EValuePhase phase)
{
    return phase == kValue_DragEnd || phase == kValue_EditEnd || phase == kValue_Click || phase == kValue_Set;
}

enum EButtonValue : int
{
    kOff = 0,
    kOn = 1,
    kNeutral = 2
};

/// A number as sliders and fields hold it.
struct CNumber
{
    double value = 0;

    friend auto operator<=>(const CNumber &, const CNumber &) = default;
};

/// A control's value has changed, or its button was pressed. The id is the control's.
class CValueMessage : public CMessage
{
public:
    CValueMessage(CObjID control, EValuePhase valuePhase) : CMessage(control), phase(valuePhase) {}

    EValuePhase Phase() const { return phase; }

private:
    EValuePhase phase;
};

/// With the value: unsigned for what is chosen from a list, CNumber, CObjID, EButtonValue, std::string for typed text.
template <class T> class CValMsg : public CValueMessage
{
public:
    CValMsg(CObjID control, EValuePhase valuePhase, T newValue)
        : CValueMessage(control, valuePhase), value(std::move(newValue))
    {
    }

    const T &Value() const { return value; }

private:
    T value;
};

/// A command is to be carried out, or somebody wants to know whether and under what name it could be. The id is the
/// command's. Who knows a command fills in the answers.
class CCommandMessage : public CMessage
{
public:
    enum class purpose
    {
        carryOut,
        update
    };

    explicit CCommandMessage(CObjID command, purpose what = purpose::carryOut) : CMessage(command), why(what) {}

    purpose Purpose() const { return why; }

    // Answers to an update.
    bool enabled = false;
    bool checked = false;
    std::string text; ///< to be localised; empty leaves the menu's own

private:
    purpose why;
};

/// A menu opens or an item of it was chosen. The id is the menu's.
class CMenuMessage : public CMessage
{
public:
    enum class purpose
    {
        opening,
        chosen
    };

    CMenuMessage(CObjID menu, purpose what, CObjID chosenItem = {}) : CMessage(menu), why(what), item(chosenItem) {}

    purpose Purpose() const { return why; }
    CObjID Item() const { return item; }

private:
    purpose why;
    CObjID item;
};

/// A key together with its modifiers (Platform::modifier): bit 1 Alt, bit 2 Ctrl, bit 3 Shift.
struct CShortcut
{
    Platform::key key = Platform::key::none;
    std::uint32_t modifiers = 0;

    friend auto operator<=>(const CShortcut &, const CShortcut &) = default;

    /// As a menu shows it: "Ctrl+Shift+Z"; empty without a key.
    std::string Text() const;
};

/// A key went down or up, or wrote a character. The id is the kind.
class CKeyboardMessage : public CMessage
{
public:
    CKeyboardMessage(CObjID kind, Platform::key k, char32_t written, std::uint32_t modifierWord, bool isRepeat)
        : CMessage(kind), key(k), character(written), modifiers(modifierWord), repeat(isRepeat)
    {
    }

    Platform::key Key() const { return key; }
    /// What was written; for a key that goes down what it alone writes, 27 for Escape, 0 for F1.
    char32_t Character() const { return character; }
    std::uint32_t Modifiers() const { return modifiers; }
    bool Repeat() const { return repeat; }
    CShortcut Shortcut() const { return {key, modifiers}; }
    /// With or without Alt.
    bool IsDown() const;
    bool IsChar() const;

    /// Who takes a key that goes down keeps it from writing anything, unless the text itself is wanted.
    void WantText() { textWanted = true; }
    bool TextWanted() const { return textWanted; }

    static const CObjID KeyDown, KeyUp, KeyChar, KeyDeadChar, SysKeyDown, SysKeyUp, SysKeyChar, SysKeyDeadChar;

private:
    Platform::key key;
    char32_t character;
    std::uint32_t modifiers;
    bool repeat;
    bool textWanted = false;
};

/// A scroller has moved. The id is the scroller's.
class CScrollMessage : public CMessage
{
public:
    CScrollMessage(CObjID scroller, double toX, double toY) : CMessage(scroller), x(toX), y(toY) {}

    double X() const { return x; }
    double Y() const { return y; }

private:
    double x, y;
};

/// Something has happened that is no change of a value: a popup has closed, a view was laid out. The id says what, the
/// source who.
class CMessageEvent : public CMessage
{
public:
    CMessageEvent(CObjID what, CObjID whose) : CMessage(what), source(whose) {}

    CObjID Source() const { return source; }

private:
    CObjID source;
};

/// Posted, and delivered by the message loop (notifications.h).
class CustomNotificationMessage : public CMessage
{
public:
    using CMessage::CMessage;
};

} // namespace Sarnik
