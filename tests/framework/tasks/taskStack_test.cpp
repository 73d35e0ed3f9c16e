#include "framework/tasks/taskStack.h"

#include "framework/base/exceptions.h"

#include <gtest/gtest.h>
#include <utility>
#include <vector>

// Random sequences of tasks that change something real are in tests/dialog/tasks.
namespace Sarnik
{
namespace
{

/// What tasks write on, and what became of them: p pushed, u undone, r redone.
struct paper
{
    std::string lines, told, destroyed;
    bool fails = false; ///< the next execution
};

class writing final : public CTask
{
public:
    writing(paper &on, char what, bool written = false, const char *given = nullptr)
        : CTask(written), sheet(on), line(what), name(given)
    {
    }
    ~writing() override { sheet.destroyed += line; }
    bool GetName(std::string &text) const override
    {
        if (name)
            text = name;
        return name != nullptr;
    }
    void Pushed() override { sheet.told += 'p'; }
    void Undone() override { sheet.told += 'u'; }
    void Redone() override { sheet.told += 'r'; }

private:
    void Check()
    {
        if (std::exchange(sheet.fails, false))
            throw CError("$$$/Test/Fails=no paper");
    }
    void PerformUndo() override
    {
        Check();
        sheet.lines.pop_back();
    }
    void PerformRedo() override
    {
        Check();
        sheet.lines += line;
    }

    paper &sheet;
    char line;
    const char *name;
};

struct limitedStack : CTaskStack
{
    bool GetLimit(int &most) const override
    {
        most = limit;
        return limit >= 0;
    }
    int limit = -1;
};

TEST(TaskStack, KeepsTheLimitAndDestroysTheOldestFirst)
{
    paper sheet;
    {
        limitedStack stack;
        for (const char line : {'a', 'b', 'c', 'd', 'e', 'f', 'g'})
            stack.Push(std::make_unique<writing>(sheet, line));
        for (int i = 0; i < 3; ++i)
            stack.Undo();
        stack.limit = 6;
        stack.Push(nullptr);
        EXPECT_EQ(sheet.destroyed, "g"); // what could be redone, the farthest away first
        stack.limit = 3;
        stack.Trim();
        EXPECT_EQ(sheet.destroyed, "gfea");
        EXPECT_TRUE(stack.WillUndo());
        stack.UndoRedo(); // back once more, for there is nothing to redo
        EXPECT_EQ(sheet.lines, "abc");
        stack.limit = 0; // one
        stack.Push(std::make_unique<writing>(sheet, 'x'));
        EXPECT_EQ(sheet.destroyed, "gfeadbc");
        stack.limit = -1;
        stack.Push(std::make_unique<writing>(sheet, 'y'));
        stack.Push(std::make_unique<writing>(sheet, 'z'));
        stack.Undo();
    }
    EXPECT_EQ(sheet.destroyed, "gfeadbczxy");

    CTaskStack plain;
    plain.Push(std::make_unique<writing>(sheet, '1'));
    plain.Push(std::make_unique<writing>(sheet, '2'));
    EXPECT_EQ(sheet.destroyed, "gfeadbczxy1");
}

TEST(TaskStack, FailuresLeaveItAsItWas)
{
    paper sheet;
    limitedStack stack;
    stack.Push(std::make_unique<writing>(sheet, 'a'));
    stack.Push(std::make_unique<writing>(sheet, 'b'));
    const std::uintptr_t both = stack.Position();
    stack.Undo();
    const std::uintptr_t one = stack.Position();
    EXPECT_TRUE(both != one && one != 0);
    for (const bool undo : {true, false})
    {
        sheet.fails = true;
        EXPECT_THROW(undo ? stack.Undo() : stack.Redo(), CError);
    }
    sheet.fails = true;
    EXPECT_THROW(stack.Push(std::make_unique<writing>(sheet, 'c')), CError);
    EXPECT_EQ(sheet.destroyed, "c");
    EXPECT_EQ(stack.Position(), one);
    EXPECT_TRUE(stack.CanRedo());
    stack.UndoRedo();
    EXPECT_EQ(stack.Position(), both);
    EXPECT_EQ(sheet.lines, "ab");
    stack.ClearAll();
    EXPECT_EQ(stack.Position(), 0u);
    stack.Push(std::make_unique<writing>(sheet, 'b'));
    EXPECT_NE(stack.Position(), both);
}

TEST(TaskStack, TellsTheTaskAndNamesIt)
{
    paper sheet;
    limitedStack stack;
    std::string text;
    EXPECT_FALSE(stack.GetUndoText(text));
    EXPECT_EQ(text, "Cannot Undo");
    EXPECT_FALSE(stack.GetRedoText(text));
    EXPECT_EQ(text, "Cannot Redo");
    stack.Push(std::make_unique<writing>(sheet, 'a'));
    stack.Push(std::make_unique<writing>(sheet, 'b', false, "$$$/Test/Write=Write ^0"));
    EXPECT_TRUE(stack.GetUndoText(text));
    EXPECT_EQ(text, "Undo Write ^0");
    stack.Undo();
    EXPECT_TRUE(stack.GetUndoText(text));
    EXPECT_EQ(text, "Undo");
    EXPECT_TRUE(stack.GetRedoText(text));
    EXPECT_EQ(text, "Redo Write ^0");
    stack.UndoRedo();
    stack.Push(std::make_unique<writing>(sheet, 'c', true)); // its change was made before
    EXPECT_EQ(sheet.told, "ppurp");
    EXPECT_EQ(sheet.lines, "ab");
}

} // namespace
} // namespace Sarnik
