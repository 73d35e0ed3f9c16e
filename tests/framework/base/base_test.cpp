#include "framework/base/container.h"
#include "framework/base/exceptions.h"
#include "framework/base/localisedString.h"

#include <gtest/gtest.h>

#include <functional>

namespace Sarnik
{
namespace
{

TEST(LocalisedString, ShowsTheDefaultAndFillsPlaces)
{
    EXPECT_EQ(localised("$$$/A/B=Some = text"), "Some = text");
    EXPECT_EQ(localised("$$$/A/B"), "");
    EXPECT_EQ(localised("plain = text"), "plain = text");
    EXPECT_EQ(localised("$$$/K=^1 of ^0, ^0, ^2, ^", {"ten", "^0"}), "^0 of ten, ten, ^2, ^");
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
