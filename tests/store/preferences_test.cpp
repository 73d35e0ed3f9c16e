#include "store/preferences.h"

#include "framework/base/container.h"
#include "framework/base/exceptions.h"
#include "platform/error.h"
#include "platform/userFolder.h"
#include "store/preferencesFormat.h"
#include "tests/store/storeFixture.h"

#include <cstring>
#include <gmock/gmock.h>
#include <sys/stat.h>

namespace Project
{

namespace
{

enum class order
{
    little,
    big
};

/// Bytes put together by hand, in either byte order.
class bytesBuilder
{
public:
    explicit bytesBuilder(order o) : byteOrder(o) {}

    bytesBuilder &u32(std::uint32_t value) { return number(value, 4); }
    bytesBuilder &u16(std::uint32_t value) { return number(value, 2); }
    bytesBuilder &raw(const std::string &more)
    {
        bytes += more;
        return *this;
    }
    bytesBuilder &chunk(std::uint32_t type, std::uint32_t version, const std::string &payload)
    {
        u32(0x4465626C).u32(type).u32(0).u32(version).u32(static_cast<std::uint32_t>(payload.size()));
        return raw(payload);
    }
    bytesBuilder part() const { return bytesBuilder(byteOrder); }

    std::string bytes;

private:
    bytesBuilder &number(std::uint32_t value, int size)
    {
        for (int i = 0; i < size; ++i)
            bytes += static_cast<char>(value >> 8 * (byteOrder == order::little ? i : size - 1 - i));
        return *this;
    }

