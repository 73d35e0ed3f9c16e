#include "host/pfm.h"

#include "tests/host/hostFixture.h"

#include <cmath>
#include <cstring>
#include <gmock/gmock.h>
#include <limits>

namespace Stillmark
{
namespace
{

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::StartsWith;

class Pfm : public hostTest
{
};

TEST_F(Pfm, EveryFloatSurvivesARoundTripToTheBit)
{
    for (const int planes : {1, 3})
    {
        floatRaster raster{3, 2, planes, {}};
        for (int i = 0; i < 6 * planes; ++i)
            raster.samples.push_back(std::ldexp(static_cast<float>(i - 5) * 1.37f, i * 4 - 20));
        raster.samples[1] = -std::numeric_limits<float>::infinity();
        raster.samples[2] = std::nanf("7");
        raster.samples[3] = -0.0f;
        raster.samples[4] = std::numeric_limits<float>::denorm_min();
        writePfm(file("r.pfm"), raster);
        const floatRaster back = readPfm(file("r.pfm"));
        ASSERT_TRUE(back.width == 3 && back.height == 2 && back.planes == planes);
        ASSERT_EQ(back.samples.size(), raster.samples.size());
        EXPECT_EQ(std::memcmp(back.samples.data(), raster.samples.data(), raster.samples.size() * 4), 0);
    }
}

TEST_F(Pfm, RowsGoFromTheBottomAndTheScaleTellsTheByteOrder)
{
    const std::string big("\x3f\x80\0\0\x40\0\0\0", 8), little("\0\0\x80\x3f\0\0\0\x40", 8);
    for (const std::string &bytes : {"Pf\n1 2\n1.0\n" + big, "Pf\n1 2\n-1\n" + little, "Pf 1\t2\r-0.004 " + little,
                                     "Pf\n1 2\n255\n" + big + "trailing"})
    {
        writeBytes(file("r.pfm"), bytes);
        EXPECT_EQ(readPfm(file("r.pfm")).samples, (std::vector<float>{2, 1})) << bytes;
    }
    // A first sample whose first byte looks like white space belongs to the samples all the same.
    writeBytes(file("r.pfm"), "Pf\n1 1\n-1.0\n\n\n\n\n");
    const float expected = readPfm(file("r.pfm")).samples[0];
    EXPECT_EQ(std::memcmp(&expected, "\n\n\n\n", 4), 0);
}

TEST_F(Pfm, HostileHeadersAreRefusedBeforeMemoryIsTaken)
{
    const std::string data(400, '\0');
    const std::pair<std::string, std::string> cases[] = {
        {"Pf", "not a portable float map"},
        {"P6\n1 1\n255\n" + data, "not a portable float map"},
        {"Pf\n0 5\n-1\n" + data, "damaged"},
        {"Pf\n3 x\n-1\n" + data, "damaged"},
        {"Pf\n3 3\n0\n" + data, "damaged"},
        {"Pf\n3 3\nnan\n" + data, "damaged"},
        {"Pf\n99999999999 2\n-1\n" + data, "damaged"},
        {"Pf\n" + std::string(400, ' ') + "3 3\n-1\n" + data, "damaged"},
        {"Pf\n600000 1\n-1\n" + data, "too large"},
        {"PF\n400000 400000\n-1\n" + data, "cut short"},
        {"Pf\n10 11\n-1\n" + data, "cut short"},
    };
    for (const auto &[bytes, cause] : cases)
    {
        writeBytes(file("bad.pfm"), bytes);
        try
        {
            readPfm(file("bad.pfm"));
            ADD_FAILURE() << "taken: " << bytes.substr(0, 30);
        }
        catch (const Platform::fileError &error)
        {
            EXPECT_THAT(error.what(), AllOf(StartsWith(file("bad.pfm") + ": "), HasSubstr(cause)));
        }
    }
    EXPECT_THROW(readPfm(file("none.pfm")), Platform::fileError);
    EXPECT_THROW(readPfm(folder.path().string()), Platform::fileError);
}

} // namespace
} // namespace Stillmark
