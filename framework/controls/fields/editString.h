#pragma once

#include "framework/controls/control.h"
#include "framework/controls/editPhases.h"
#include "framework/controls/fields/textEditor.h"
#include "framework/controls/fields/textLines.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace Sarnik
{

class CScrollBar;

/// How a field behaves; values are those of kEdit_... in layouts.
enum EEditOptions : std::uint32_t
{
    kEdit_NoOptions = 0,
    kEdit_MultiLine = 1,
    kEdit_AutoGrow = 2, ///< the frame follows the text: its height with several lines, otherwise its width
    kEdit_NoFrame = 4,
    kEdit_ReadOnly = 8,
    kEdit_Password = 16, ///< one line of dots, which are not copied
    kEdit_CanScroll = 32,
    kEdit_ReturnIsEnter = 64, ///< several lines, but the return key ends the edit; with Shift it makes a line
    kEdit_IgnoreFKeys = 128,
    kEdit_NoRangeAlert = 256 ///< numbers out of range are cut without a word
};

/// A field for text. The class "CEditString" of layouts. A change begins with the first key that changes the text and
/// ends with Enter or the loss of the focus; Escape brings back the text from before. Each tells so by a
/// CValMsg<std::string>. Answers the commands sarnik/command/cut, copy, paste, clear, selectAll, undo and redo while it
/// has the focus. Several lines that are higher than the field have a scroll bar.
class CEditString : public CControl, protected CEditPhases
{
public:
    explicit CEditString(const CRect &viewFrame = {}, std::uint32_t viewOptions = kView_Target | kView_TabStop);

    const std::string &Value() const { return editor.Text(); }
    /// Tells nobody. Ends nothing: a change under way goes on with this text.
    void SetValue(std::string_view utf8);
    std::uint32_t EditOptions() const { return editBits; }
    void SetEditOptions(std::uint32_t bits);
    /// 0 for no limit but CTextEditor::mostBytes.
    void SetMaxCharacters(std::size_t most);
    void SetTextAlign(EAlign toWhere);
    const CTextEditor &Editor() const { return editor; }
    void Select(std::size_t from, std::size_t to);
    /// Where the caret is drawn, in the view's coordinates; empty without one.
    CRect CaretRect() const;

    /// What typing began is told as ended; the next Escape comes back to here. Enter and the loss of the focus do it.
    virtual void Commit();
    /// Back to the text of the last commit, or of the beginning.
    virtual void Restore();

    void Draw(CPort &port) override;
    void FocusChanged(bool has) override;
    void FrameChanged() override;
    bool ReceiveKeyboard(CKeyboardMessage &message) override;
    bool ReceiveMessage(CMessage &message) override;
    bool ReceiveCommand(CCommandMessage &message) override;
    bool UpdateCommand(CCommandMessage &message) override;
    bool MouseDown(const CMouseEvent &e) override;
    bool MouseWheel(const CMouseEvent &e) override;
    bool CursorAt(CPoint at, Platform::cursor &cursor) override;
    char32_t AccessKey() const override { return 0; }

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure);
    static constexpr std::int32_t naturalHeight = 22;

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    std::string_view FontProperty() const override { return "edit_font"; }

    /// What of a typed or pasted text may go in.
    virtual std::string Acceptable(std::string_view utf8) const { return std::string(utf8); }
    /// Up, down and the page keys in a field of one line; true takes the key.
    virtual bool StepKey(const CKeyboardMessage &) { return false; }
    void SendPhase(EValuePhase phase) override;
    /// Replaces the text as an edit of the program's: nothing is told, nothing can be undone.
    void ReplaceText(std::string_view utf8);
    bool Has(EEditOptions bit) const { return (editBits & bit) != 0; }
    static void Beep();

private:
    friend class CTextTracker;

    // Input.
    enum class direction
    {
        backwards,
        forwards
    };
    bool KeyDown(CKeyboardMessage &message);
    bool MoveKey(const CKeyboardMessage &message);
    bool EditKey(const CKeyboardMessage &message);
    bool ClipboardKey(const CKeyboardMessage &message);
    void MoveTo(std::size_t offset, bool extending);
    /// A step of the caret that keeps its distance from the left edge.
    void MoveDown(double by, bool extending);
    void Type(std::string_view utf8, CTextEditor::change kind);
    void Remove(direction where, bool word);
    /// What a command can do now; false for one that the field does not know.
    bool CanDo(CObjID command, bool &able) const;
    bool Do(CObjID command);
    template <class Change> void Edit(Change change);

    // Places.
    bool SeveralLines() const { return Has(kEdit_MultiLine) && !Has(kEdit_Password); }
    const CTextLines &Lines() const;
    /// Within the frame, where text is seen.
    Platform::rectangle TextRoom() const;
    /// Where the text's own (0, 0) lies.
    CPoint Origin() const;
    std::size_t OffsetAt(CPoint at) const;
    void Grow();

    // Scrolling.
    std::int32_t BarEdge() const;
    static std::int32_t BarThickness();
    /// The furthest that the text can be scrolled.
    CPoint Largest() const;
    /// Cut to what there is; the bar follows, also where only the text or the field has changed.
    void ScrollTo(CPoint to);
    void PlaceBar();
    /// Brings the caret into sight.
    void Reveal();

    // Caret.
    static void Blink(void *field);
    void ShowCaret();

    CTextEditor editor;
    std::uint32_t editBits = 0;
    std::size_t maxCharacters = 0;
    EAlign align = kAlign_Default;
    std::int32_t growLines[2] = {1, 8}, growWidth[2] = {40, 400}; ///< least and most
    std::string restored;                                         ///< what Escape comes back to
    mutable CTextLines layout;
    CPoint scroll;
    CScrollBar *bar = nullptr; ///< a child, once one was needed
    double wantedX = -1;       ///< of the caret while it goes up and down; -1 for where it is
    bool caretShown = false;
    int blinks = 0;
    CTimer blink;
};

} // namespace Sarnik
