#include "framework/layout/layoutError.h"
#include "framework/layout/layoutFlags.h"
#include "tests/framework/layout/layoutViews.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <chrono>
#include <string>

namespace Sarnik
{
namespace
{

/// The properties of the outermost view's head.
class Head
{
public:
    explicit Head(const std::string &text) : definition(ParseLayout(text)) {}
    CWyraVariablePropertyList operator()() const { return definition->Root().Properties(); }

private:
    std::unique_ptr<CWyraDefinition> definition;
};

TEST(WyraParser, PropertiesAreIntegersAndTexts)
{
    const Head head(
        "code = 'Abcd'; again = code; n = 3; Box(a: 'Abcd', b: again, c: 'Abcde', d: n + n, e: '',"
        " f: '0.001', g: 1, g: 2, h: '$$$/K=a \n& b', i: '1e999', k: n, l: (code) + 0, m: '12', o: code) ;");
    const auto properties = head();
    EXPECT_EQ(properties.Integer("a"), 0x41626364);
    EXPECT_EQ(properties.Text("a"), "Abcd");
    EXPECT_EQ(properties.Integer("b"), 0x41626364); // a lone name hands on both, an expression the integer alone
    EXPECT_EQ(properties.Text("b"), "Abcd");
    EXPECT_EQ(properties.Text("b").data(), properties.Text("o").data()); // never copied: it may be very long
    EXPECT_EQ(properties.Integer("l"), 0x41626364);
    EXPECT_EQ(properties.Text("l"), "");
    EXPECT_EQ(properties.Integer("c", -1), -1);
    EXPECT_EQ(properties.Integer("m", -1), -1);
    EXPECT_EQ(properties.Integer("d"), 6);
    EXPECT_EQ(properties.Integer("k"), 3);
    EXPECT_EQ(properties.Integer("g"), 2);
    EXPECT_EQ(properties.LocalisedText("h"), "a \n& b");
    EXPECT_EQ(properties.Number("f"), 0.001);
    EXPECT_EQ(properties.Number("d"), 6);
    EXPECT_EQ(properties.Number("i", 5), 5); // no finite number
    std::string_view text = "untouched";
    EXPECT_TRUE(properties.ReadText("e", &text));
    EXPECT_EQ(text, "");
    EXPECT_FALSE(properties.ReadText("d", &text));
    EXPECT_THROW(properties.ReadInteger("a", nullptr), CLayoutError);
    EXPECT_THROW(properties.ReadText("a", nullptr), CLayoutError);
}

TEST(WyraParser, BooleansSetAndClearBitsOfTheirWord)
{
    const Head head("view_tabstop = true; Box(view_options: kView_Target + kView_DrawParts, view_target: false,"
                    " view_invisible: 2 > 1, text_framed: false, window_can_move: false);");
    EXPECT_EQ(ReadFlags(head(), "view_options"), 1 + 16 + 512);
    EXPECT_EQ(ReadFlags(head(), "text_options", 1), 1 + 4);
    EXPECT_EQ(ReadFlags(head(), "window_features", 7), 5);
}

TEST(WyraParser, VariablesHoldForWhatFollowsInTheirBodyAndInsideIt)
{
    const auto window = layoutBench().Build(R"(
        text_font = 1;
        Pane(view_id: 'root')
        {
            Box(view_id: 'before');
            text_font = kFont_UIMedium;
            Box(view_id: 'after');
            Pane(view_id: 'pane')
            {
                Box(view_id: 'inner');
                text_font = text_font + 1;
                Box(view_id: 'own', text_font: text_font * 2);
                Pane(text_font: 99) { Box(view_id: 'deep'); }
                text_font = 3;
                Box(view_id: 'redefined');
            }
            Box(view_id: 'last');
        })");
    const std::pair<const char *, int> fonts[] = {{"root", 1},  {"before", 1},    {"after", 10},
                                                  {"pane", 10}, {"inner", 10},    {"own", 22},
                                                  {"deep", 11}, {"redefined", 3}, {"last", 10}};
    for (const auto &[id, font] : fonts)
        EXPECT_EQ(window->Find(id)->font, font) << id;
}

TEST(WyraParser, StatementsDefineTheirOutputs)
{
    const Head head("step(10, -3, &a, &b, &c); align_centers(20, 13, a * 3, &x, &y, &z); step(nothing, 1, &u);"
                    " align_centers(1, 8, &left); Box(a: a, b: b, c: c, x: x, y: y, z: z, u: u + 1, left: left);");
    const std::pair<const char *, int> values[] = {{"a", 10}, {"b", 7}, {"c", 4},   {"x", 5},
                                                   {"y", 8},  {"z", 0}, {"u", -77}, {"left", 3}};
    for (const auto &[name, value] : values)
        EXPECT_EQ(head().Integer(name, -77), value) << name;
}

TEST(WyraParser, UnknownFunctionsAreAskedOfTheApplication)
{
    const layoutBench bench;
    CWyraGenerator generator(bench.measure, bench.map, [](std::string_view name, const CWyraPropertyList &arguments) {
        EXPECT_EQ(name, "size_of");
        CExpressionValue answer;
        answer.integer = arguments.Find("twice")->integer * 2;
        answer.text = *arguments.Find("name")->text;
        return answer;
    });
    generator.Parse("Text(width: size_of(name: 'x', twice: 4) + 1, text: size_of(name: 'four', twice: 0));");
    EXPECT_EQ(generator.MeasureViews(), (CLayoutSize{9, 15}));
    generator.Parse("Text(text: size_of(name: 'four', twice: 0));");
    EXPECT_EQ(generator.MeasureViews(), (CLayoutSize{28, 15}));
    EXPECT_THROW(generator.Parse("Text("), CLayoutError);
    EXPECT_THROW(generator.MeasureViews(), CLayoutError); // nothing is left of the one before
}

TEST(WyraParser, ErrorsTellAssertionAndPlace)
{
    const struct
    {
        const char *text, *message;
    } cases[] = {
        {"", "Warning! (viewProxyList->size() == 1) line 1, column 1: "},
        {"a = 1;", "Warning! (viewProxyList->size() == 1) line 1, column 7: "},
        {"Box();\nBox();", "Warning! (viewProxyList->size() == 1) line 2, column 7: "},
        {"Box() {}\n  }", "Warning! (*definition == 0) line 2, column 3: "},
        {"Box(width: gNone);", "Warning! (variable != NULL) line 1, column 12: no variable is named 'gNone'"},
        {"\n\ta = b ;Box();", "Warning! (variable != NULL) line 2, column 6: "},
        {"Pane()\n{\n Box(width 3);\n}", "Warning! (*definition == 0) line 3, column 12: expected ':'"},
        {"Pane() { Box() }", "Warning! (*definition == 0) line 1, column 16: expected ';'"},
        {"Box(text: 'never ends);", "Warning! (*definition == 0) line 1, column 11: a string without"},
        {"Box(text: '\xC3\xBC', 3);", "Warning! (*definition == 0) line 1, column 16: expected a property"},
        {"Box(a: 1,);", "Warning! (*definition == 0) line 1, column 10: "},
        {"Box(a: 1.5);", "Warning! (*definition == 0) line 1, column 9: "},
        {"Box(a: 9999999999);", "Warning! (*definition == 0) line 1, column 8: a number above"},
        {"Pane() { Box();", "Warning! (*definition == 0) line 1, column 16: expected '}'"},
        {"align_centers(1, 2, &a, &b, &c); Box();", "Warning! (size() > 0) line 1, column 21: "},
        {"align_centers(1, &a); Box();", "Warning! (*definition == 0) line 1, column 18: "},
        {"step(1, 2); Box();", "Warning! (*definition == 0) line 1, column 10: "},
        {"Box(a: f(b: 2));", "Warning! (fGenerator) line 1, column 8: "},
        {"// no comments\nBox();", "Warning! (*definition == 0) line 1, column 1: "},
        {"Box(a: 1 + gNone) x",
         "line 1, column 19: expected ';' or '{' after a view's head; 'gNone' in line 1, column 12 is"},
    };
    for (const auto &c : cases)
        try
        {
            ParseLayout(c.text);
            ADD_FAILURE() << c.text;
        }
        catch (const CError &error)
        {
            EXPECT_THAT(error.GetErrorString(), testing::HasSubstr(c.message)) << c.text;
        }
    EXPECT_NO_THROW(ParseLayout(std::string_view("Box();\0 whatever follows", 23)));
}

/// Writes down every rule as "code'text'".
class noteRules final : public CWyraListener
{
public:
    explicit noteRules(std::string layoutText) : text(std::move(layoutText)) { ParseLayout(text, nullptr, this); }
    void Report(int ruleCode, std::size_t from, std::size_t to) override
    {
        ASSERT_TRUE(from <= to && to <= text.size());
        if (ruleCode != 47)
            rules += std::to_string(ruleCode) + "'" + text.substr(from, to - from) + "' ";
        else
            marks += text.substr(from, to - from);
    }

