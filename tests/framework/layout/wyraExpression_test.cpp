#include "framework/layout/layoutConstants.h"
#include "framework/layout/layoutError.h"
#include "framework/layout/wyraExpression.h"
#include "framework/layout/wyraParser.h"

#include <gtest/gtest.h>

#include <random>
#include <set>
#include <string>

namespace Sarnik
{
namespace
{

constexpr std::int32_t undefined = undefinedInteger;

/// In a view's scope, or in a plain one without logic.
std::int32_t evaluated(std::string_view expression, bool logic = true)
{
    CWyraDefinition definition;
    definition.File().Define("seven", {7, {}});
    CWyraText text(expression, nullptr);
    const std::int32_t value =
        CWyraExpression(text, nullptr).Evaluate(logic ? definition.File() : definition.Constants());
    if (text.Next() != '\0')
        text.Fail(text.Start(), "left over");
    return value;
}

TEST(WyraExpression, Values)
{
    // clang-format off
    const struct
    {
        const char *text;
        std::int32_t value;
    } cases[] = {
        {"10 / 3", 3}, {"7 % 3", 1}, {"-3 / 2", -1}, {"-7 % 3", -1}, {"2 + 3 * 4 - 1", 13}, {"20 - 5 - 5", 10},
        {"64 / 4 / 2", 8}, {"\t( 2+3 )\n*\v4", 20}, {"- - +5", 5}, {"!5 + !0 * 3", 3}, {"!!seven", 1},
        {"kWin_CanMove + kWin_CanSize", 6}, {"seven", 7}, {"007", 7},
        // comparisons and logic: 0 or 1, comparisons bind before equality, && before ||
        {"3 <= 3", 1}, {"3 < 3", 0}, {"4 >= 5", 0}, {"5 > 4", 1}, {"2 == 1 + 1", 1}, {"2 != 2", 0},
        {"1 < 2 == 1", 1}, {"1 || 0 && 0", 1}, {"9 && 4", 1}, {"0 || 0", 0}, {"2 > 1 && 0 != 1", 1},
        // functions
        {"min(4, 2, 9)", 2}, {"max(4, seven, -9)", 7}, {"dim(9, 4)", 5}, {"dim(4, 9)", 0}, {"in(3, 1, 3, 5)", 1},
        {"in(2, 1, 3, 5)", 0}, {"in(40, 1)", 0}, {"in(31, 31)", 1}, {"in(8, 40)", 0}, {"in(-1, -1)", 0},
        {"in(3)", 0}, {"in(0, 0)", 1}, {"1 && 1 && 0", 0}, {"max(min(1, 2), dim(max(8, 3), 2))", 6},
        // the function names are plain names elsewhere
        {"min", undefined}, {"max + 1", undefined},
        // undefined: passed on by sums and products, 0 in comparisons
        {"u", undefined}, {"u + 1", undefined}, {"2 * u", undefined}, {"u - u", undefined}, {"-u", undefined},
        {"u == u", 0}, {"u != 1", 0}, {"u < 1", 0}, {"1 >= u", 0}, {"!u", 0}, {"u || 0", 0}, {"u && 1", 0},
        {"min(u, 3)", undefined}, {"max(3, u)", undefined}, {"dim(3, u)", 0}, {"dim(u, 3)", 0}, {"in(u, 1)", 0},
        {"5 / 0", undefined}, {"5 % 0", undefined},
        // 32 bits that wrap around
        {"2147483647", 2147483647}, {"2147483647 + 2", -2147483647}, {"65536 * 65536", 0},
        {"(-2147483647 - 1) / -1", undefined}, {"dim(2147483647, -2)", -2147483647},
    };
    // clang-format on
    for (const auto &c : cases)
        EXPECT_EQ(evaluated(c.text), c.value) << c.text;
}

TEST(WyraExpression, RefusesWhatIsNoExpression)
{
    for (const char *const text : {"",
                                   "1 +",
                                   "1 2",
                                   "1 < 2 < 3",
                                   "1 == 2 == 3",
                                   "(1",
                                   "1)",
                                   "min(1)",
                                   "min()",
                                   "dim(1)",
                                   "dim(1, 2, 3)",
                                   "in()",
                                   "1.5",
                                   "0x10",
                                   "'1' + 1",
                                   "2147483648",
                                   "99999999999999999999999",
                                   "a & b",
                                   "a = b",
                                   "1 =! 2",
                                   "3 < = 4",
                                   "1 | 2"})
        EXPECT_THROW(evaluated(text), CLayoutError) << text;
    for (const char *const text : {"1 < 2", "1 == 1", "1 || 1", "in(1, 1)"})
        EXPECT_THROW(evaluated(text, false), CLayoutError) << text;
    EXPECT_EQ(evaluated("1 + max(2, 3)", false), 4);
}

TEST(WyraExpression, NestsToItsLimitAndNoFurther)
{
    const auto nested = [](int n, const char *open, const char *close) {
        std::string text;
        for (int i = 0; i < n; ++i)
            text += open;
        text += "1";
        for (int i = 0; i < n; ++i)
            text += close;
        return text;
    };
    EXPECT_EQ(evaluated(nested(40, "(", ")")), 1);
    EXPECT_EQ(evaluated(nested(80, "!", "")), 1);
    for (const char *const open : {"(", "-", "!(", "min(1,", "f(a:"})
        EXPECT_THROW(evaluated(nested(100'000, open, "")), CLayoutError) << open;
}

/// Random trees, printed with all their parentheses, against the arithmetic of the compiler.
struct tree
{
    std::string text;
    std::int64_t value;
};

tree randomTree(std::mt19937 &random, int depth)
{
    const auto pick = [&random](int n) { return static_cast<int>(random() % static_cast<unsigned>(n)); };
    if (depth == 0)
    {
        const int value = pick(20);
        return {std::to_string(value), value};
    }
    const tree a = randomTree(random, depth - 1), b = randomTree(random, pick(depth));
    const auto joined = [&](const char *sign, std::int64_t value) {
        return tree{"(" + a.text + sign + b.text + ")", value};
    };
    switch (pick(8))
    {
    case 0:
        return joined(" + ", a.value + b.value);
    case 1:
        return joined("-", a.value - b.value);
    case 2:
        return joined("<", a.value < b.value);
    case 3:
        return joined("==", a.value == b.value);
    case 4:
        return joined(" || ", a.value || b.value);
    case 5:
        return b.value != 0 ? joined(" / ", a.value / b.value) : joined("&&", false);
    case 6:
        return {"max(" + a.text + "," + b.text + ")", std::max(a.value, b.value)};
    default:
        return {"-" + a.text, -a.value};
    }
}

TEST(WyraExpression, AgreesWithTheCompilersArithmetic)
{
    std::mt19937 random(3);
    for (int i = 0; i < 2000; ++i)
    {
        const tree t = randomTree(random, 6);
        EXPECT_EQ(evaluated(t.text), t.value) << t.text;
    }
}

TEST(LayoutConstants, HaveOneNameEachAndAddUp)
{
    std::set<std::string_view> names;
    for (const CLayoutConstant &constant : LayoutConstants())
        EXPECT_TRUE(names.insert(constant.name).second) << constant.name;
    EXPECT_EQ(names.size(), 319u + 15u);
    for (const char *const law :
         {"kBind_Scrollable == kBind_XScrollable + kBind_YScrollable",
          "kBind_FixedMiddle == kBind_XCenter + kBind_YCenter",
          "kBind_ScrollTopLeft == kBind_Scrollable + kBind_PinTopLeft", "kBind_NoPin == kBind_XNoPin + kBind_YNoPin",
          "kBind_LimitBottomRight == kBind_LimitBottom + kBind_LimitRight", "kFont_UIMicroBoldItalic == 21",
          "kBind_SizeCenterBottom == kBind_YSizeable + kBind_FixedCenterBottom", "kDividerBottomUIB == 63",
          "kWin_AllTargeting == kWin_CanTarget + kWin_CanBullseye + kWin_CanTabStop",
          "kView_SupressSurrenders == 131072",
          "kScroller_AllControls == kScroller_XBar + kScroller_YBar + kScroller_SizeBox",
          "kCellSheet_MultiSelect == 32"})
        EXPECT_EQ(evaluated(law), 1) << law;
}

} // namespace
} // namespace Sarnik