    order byteOrder;
};

constexpr std::uint32_t kFlags = 0x44466C67, kPlacement = 0x444C6F63, kParameters = 0x42536574;

std::string Boolean(bool value)
{
    return std::string(1, value ? '\1' : '\0');
}

std::string FlagsPayload(order o)
{
    return bytesBuilder(o).u32(0xC0FFEE01).bytes;
}

std::string PlacementPayload(order o)
{
    bytesBuilder b(o);
    b.u32(1).u32(60).u32(5).u32(6);
    for (std::uint32_t edge = 10; edge < 18; ++edge)
        b.u32(edge);
    return b.u32(0xFFFFFFFE).u32(300).u32(400).u32(0xFFFFFFFD).u16(7).u16(0x0809).bytes;
}

std::string ParametersPayload(order o, bool withFineResult = true)
{
    bytesBuilder b(o);
    b.raw(Boolean(false)).raw(Boolean(false)).u32(6).u32(5).raw("/b\xC3\xA4/c").u32(256).u32(0x11223344).u32(4);
    b.raw(Boolean(true));
    if (withFineResult)
        b.raw(Boolean(false));
    return b.raw(Boolean(false)).raw(Boolean(true)).bytes;
}

std::string File(order o, const std::string &chunks)
{
    bytesBuilder b(o);
    b.u32(0x53726E6B).u32(0x4465626C).u32(0).u32(0).u32(static_cast<std::uint32_t>(chunks.size() + 4));
    return b.raw(chunks).u32(0).bytes;
}

/// A file in which nothing has the value that it has in fresh preferences.
std::string FullFile(order o)
{
    return File(o, bytesBuilder(o)
                       .chunk(kFlags, 0, FlagsPayload(o))
                       .chunk(kPlacement, 0, PlacementPayload(o))
                       .chunk(kParameters, 1, ParametersPayload(o))
                       .bytes);
}

std::string Written(const PPreferences &preferences)
{
    Sarnik::CMemoryContainer out;
    WritePreferences(out, preferences);
    return {reinterpret_cast<const char *>(out.Content().data()), out.Content().size()};
}

const std::string kFresh = Written(PPreferences());

class preferencesTest : public storeTest
{
protected:
    std::unique_ptr<PPreferences> Loading(const std::string &bytes, ResetGesture gesture = ResetGesture::None) const
    {
        Put("Stillmark Prefs.tnp", bytes);
        return LoadPreferences(directory, gesture);
    }
};

TEST_F(preferencesTest, WritesTheDocumentedBytes)
{
    EXPECT_EQ(FullFile(order::little).substr(0, 28), std::string("knrSlbeD\0\0\0\0\0\0\0\0\xA8\0\0\0lbeDglFD", 28));
    const auto loaded = Loading(FullFile(order::little));
    SavePreferences(directory, *loaded);
    EXPECT_EQ(Get("Stillmark Prefs.tnp"), FullFile(order::little));

    bytesBuilder fresh(order::little), placement(order::little), parameters(order::little);
    placement.u32(1).u32(60).raw(std::string(40, '\0'));
    placement.u32(-100u).u32(-100u).u32(-50u).u32(-33u).u16(2).u16(2);
    parameters.raw("\1\1").u32(0).u32(512).u32(0xFFFF0000).u32(1).raw(Boolean(false)).raw("\1\1").raw(Boolean(false));
    EXPECT_EQ(kFresh, File(order::little, fresh.chunk(kFlags, 0, fresh.part().u32(1).bytes)
                                              .chunk(kPlacement, 0, placement.bytes)
                                              .chunk(kParameters, 1, parameters.bytes)
                                              .bytes));
}

TEST_F(preferencesTest, ReadsBothByteOrdersAlike)
{
    for (const order o : {order::little, order::big})
    {
        const auto p = Loading(FullFile(o));
        EXPECT_EQ(p->flags, 0xC0FFEE01u);
        EXPECT_EQ(p->frame, (PWindowPlacement{5, 6, {10, 11, 12, 13, 14, 15, 16, 17}, -2, 300, 400, -3, {7, 0x0809}}));
        EXPECT_EQ(p->parameters.version, 1u);
        EXPECT_EQ(p->parameters.lastFolder, "/b\xC3\xA4/c");
        EXPECT_EQ(p->parameters.tileSize, 256u);
        EXPECT_EQ(p->parameters.overflowColour, 0x11223344u);
        EXPECT_EQ(p->parameters.autoTraceCount, 4u);
        for (const bool flag : {p->parameters.showPreview, p->parameters.showRegions, p->parameters.fineResult,
                                p->parameters.accuratePreview})
            EXPECT_FALSE(flag);
        EXPECT_TRUE(p->parameters.advancedOpen);
        EXPECT_TRUE(p->parameters.previewWindowOpen);
    }
}

TEST_F(preferencesTest, VersionsOfChunksDecideWhatIsRead)
{
    for (const order o : {order::little, order::big})
    {
        const auto with = [o](std::uint32_t type, std::uint32_t version, const std::string &payload) {
            return File(o, bytesBuilder(o).chunk(type, version, payload).bytes);
        };
        const auto old = Loading(with(kParameters, 0, ParametersPayload(o, false)));
        EXPECT_TRUE(old->parameters.fineResult);
        EXPECT_FALSE(old->parameters.accuratePreview);
        EXPECT_TRUE(old->parameters.previewWindowOpen);
        EXPECT_EQ(old->parameters.version, 0u);
        EXPECT_EQ(Written(*old).substr(144, 4), std::string("\1\0\0\0", 4)); // it is saved as version 1

        const auto newer = Loading(with(kParameters, 0xFFFFFFFF, ParametersPayload(o)));
        EXPECT_FALSE(newer->parameters.fineResult);
        EXPECT_EQ(newer->parameters.autoTraceCount, 4u);

        EXPECT_EQ(Written(*Loading(with(kFlags, 1, FlagsPayload(o)))), kFresh);
        EXPECT_EQ(Written(*Loading(with(kPlacement, 1, PlacementPayload(o)))), kFresh);
    }
}

TEST_F(preferencesTest, PassesOverForeignChunksAndTrustsLengthsOnly)
{
    const order o = order::little;
    const std::string flags = bytesBuilder(o).chunk(kFlags, 0, FlagsPayload(o)).bytes;
    const std::string unknown = bytesBuilder(o).chunk(0x12345678, 9, std::string(77, 'u')).bytes;
    std::string foreign = bytesBuilder(o).chunk(kFlags, 0, "....").bytes;
    foreign[0] = 'X';
    EXPECT_EQ(Loading(File(o, unknown + foreign + flags))->flags, 0xC0FFEE01u);

    // A payload longer than what is read of it, and one shorter: the next chunk is where the length says.
    const std::string longer = bytesBuilder(o).chunk(kPlacement, 0, PlacementPayload(o) + "more").bytes;
    EXPECT_EQ(Loading(File(o, longer + flags))->flags, 0xC0FFEE01u);
    const std::string shorter = bytesBuilder(o).chunk(kFlags, 0, "").bytes;
    EXPECT_EQ(Loading(File(o, shorter + flags))->flags, 0xC0FFEE01u);
    EXPECT_EQ(Loading(File(o, flags) + "what follows the end")->flags, 0xC0FFEE01u);
}

TEST_F(preferencesTest, AnotherShapeOfPlacementIsPassedOver)
{
    const order o = order::big;
    PPreferences p;
    p.frame = {5, 6, {1, 2, 3, 4, 5, 6, 7, 8}, 9, 10, 11, 12, {13, 14}};
    const std::string payload = bytesBuilder(o).u32(2).u32(3).raw("abc").u32(0xA8CD).bytes;
    Sarnik::CMemoryContainer in(std::as_bytes(std::span(payload)));
    in.SetSwapBytes(true);
    ReadPlacement(in, p.frame);
    EXPECT_EQ(p.frame, (PWindowPlacement{5, 6, {}, -100, -100, 0, 0, {2, 2}}));
    EXPECT_EQ(in.ReadU32(), 0xA8CDu);
}

TEST_F(preferencesTest, WhatIsNoFileOfOursGivesFreshPreferences)
{
    EXPECT_EQ(Written(*LoadPreferences(directory, ResetGesture::None)), kFresh);
    EXPECT_EQ(Written(*LoadPreferences(directory + "/none", ResetGesture::None)), kFresh);
    EXPECT_EQ(Written(*Loading(FullFile(order::little), ResetGesture::Held)), kFresh);
    EXPECT_EQ(Written(*Loading(std::string(2 << 20, '\0'))), kFresh);

    // With a length of 4 the file would only hold its zero word.
    EXPECT_EQ(Written(*Loading(bytesBuilder(order::little)
                                   .u32(0x53726E6B)
                                   .u32(0x4465626C)
                                   .u32(0)
                                   .u32(0)
                                   .u32(4)
                                   .raw(FullFile(order::little).substr(20))
                                   .bytes)),
              kFresh);

    std::filesystem::remove(directory + "/Stillmark Prefs.tnp");
    ASSERT_EQ(::mkfifo((directory + "/Stillmark Prefs.tnp").c_str(), 0600), 0);
    EXPECT_EQ(Written(*LoadPreferences(directory, ResetGesture::None)), kFresh);
}

TEST_F(preferencesTest, CutShortAnywhereItGivesFreshPreferences)
{
    for (const order o : {order::little, order::big})
    {
        const std::string whole = FullFile(o);
        for (std::size_t length = 0; length < whole.size(); ++length)
            ASSERT_EQ(Written(*Loading(whole.substr(0, length))), kFresh) << length;
    }
}

TEST_F(preferencesTest, LengthsThatLeadNowhereEndTheLoad)
{
    // Each of these would go round for ever, or reserve gigabytes, if the numbers were believed.
    for (const order o : {order::little, order::big})
        for (const std::uint32_t length : {0xFFFFFFECu, 0xFFFFFFFFu, 0x7FFFFFFFu, 0xFFFFFFE8u})
        {
            std::string file = FullFile(o);
            file.replace(36, 4, bytesBuilder(o).u32(length).bytes); // of the first chunk
            EXPECT_EQ(Written(*Loading(file)), kFresh);

            const std::string name = bytesBuilder(o).raw("\1\1").u32(length).u32(1).raw("x").bytes;
            EXPECT_EQ(Written(*Loading(File(o, bytesBuilder(o).chunk(kParameters, 1, name).bytes))), kFresh);
            const std::string shape = bytesBuilder(o).u32(2).u32(length).bytes;
            EXPECT_EQ(Written(*Loading(File(o, bytesBuilder(o).chunk(kPlacement, 0, shape).bytes))), kFresh);
        }
}

TEST_F(preferencesTest, ASingleWrongBitDoesWhatItsPlaceSays)
{
    enum outcome
    {
        fresh,  ///< refused whole
        same,   ///< nobody looks at it
        skips,  ///< the chunk is passed over, the others are read
        loaded, ///< that value is another, the rest is read
        any     ///< a length: whatever it leads to
    };
    struct place
    {
        std::size_t begin, end;
        outcome expected;
    };
    // The file header, then three chunks: headers at 20, 44 and 132, payloads at 40, 64 and 152, the zero word at 184.
    const place places[] = {
        {0, 8, fresh},   {8, 12, same},    {12, 16, fresh},    {16, 20, same},    {20, 28, skips},   {28, 32, same},
        {32, 36, skips}, {36, 40, any},    {40, 44, loaded},   {44, 52, skips},   {52, 56, same},    {56, 60, skips},
        {60, 64, any},   {64, 68, loaded}, {68, 72, same},     {72, 132, loaded}, {132, 140, skips}, {140, 144, same},
        {144, 148, any}, {148, 152, any},  {152, 154, loaded}, {154, 158, any},   {158, 162, same},  {162, 180, loaded},
        {180, 184, any}, {184, 188, fresh}};
    const std::string whole = FullFile(order::little);
    ASSERT_EQ(whole.size(), 188u);
    std::size_t covered = 0;
    for (const place &p : places)
    {
        ASSERT_EQ(p.begin, covered);
        covered = p.end;
        for (std::size_t bit = 8 * p.begin; bit < 8 * p.end; ++bit)
        {
            std::string file = whole;
            file[bit / 8] = static_cast<char>(file[bit / 8] ^ (1 << bit % 8));
            const std::string got = Written(*Loading(file));
            switch (p.expected)
            {
            case fresh:
                EXPECT_EQ(got, kFresh) << bit;
                break;
            case same:
                EXPECT_EQ(got, whole) << bit;
                break;
            case skips:
            case loaded:
                EXPECT_TRUE(got != kFresh && got != whole) << bit;
                break;
            case any:
                break;
            }
            EXPECT_EQ(Written(*Loading(got)), got) << bit; // what is saved next loads as it was
        }
    }
    EXPECT_EQ(covered, whole.size());
}

TEST_F(preferencesTest, SavingReplacesTheFileWholeOrNotAtAll)
{
    Put("Stillmark Prefs.tnp", std::string(5000, 'x'));
    PPreferences p;
    p.parameters.lastFolder = std::string(9000, 'f'); // longer than a container's block
    SavePreferences(directory, p);
    EXPECT_EQ(Get("Stillmark Prefs.tnp"), Written(p));
    EXPECT_EQ(LoadPreferences(directory, ResetGesture::None)->parameters.lastFolder, p.parameters.lastFolder);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(directory), {}), 1); // nothing is left beside it

