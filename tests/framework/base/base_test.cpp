#include "framework/base/container.h"
#include "framework/base/exceptions.h"
#include "framework/base/localisedString.h"
#include "framework/base/stringTable.h"

#include <gtest/gtest.h>

#include <functional>

namespace Sarnik
{
namespace
{

TEST(LocalisedString, ShowsTheDefaultAndFillsPlaces)
{
    EXPECT_EQ(Localize("$$$/A/B=Some = text"), "Some = text");
    EXPECT_EQ(Localize("$$$/A/B"), "");
    EXPECT_EQ(Localize("plain = text"), "plain = text");
    EXPECT_EQ(Localize("$$$/K=^1 of ^0, ^0, ^2, ^", {"ten", "^0"}), "^0 of ten, ten, ^2, ^");
}

TEST(LocalisedString, SequencesStandForCharacters)
{
    EXPECT_EQ(Localize("$$$/K=^[a^]^{b^}^N^n^t^^0^Q^V^P^p^o"), "\u201Ca\u201D\u2018b\u2019\r\n\n\t^0?|Altaltcontrol");
    EXPECT_EQ(Localize("$$$/K=^+20AC^+20ac^+d83D^+De00"), "\u20AC\u20AC\U0001F600");
    EXPECT_EQ(Localize("$$$/K=^+D83D ^+DE00 ^+20A ^z ^Z^"), "\uFFFD \uFFFD ^+20A ^z ^Z^") << "halves, and what is none";
    EXPECT_EQ(Localize("$$$Loose=^C"), "\u00A9");
    EXPECT_EQ(Localize("^C"), "^C") << "no key";
    EXPECT_EQ(Localize("$$$/K=^^0 ^0", {"^n"}), "^0 ^n");
    std::string text = Localize("$$$/K=^0 and ^1, ^0^");
    ReplaceParam(text, 0, "^1x");
    EXPECT_EQ(text, "^1x and ^1, ^1x^");
    CStringTable::Global().Set("$$$/K", "^B eigen ^0");
    EXPECT_EQ(Localize("$$$/K=own ^0", {"x"}), "\u2022 eigen x");
    CStringTable::Global().Clear();
    EXPECT_EQ(Localize("$$$/K=own ^0", {"x"}), "own x");
}

TEST(Exceptions, TellTheirOwnWords)
{
    const CError plain("$$$/X=Why.");
    EXPECT_EQ(plain.GetTaskString(), "");
    EXPECT_EQ(plain.GetErrorString(), "Why.");
    EXPECT_TRUE(plain.ShowAlert());
    EXPECT_FALSE(plain.Silent());
    const CAbort quiet(true);
    EXPECT_TRUE(quiet.Silent());
    EXPECT_EQ(quiet.GetErrorString(), "The operation has been canceled.");
    EXPECT_EQ(CTintorelError(-34).GetErrorString(), "The disk is full.");
    EXPECT_EQ(CTintorelError(-1).GetErrorString(), "An unknown host error has occurred.");
    EXPECT_EQ(CTintorelError(-34).GetTaskString(), "The operation could not be completed.");
}

CMemoryContainer written(bool swapped)
{
    CMemoryContainer c;
    c.SetSwapBytes(swapped);
    c.WriteU16(0x1234);
    c.WriteU32(0xDEADBEEF);
    c.WriteF32(-0.5f);
    c.WriteBool(true);
    c.WriteString("gr\xC3\xBCn");
    c.WriteString("");
    c.WriteI32(-2);
    c.Seek(0);
    return c;
}

TEST(Container, LaysBytesOutInBothOrdersAndReadsThemBack)
{
    for (const bool swapped : {false, true})
    {
        CMemoryContainer c = written(swapped);
        EXPECT_EQ(c.Content()[0], swapped ? std::byte{0x12} : std::byte{0x34});
        EXPECT_EQ(c.Content()[2], swapped ? std::byte{0xDE} : std::byte{0xEF});
        EXPECT_EQ(c.Size(), 2u + 4 + 4 + 1 + (4 + 4 + 5) + 4 + 4);
        EXPECT_EQ(c.ReadU16(), 0x1234);
        EXPECT_EQ(c.ReadU32(), 0xDEADBEEFu);
        EXPECT_EQ(c.ReadF32(), -0.5f);
        EXPECT_TRUE(c.ReadBool());
        const std::size_t string = c.Position();
        c.Seek(string + 4);
        EXPECT_EQ(c.ReadU32(), 4u); // characters, not bytes
        c.Seek(string);
        EXPECT_EQ(c.ReadString(), "gr\xC3\xBCn");
        EXPECT_EQ(c.ReadString(), "");
        EXPECT_EQ(c.ReadI32(), -2);
        EXPECT_EQ(c.Remaining(), 0u);
    }
}

TEST(Container, EveryReadPastTheEndThrowsAndStaysWhereItWas)
{
    const CMemoryContainer whole = written(false);
    const std::function<void(CContainer &)> reads[] = {
        [](CContainer &c) { c.ReadU16(); },    [](CContainer &c) { c.ReadU32(); },
        [](CContainer &c) { c.ReadF32(); },    [](CContainer &c) { c.ReadBool(); },
        [](CContainer &c) { c.ReadString(); }, [](CContainer &c) { c.ReadString(); },
        [](CContainer &c) { c.ReadI32(); }};
    for (std::size_t length = 0; length < whole.Size(); ++length)
    {
        CMemoryContainer cut(whole.Content().first(length));
        bool thrown = false;
        for (const auto &read : reads)
        {
            const std::size_t before = cut.Position();
            try
            {
                read(cut);
            }
            catch (const CError &error)
            {
                EXPECT_EQ(error.GetErrorString(), "The end of data was reached while reading from a container.");
                EXPECT_EQ(cut.Position(), before);
                thrown = true;
                break;
            }
        }
        EXPECT_TRUE(thrown) << length;
    }
    // A length that promises more than there is asks for no memory.
    CMemoryContainer huge;
    huge.WriteU32(0xFFFFFFFF);
    huge.WriteU32(1);
    huge.Seek(0);
    EXPECT_THROW(huge.ReadString(), CError);
    EXPECT_THROW(huge.Seek(9), CError);
}

} // namespace
} // namespace Sarnik