    std::string rules, marks;

private:
    std::string text;
};

TEST(WyraParser, ReportsEachFinishedRuleOnce)
{
    const noteRules simple(" a = 'x' ; A ( b : a ) ; ");
    EXPECT_EQ(simple.rules, "45'a' 12'a = 'x' ;' 45'A' 45'b' 45'a' 33'a' 52'( b : a )' 51'A ( b : a ) ;' "
                            "49'a = 'x' ; A ( b : a ) ;' 48'a = 'x' ; A ( b : a ) ;' ");
    EXPECT_EQ(simple.marks, "='';(:);");
    const noteRules rich("A(b: min(1, c) >= 2){ step(1, 2, &d); }");
    EXPECT_EQ(rich.rules,
              "45'A' 45'b' 45'min' 46'1' 32'1' 31'1' 19'1' 24'1' 45'c' 33'c' 31'c' 19'c' 24'c' 43'min(1, c)' "
              "38'min(1, c)' 31'min(1, c)' 21'>=' 46'2' 32'2' 31'2' 19'min(1, c) >= 2' 24'min(1, c) >= 2' "
              "52'(b: min(1, c) >= 2)' 45'step' 46'1' 32'1' 31'1' 19'1' 24'1' 46'2' 32'2' 31'2' 19'2' 24'2' "
              "45'd' 5'step(1, 2, &d)' 49'step(1, 2, &d);' 53'{ step(1, 2, &d); }' "
              "51'A(b: min(1, c) >= 2){ step(1, 2, &d); }' 49'A(b: min(1, c) >= 2){ step(1, 2, &d); }' "
              "48'A(b: min(1, c) >= 2){ step(1, 2, &d); }' ");
    EXPECT_EQ(rich.marks, "(:(,)){(,,&);}");
}

std::string repeated(const std::string &text, std::size_t bytes)
{
    std::string all;
    while (all.size() + text.size() <= bytes)
        all += text;
    return all;
}

/// Texts at the edge of what is allowed: each ends, accepted or not, in a time that a user would wait.
TEST(WyraParser, HostileTextsEndSoon)
{
    const std::size_t room = CWyraLimits::bytes - 100;
    std::string collisions;
    for (int i = 0; i < CWyraLimits::variables; ++i)
        collisions += "margin=" + std::to_string(i) + ";";
    const std::string texts[] = {
        repeated("A(){", room),
        repeated("A(){", 62 * 4) + repeated("}", 62),
        "A(){" + repeated("B(width:1,height:1);", room) + "}",
        "A(){" + repeated("B(width:1,height:1);", 3900 * 20) + "}",
        "A(){" + collisions + repeated("B();", 15'000) + "}",
        "A(){" + repeated("B();", 15'000) + collisions + repeated("C(a:margin+margin);", 1500) + "}",
        "A(a:" + repeated("x+", room) + "1);",
        "A(" + repeated("a:1,", room) + "a:1);",
        "a='" + repeated("x", room) + "';A(text:a);",
        repeated(" ", room) + "A();",
        repeated("step(1,1,&a,&b);", room) + "A();",
        "A(" + repeated("a", room) + ":" + repeated("b", 50) + ");",
        std::string(CWyraLimits::bytes + 1, ' '),
    };
    const layoutBench bench({"A", "B"});
    for (const std::string &text : texts)
    {
        const auto start = std::chrono::steady_clock::now();
        std::string error;
        try
        {
            bench.Build(text);
        }
        catch (const CLayoutError &e)
        {
            error = e.GetErrorString();
        }
        EXPECT_LT(error.size(), 400u);
        const std::chrono::duration<double> seconds = std::chrono::steady_clock::now() - start;
        EXPECT_LT(seconds.count(), 10.0) << text.substr(0, 40); // a thousandth of it is usual; sanitizers are slow
    }
}

} // namespace
} // namespace Sarnik