    EXPECT_THROW(SavePreferences(directory + "/none", p), Platform::fileError);
    std::filesystem::create_directories(directory + "/taken/Stillmark Prefs.tnp/inside");
    EXPECT_THROW(SavePreferences(directory + "/taken", p), Platform::fileError);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(directory + "/taken"), {}), 1);
}

TEST_F(preferencesTest, ParametersStandAloneAsInARecordedAction)
{
    PParams p;
    Sarnik::CMemoryContainer out;
    WriteParameters(out, p);
    EXPECT_EQ(out.Size(), 22u); // the empty folder is a zero word alone

    out.Seek(0);
    p.version = kParametersVersion;
    p.tileSize = 0;
    ReadParameters(out, p);
    EXPECT_EQ(p.tileSize, 512u);
    EXPECT_THROW(ReadParameters(out, p), Sarnik::CError);
}

TEST_F(preferencesTest, TheDirectoryIsMadeOnTheWay)
{
    const std::string made = PreferencesDirectory(directory + "/not/there yet");
    EXPECT_EQ(made, directory + "/not/there yet/Corvane/Corvane Tintorel 14/Corvane Tintorel 14 Settings");
    EXPECT_TRUE(std::filesystem::is_directory(made));
    EXPECT_EQ(PreferencesDirectory(directory + "/not/there yet"), made);
    Put("file", "");
    EXPECT_THROW(PreferencesDirectory(directory + "/file"), std::filesystem::filesystem_error);
}

