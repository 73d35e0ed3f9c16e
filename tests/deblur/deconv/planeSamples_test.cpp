#include "deblur/deconv/planeSamples.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <cstring>
#include <limits>
#include <vector>

using namespace CorvaneDeblur;

namespace
{

/// Two planes of 3 rows at an odd address with an odd pitch: the second is read and written.
template <typename Sample> struct planarMemory
{
    static constexpr int rows = 3;
    static constexpr int depth = 8 * static_cast<int>(sizeof(Sample));

    explicit planarMemory(int columns)
        : cols(columns), pitch(columns * static_cast<std::ptrdiff_t>(sizeof(Sample)) + 3),
          bytes(static_cast<std::size_t>(1 + 2 * rows * pitch), std::byte{0x5A})
    {
    }

    std::byte *begin() { return bytes.data() + 1; }
    std::byte *at(int row, int col)
    {
        return begin() + (rows + row) * pitch + col * static_cast<std::ptrdiff_t>(sizeof(Sample));
    }
    void set(int row, int col, Sample s) { std::memcpy(at(row, col), &s, sizeof s); }
    Sample get(int row, int col)
    {
        Sample s;
        std::memcpy(&s, at(row, col), sizeof s);
        return s;
    }

    int cols;
    std::ptrdiff_t pitch;
    std::vector<std::byte> bytes;
};

template <typename Sample> class PlaneSamplesOf : public testing::Test
{
};
using sampleTypes = testing::Types<std::uint8_t, std::uint16_t>;
TYPED_TEST_SUITE(PlaneSamplesOf, sampleTypes);

TYPED_TEST(PlaneSamplesOf, EveryCodeSurvivesReadingAndWriting)
{
    const int codes = std::numeric_limits<TypeParam>::max() + 1;
    planarMemory<TypeParam> memory(codes), copy(codes);
    for (int y = 0; y < memory.rows; ++y)
        for (int c = 0; c < codes; ++c)
            memory.set(y, c, static_cast<TypeParam>(c));

    const floatArray plane = floatArray::allocate(memory.rows, codes);
    readPlane(memory.begin(), plane, 1, memory.pitch, memory.depth);
    EXPECT_EQ(plane.at(0, 0), 0.0f);
    EXPECT_EQ(plane.at(2, codes - 1), 1.0f);
    writePlane(plane, copy.begin(), 1, copy.pitch, copy.depth);
    // All bytes: neither the other plane nor the gaps between the rows may change.
    EXPECT_TRUE(memory.bytes == copy.bytes);
}

TEST(PlaneSamples, WritingClampsAndTruncates)
{
    constexpr float nan = std::numeric_limits<float>::quiet_NaN(), inf = std::numeric_limits<float>::infinity();
    const float values[] = {-0.2f, -inf, nan, 0.9999f / 255.0f, 0.99999f, 1.0f, 1.5f, inf, 0.5f};
    constexpr int count = 9;
    const floatArray plane = floatArray::allocate(3, count);
    for (int y = 0; y < 3; ++y)
        std::memcpy(plane.row(y), values, sizeof values);

    planarMemory<std::uint8_t> narrow(count);
    planarMemory<std::uint16_t> wide(count);
    planarMemory<float> real(count);
    writePlane(plane, narrow.begin(), 1, narrow.pitch, 8);
    writePlane(plane, wide.begin(), 1, wide.pitch, 16);
    writePlane(plane, real.begin(), 1, real.pitch, 32);
    const int expected8[] = {0, 0, 0, 0, 254, 255, 255, 255, 127};
    const int expected16[] = {0, 0, 0, 256, 65534, 65535, 65535, 65535, 32767};
    const float expected32[] = {0, 0, 0, values[3], values[4], 1, 1, 1, 0.5f};
    for (int i = 0; i < count; ++i)
    {
        EXPECT_EQ(narrow.get(2, i), expected8[i]) << values[i];
        EXPECT_EQ(wide.get(2, i), expected16[i]) << values[i];
        EXPECT_EQ(real.get(2, i), expected32[i]) << values[i];
    }
}

TEST(PlaneSamples, FloatsAreReadAsTheyAreAndSpoiltOnesAsZero)
{
    const float values[] = {-3.5f,
                            std::numeric_limits<float>::quiet_NaN(),
                            std::numeric_limits<float>::max(),
                            std::numeric_limits<float>::infinity(),
                            -std::numeric_limits<float>::infinity(),
                            1e-40f};
    planarMemory<float> memory(6);
    for (int i = 0; i < 6; ++i)
        memory.set(1, i, values[i]);
    const floatArray plane = floatArray::allocate(3, 6);
    readPlane(memory.begin(), plane, 1, memory.pitch, 32);
    for (int i = 0; i < 6; ++i)
        EXPECT_EQ(plane.at(1, i), std::isfinite(values[i]) ? values[i] : 0.0f) << i;

    plane.at(0, 0) = 7.0f;
    readPlane(memory.begin(), plane, 1, memory.pitch, 24);
    EXPECT_EQ(plane.at(0, 0), 7.0f) << "an unknown depth leaves the plane alone";
}

} // namespace
