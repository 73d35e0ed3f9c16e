#include "framework/controls/fields/numberFormat.h"
#include "framework/controls/fields/textEditor.h"

#include <gmock/gmock.h>

#include <cmath>
#include <random>

using namespace Sarnik;
using change = CTextEditor::change;

namespace
{

/// The same by characters instead of bytes, and a copy of everything for each step back.
struct plainEditor
{
    struct state
    {
        std::vector<std::string> characters;
        std::size_t anchor = 0, caret = 0;
    };
    state now;
    std::vector<std::pair<state, state>> steps; ///< before and after each
    std::size_t done = 0, most = 0;

    std::size_t Bytes(std::size_t place) const
    {
        std::size_t bytes = 0;
        for (std::size_t i = 0; i < place; ++i)
            bytes += now.characters[i].size();
        return bytes;
    }
    std::string Text() const
    {
        std::string text;
        for (const std::string &c : now.characters)
            text += c;
        return text;
    }
    void Replace(std::size_t from, std::size_t to, std::vector<std::string> with)
    {
        const std::size_t room = most - std::min(most, now.characters.size() - (to - from));
        with.resize(std::min(with.size(), room));
        if (from == to && with.empty())
            return;
        const state before = now;
        const auto at = [&](std::size_t i) { return now.characters.begin() + static_cast<std::ptrdiff_t>(i); };
        now.characters.erase(at(from), at(to));
        now.characters.insert(at(from), with.begin(), with.end());
        now.anchor = now.caret = from + with.size();
        steps.resize(done++);
        steps.emplace_back(before, now);
    }
};

TEST(TextEditor, DoesWhatAPlainOneDoes)
{
    const std::vector<std::string> alphabet{"a", "b", " ", "\xC3\xA4", "\xE2\x82\xAC", "\xF0\x9F\x99\x82", "\n", "."};
    std::mt19937 random(5);
    const auto upTo = [&](std::size_t n) { return static_cast<std::size_t>(random() % (n + 1)); };
    for (int round = 0; round < 60; ++round)
    {
        CTextEditor editor;
        plainEditor plain;
        plain.most = 3 + upTo(30);
        editor.SetRules(true, plain.most);
        for (int step = 0; step < 120; ++step)
        {
            const std::size_t size = plain.now.characters.size();
            const std::size_t a = upTo(size), b = upTo(size), from = std::min(a, b), to = std::max(a, b);
            switch (upTo(5))
            {
            case 0:
                plain.now.anchor = a;
                plain.now.caret = b;
                editor.Select(plain.Bytes(a), plain.Bytes(b));
                break;
            case 1:
            case 2:
            {
                std::vector<std::string> with(upTo(4));
                std::string text;
                for (std::string &c : with)
                    text += c = alphabet[upTo(alphabet.size() - 1)];
                plain.Replace(std::min(plain.now.anchor, plain.now.caret), std::max(plain.now.anchor, plain.now.caret),
                              with);
                editor.Insert(text);
                break;
            }
            case 3:
                editor.Erase(plain.Bytes(from), plain.Bytes(to), change::whole);
                plain.Replace(from, to, {});
                break;
            case 4:
                ASSERT_EQ(editor.Undo(), plain.done > 0);
                if (plain.done > 0)
                    plain.now = plain.steps[--plain.done].first;
                break;
            default:
                ASSERT_EQ(editor.Redo(), plain.done < plain.steps.size());
                if (plain.done < plain.steps.size())
                    plain.now = plain.steps[plain.done++].second;
            }
            ASSERT_EQ(editor.Text(), plain.Text());
            ASSERT_EQ(editor.Anchor(), plain.Bytes(plain.now.anchor));
            ASSERT_EQ(editor.Caret(), plain.Bytes(plain.now.caret));
        }
    }
}

TEST(TextEditor, UndoesTypingByWordsAndErasuresTogether)
{
    CTextEditor editor;
    const auto type = [&](std::string_view text) {
        for (const char c : text)
            editor.Insert(std::string_view(&c, 1), change::typed);
    };
    type("one two");
    for (int i = 0; i < 4; ++i)
        editor.Erase(editor.Caret() - 1, editor.Caret());
    type("x");
    editor.Select(0, 0);
    type("yz");
    const auto back = [&] { return editor.Undo() ? editor.Text() : "-"; };
    EXPECT_EQ(editor.Text(), "yzonex");
    EXPECT_EQ(back(), "onex");
    EXPECT_EQ(back(), "one");
    EXPECT_EQ(back(), "one two");
    EXPECT_EQ(back(), "one ");
    EXPECT_EQ(back(), "");
    EXPECT_EQ(back(), "-");
    while (editor.Redo())
        ;
    EXPECT_EQ(editor.Text(), "yzonex");
}

TEST(TextEditor, CleansWhatComesInAndKeepsToItsLimits)
{
    CTextEditor editor;
    editor.SetText(std::string_view("a\r\nb\rc\xE2\x80\xA8"
                                    "d\te\x01\x7F\0f\xFFg",
                                    18));
    EXPECT_EQ(editor.Text(), "a b c d e\xEF\xBF\xBD"
                             "f\xEF\xBF\xBDg");
    editor.SetRules(true, 0);
    EXPECT_EQ(editor.Cleaned("a\r\nb\rc\td"), "a\nb\nc\td");
    // Cut between characters, whatever they are.
    std::string euros;
    for (int i = 0; i < 100'000; ++i)
        euros += "\xE2\x82\xAC";
    editor.SetText("");
    editor.Insert(euros);
    EXPECT_EQ(editor.Text().size(), CTextEditor::mostBytes / 3 * 3);
    editor.Select(1, 5);
    EXPECT_EQ(editor.From(), 0u) << "within a character";
    EXPECT_EQ(editor.To(), 3u);
    // Steps do not pile up without end.
    for (int i = 0; i < 12; ++i)
    {
        editor.SelectAll();
        editor.Insert(euros);
    }
    int steps = 0;
    for (; editor.Undo(); ++steps)
        ;
    EXPECT_LT(steps, 10);
    EXPECT_GT(steps, 1);
}

TEST(NumberFormat, WritesAndReads)
{
    const auto text = [](std::uint32_t bits, std::int32_t decimals, double v, std::int32_t digits = 0) {
        return CNumberFormat{bits, decimals, digits}.Text(v);
    };
    EXPECT_EQ(text(kNumber_Integer, 1, 12.5), "13");
    EXPECT_EQ(text(kNumber_Integer, 1, -0.4), "0");
    EXPECT_EQ(text(kNumber_Decimal, 1, 45), "45");
    EXPECT_EQ(text(kNumber_Decimal, 2, 100.5), "100.5");
    EXPECT_EQ(text(kNumber_FixedDecimal, 2, 0.999), "1.00");
    EXPECT_EQ(text(kNumber_PadInteger, 0, -7, 3), "-007");
    EXPECT_EQ(text(kNumber_ShowPlus | kNumber_FixedDecimal | kNumber_PadInteger, 1, 2.25, 2), "+02.3");
    EXPECT_EQ(text(kNumber_ShowPlus, 1, 0), "0");
    EXPECT_EQ(text(kNumber_Decimal, 1, std::nan("")), "0");
    EXPECT_EQ(text(kNumber_Integer, 1, HUGE_VAL), "1000000000000000");

    using testing::Optional;
    EXPECT_THAT(CNumberFormat::Parse(" +1,5 "), Optional(1.5));
    EXPECT_THAT(CNumberFormat::Parse("\xE2\x88\x92.5"), Optional(-0.5));
    EXPECT_THAT(CNumberFormat::Parse("5."), Optional(5.0));
    EXPECT_THAT(CNumberFormat::Parse(std::string(400, '9')), Optional(CNumberFormat::largest));
    for (const char *const none : {"", ".", "-", "--1", "1-", "1,000.5", "0x10", "1e3", "inf", "nan", "1 2"})
        EXPECT_EQ(CNumberFormat::Parse(none), std::nullopt) << none;
    EXPECT_EQ(CNumberFormat::Filtered("x = -12.5 %"), "  -12.5 ");

    std::mt19937_64 random(3);
    for (int i = 0; i < 5000; ++i)
    {
        const CNumberFormat format{static_cast<std::uint32_t>(random() % 16), static_cast<std::int32_t>(random() % 7),
                                   static_cast<std::int32_t>(random() % 6)};
        const double range = std::pow(10, double(random() % 9));
        const double value = std::uniform_real_distribution(-range, range)(random), shown = format.Rounded(value);
        ASSERT_THAT(CNumberFormat::Parse(format.Text(value)), Optional(testing::DoubleNear(shown, 1e-9 * range)));
        ASSERT_LE(std::abs(shown - value), format.Quantum() * 0.5000001);
    }
}

TEST(NumberFormat, RangesWrapAndCut)
{
    const CNumberRange circle{0, 360};
    EXPECT_EQ(circle.Wrapped(360), 360) << "an end stands for itself";
    EXPECT_EQ(circle.Wrapped(361), 1);
    EXPECT_EQ(circle.Wrapped(-0.5), 359.5);
    EXPECT_EQ(circle.Wrapped(-725), 355);
    EXPECT_EQ((CNumberRange{5, 5}.Wrapped(9)), 5);
    EXPECT_EQ(circle.Cut(std::nan("")), 0);
}

} // namespace
