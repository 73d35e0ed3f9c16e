#include "platform/canvas/canvas.h"
#include "platform/utf8.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <random>

using namespace Platform;

namespace
{

TEST(text, MeasuresFollowTheLawsOfLayout)
{
    const textBlock word("Smoothing"), twice("SmoothingSmoothing"), bold("Smoothing", {.bold = true});
    EXPECT_NEAR(twice.width(), 2 * word.width(), 1.5);
    EXPECT_GT(bold.width(), word.width());
    EXPECT_GT(word.baseline(), 0);
    EXPECT_LT(word.baseline(), word.height());
    const textBlock large("Smoothing", {.size = 24});
    EXPECT_NEAR(large.width(), 2 * word.width(), 0.5);
    EXPECT_NEAR(large.height(), 2 * word.height(), 0.5);
    EXPECT_EQ(textBlock("").width(), 0);
    EXPECT_NEAR(textBlock("").height(), word.height(), 0.1) << "an empty field is as high as a line";

    const std::string sentence = "Place mouse over control for help, and read what it does.";
    for (const double width : {60.0, 100.0, 200.0})
    {
        const textBlock wrapped(sentence, {}, {.width = width, .lines = true});
        EXPECT_LE(wrapped.width(), width);
        EXPECT_GT(wrapped.lineCount(), 1);
        EXPECT_NEAR(wrapped.height(), wrapped.lineCount() * word.height(), 1);
        for (const textTrim trim : {textTrim::start, textTrim::middle, textTrim::end})
        {
            const textBlock cut(sentence, {}, {.width = width, .trim = trim});
            EXPECT_LE(cut.width(), width);
            EXPECT_EQ(cut.lineCount(), 1);
        }
    }
    EXPECT_EQ(textBlock("a\nb\nc", {}, {.lines = true}).lineCount(), 3);
    EXPECT_EQ(textBlock("a\nb\nc").lineCount(), 1);
    EXPECT_NEAR(textBlock("ab", {}, {.width = 100, .align = textAlign::right}).caret(2).right, 100, 0.5);
}

TEST(text, IsDrawnWhereItWasMeasuredAtEveryScale)
{
    const textBlock text("Hamburg", {.size = 14});
    for (const double scale : {1.0, 1.25, 2.0})
    {
        raster picture(static_cast<int>(140 * scale), static_cast<int>(60 * scale));
        canvas draw(picture, scale);
        draw.drawText(text, {20, 15}, {255, 255, 255});
        double ink = 0;
        for (int y = 0; y < picture.height(); ++y)
            for (int x = 0; x < picture.width(); ++x)
            {
                const double a = (picture.row(y)[x] >> 24) / 255.0;
                ink += a / (scale * scale);
                if (a > 0)
                {
                    ASSERT_GE(x + 2, 20 * scale);
                    ASSERT_LE(x - 2, (20 + text.width()) * scale);
                    ASSERT_GE(y + 1, 15 * scale);
                    ASSERT_LE(y - 1, (15 + text.height()) * scale);
                }
            }
        EXPECT_GT(ink, 50);
        EXPECT_LT(ink, text.width() * text.height() / 2);
    }
}

TEST(text, CaretsGoThroughEveryCharacterOnce)
{
    // Latin, a letter with a separate accent, a surrogate pair elsewhere, right-to-left words.
    const std::string mixed = "a\xC3\xA4 e\xCC\x81 \xF0\x9F\x98\x80 \xD7\xA9\xD7\x9C x";
    const textBlock text(mixed);
    std::vector<std::size_t> forth{0}, back{text.text().size()};
    while (forth.back() < text.text().size())
    {
        const std::size_t next = text.nextCharacter(forth.back());
        ASSERT_GT(next, forth.back());
        forth.push_back(next);
    }
    while (back.back() > 0)
    {
        const std::size_t next = text.previousCharacter(back.back());
        ASSERT_LT(next, back.back());
        back.push_back(next);
    }
    EXPECT_EQ(forth, std::vector<std::size_t>(back.rbegin(), back.rend()));
    EXPECT_EQ(std::count(forth.begin(), forth.end(), 5u), 0) << "between a letter and its accent is no place";

    const textBlock plain("plain letters");
    for (std::size_t i = 0; i <= 13; ++i)
    {
        const rectangle at = plain.caret(i);
        EXPECT_EQ(plain.offsetAt({at.left + 0.01, 3}), i);
        double covered = 0;
        for (const rectangle &r : plain.covered(i, 13))
            covered += r.width();
        EXPECT_NEAR(covered, plain.width() - at.left, 0.1);
    }
    EXPECT_EQ(plain.nextWord(0), 6u);
    EXPECT_EQ(plain.nextWord(6), 13u);
    EXPECT_EQ(plain.previousWord(13), 6u);
    EXPECT_EQ(plain.offsetAt({1e9, -1e9}), 13u);
    EXPECT_EQ(plain.caret(999), plain.caret(13));
}

TEST(utf8, AnyBytesBecomeCharacters)
{
    EXPECT_EQ(cleanText("ok \xC3\xA9"), "ok \xC3\xA9");
    EXPECT_EQ(cleanText(std::string_view("a\0b", 3)), "a\xEF\xBF\xBD"
                                                      "b");
    EXPECT_EQ(cleanText("\xC0\x80"), "\xEF\xBF\xBD\xEF\xBF\xBD");
    EXPECT_EQ(cleanText("\xED\xA0\x80").size(), 9u) << "half a surrogate pair is no character";
    EXPECT_EQ(cleanText("\xE2\x82"), "\xEF\xBF\xBD\xEF\xBF\xBD") << "cut short";

    for (const char32_t c : {U'a', U'\u00E9', U'\u20AC', U'\U0001F600', U'\U0010FFFF'})
        EXPECT_EQ(codePoints(utf8Of(c) + "x"), (std::u32string{c, U'x'}));
    EXPECT_EQ(codePoints(utf8Of(0xD800)), U"\uFFFD");
}

TEST(text, ABrokenFontSetupCostsTheLettersOnly)
{
    testing::FLAGS_gtest_death_test_style = "threadsafe";
    const auto draw = [](const char *fonts) {
        std::ofstream(fonts) << "<fontconfig/>";
        setenv("FONTCONFIG_FILE", fonts, 1);
        setenv("FONTCONFIG_PATH", "/nonexistent", 1);
        const textBlock line("Some letters");
        raster picture(120, 50);
        canvas(picture).drawText(line, {1, 1}, {255, 255, 255});
        const std::uint32_t *const row = picture.row(8);
        const bool drawn = std::any_of(row, row + picture.width(), [](std::uint32_t p) { return p != 0; });
        const double em = font{}.size;
        return drawn && line.width() > 4 * em && line.width() < 12 * em && line.height() > em &&
                       line.height() < 2 * em && line.baseline() < line.height() && line.caret(4).height() > em &&
                       line.offsetAt({3, 3}) == 0
                   ? 0
                   : 1;
    };
    const std::string fonts = testing::TempDir() + "stillmark_no_fonts.conf";
    EXPECT_EXIT(std::exit(draw(fonts.c_str())), testing::ExitedWithCode(0), "");
    EXPECT_EXIT(std::exit(draw("/nonexistent/fonts.conf")), testing::ExitedWithCode(0), "");
    std::filesystem::remove(fonts);
}

TEST(text, AnyBytesAndAnyLengthAreLaidOut)
{
    std::mt19937 random(3);
    for (int i = 0; i < 200; ++i)
    {
        std::string noise(random() % 40, ' ');
        for (char &c : noise)
            c = static_cast<char>(random());
        const textBlock text(noise, {}, {.width = double(random() % 80), .lines = i % 2 == 0, .underlined = i % 7});
        text.covered(random() % 50, random() % 50);
        EXPECT_LE(text.offsetAt({double(random() % 100), 5}), text.text().size());
        EXPECT_GE(text.width(), 0);
    }

    const auto began = std::chrono::steady_clock::now();
    const textBlock paste(std::string(100'000, 'W'));
    EXPECT_EQ(paste.text().size(), 100'000u);
    EXPECT_GT(paste.width(), 100'000 * 6.0);
    EXPECT_NEAR(paste.caret(100'000).left, paste.width(), 1);
    EXPECT_GT(textBlock(std::string(3'000'000, 'W'), {.size = 50}).width(), 0);
    EXPECT_LT(std::chrono::steady_clock::now() - began, std::chrono::seconds(20)) << "no hang";
}

} // namespace
