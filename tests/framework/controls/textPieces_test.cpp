#include "framework/controls/fields/textPieces.h"

#include <gmock/gmock.h>

#include <random>

using namespace Sarnik;

namespace
{

const Platform::font font{.size = 12};

/// The beginning of the character that an offset is in, with its accent: one without a letter is drawn otherwise where
/// a layout begins.
std::size_t snapped(const std::string &text, std::size_t offset)
{
    while (offset < text.size() && ((text[offset] & 0xC0) == 0x80 || text[offset] == '\xCC'))
        --offset;
    return offset;
}

/// Everything that can be asked must be as if the text were laid out whole.
void expectWhole(const CTextPieces &pieces, const Platform::textOptions &options, std::mt19937 &random)
{
    const std::string &text = pieces.Text();
    const Platform::textBlock whole(text, font, options);
    ASSERT_NEAR(pieces.Height(), whole.height(), 0.01) << text;
    ASSERT_NEAR(pieces.Width(), whole.width(), 0.01);
    const CTextPieces::span all{0, 1e6};
    for (int i = 0; i < 20; ++i)
    {
        std::size_t from = snapped(text, random() % (text.size() + 1));
        std::size_t to = snapped(text, random() % (text.size() + 1));
        const Platform::rectangle wanted = whole.caret(from), caret = pieces.Caret(from);
        ASSERT_NEAR(caret.left, wanted.left, 0.01) << from << " of " << text;
        ASSERT_NEAR(caret.top, wanted.top, 0.01) << from << " of " << text;
        ASSERT_EQ(pieces.NextCharacter(from), whole.nextCharacter(from)) << from << " of " << text;
        ASSERT_EQ(pieces.PreviousCharacter(from), whole.previousCharacter(from)) << from << " of " << text;
        ASSERT_EQ(pieces.NextWord(from), whole.nextWord(from)) << from << " of " << text;
        ASSERT_EQ(pieces.PreviousWord(from), whole.previousWord(from)) << from << " of " << text;
        const Platform::point at{double(random() % 220), (random() % 1000) / 1000.0 * whole.height()};
        ASSERT_EQ(pieces.OffsetAt(at), whole.offsetAt(at)) << at.x << " " << at.y << " in " << text;

        const auto area = [](const std::vector<Platform::rectangle> &parts) {
            double sum = 0;
            for (const Platform::rectangle &r : parts)
                sum += r.width() * r.height() * (1 + r.top);
            return sum;
        };
        if (from > to)
            std::swap(from, to);
        ASSERT_NEAR(area(pieces.Covered(from, to, all)), area(whole.covered(from, to)), 1) << from << " " << to;
    }
}

TEST(TextPieces, AreTheWholeTextAfterAnyChange)
{
    const std::vector<std::string> alphabet{"a", "bee", " ", " ", "\n", ". ", "\xC3\xA4", "e\xCC\x81", "longer words "};
    std::mt19937 random(7);
    for (const auto &[lineEnds, align] : {std::pair{true, Platform::textAlign::left},
                                          {false, Platform::textAlign::left},
                                          {true, Platform::textAlign::right}})
    {
        const Platform::textOptions options{.width = 200, .lines = true, .align = align};
        CTextPieces pieces({.usual = 30, .most = 150, .patience = 1000});
        std::string text;
        for (int change = 0; change < 150; ++change)
        {
            const std::size_t from = snapped(text, random() % (text.size() + 1));
            std::size_t to = from;
            if (random() % 3 == 0 || text.size() > 1500)
                to = snapped(text, std::min(text.size(), from + random() % (random() % 10 == 0 ? 1500 : 8)));
            std::string added;
            for (std::size_t n = random() % 10 == 0 ? 200 : random() % 4; n > 0; --n)
                added += alphabet[random() % alphabet.size()];
            if (!lineEnds)
                std::replace(added.begin(), added.end(), '\n', ' ');
            text.replace(from, to - from, added);
            pieces.Set(text, font, options);
            ASSERT_EQ(pieces.Text(), text);
            ASSERT_NO_FATAL_FAILURE(expectWhole(pieces, options, random)) << "change " << change;
        }
    }
}

/// The work for a key does not grow with the text.
TEST(TextPieces, OnlyWhatStandsAroundAChangeIsLaidOut)
{
    std::string lines, paragraph, letters(30'000, 'a');
    for (int i = 0; lines.size() < 100'000; ++i)
    {
        lines += "fifty letters or so in every line of a long text, " + std::to_string(i) + "\n";
        paragraph += "words of all lengths, at " + std::to_string(i) + " and ";
    }
    const Platform::textOptions options{.width = 200, .lines = true};
    for (std::string *const text : {&lines, &paragraph, &letters})
    {
        CTextPieces pieces;
        pieces.Set(*text, font, options);
        const std::size_t first = pieces.BytesLaidOut();
        EXPECT_LE(first, 2.2 * text->size());
        const std::size_t most = text == &lines ? 3'000 : 20'000;
        std::mt19937 random(3);
        for (int i = 0; i < 40; ++i)
        {
            const std::size_t before = pieces.BytesLaidOut(), at = random() % text->size();
            i % 2 == 0 ? text->insert(at, "x") : text->erase(at, 1);
            pieces.Set(*text, font, options);
            EXPECT_GT(pieces.BytesLaidOut(), before);
            EXPECT_LE(pieces.BytesLaidOut() - before, most) << "change " << i << " at " << at;
            const Platform::rectangle caret = pieces.Caret(at);
            EXPECT_EQ(pieces.OffsetAt({caret.left, caret.top + 1}), at);
        }
        // All of it again, once, for another shape; nothing for the same.
        const std::size_t before = pieces.BytesLaidOut();
        pieces.Set(*text, font, {.width = 150, .lines = true});
        pieces.Set(*text, font, {.width = 150, .lines = true});
        EXPECT_NEAR(double(pieces.BytesLaidOut() - before), double(first), 0.1 * double(first));
    }
}

} // namespace