/// Puts an environment variable back at the end.
class variableGuard
{
public:
    variableGuard(const char *variable, const char *value) : name(variable)
    {
        if (const char *was = std::getenv(variable))
            old = was, wasSet = true;
        value ? ::setenv(variable, value, 1) : ::unsetenv(variable);
    }
    ~variableGuard() { wasSet ? ::setenv(name, old.c_str(), 1) : ::unsetenv(name); }

private:
    const char *name;
    std::string old;
    bool wasSet = false;
};

TEST_F(preferencesTest, TheUsersFolderComesFromTheEnvironment)
{
    const variableGuard home("HOME", directory.c_str());
    {
        const variableGuard config("XDG_CONFIG_HOME", "relative");
        EXPECT_EQ(Platform::userDataFolder(), directory + "/.config");
    }
    const std::string elsewhere = directory + "/elsewhere";
    const variableGuard config("XDG_CONFIG_HOME", elsewhere.c_str());
    EXPECT_EQ(PreferencesDirectory().substr(0, elsewhere.size()), elsewhere);

    PPreferences p;
    p.flags = 77;
    SavePreferences(PreferencesDirectory(), p);
    EXPECT_EQ(LoadPreferences(ResetGesture::None)->flags, 77u);
    EXPECT_EQ(LoadPreferences(ResetGesture::Held)->flags, 1u);

    Put("file", "");
    const variableGuard broken("XDG_CONFIG_HOME", (directory + "/file").c_str());
    EXPECT_EQ(LoadPreferences(ResetGesture::None)->flags, 1u);
}

} // namespace

} // namespace Project
