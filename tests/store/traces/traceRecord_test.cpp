#include "framework/base/container.h"
#include "framework/base/exceptions.h"
#include "store/traces/traceRecord.h"
#include "tests/store/traces/traceFixture.h"
#include "tests/support/matchers.h"

#include <cmath>
#include <random>

namespace Project
{
namespace
{

using CorvaneDeblur::floatArray;
using Sarnik::CMemoryContainer;

class TraceRecord : public traceTest
{
protected:
    static CMemoryContainer Bytes(const PKernel &trace)
    {
        CMemoryContainer out;
        trace.Write(out);
        out.Seek(0);
        return out;
    }

    /// The fields of a record as an older version has them.
    void WriteOld(CMemoryContainer &out, int version, bool readOnly, PLinePoint end)
    {
        for (const int edge : {31, 2, 63, 4})
            out.WriteI32(edge);
        CMemoryContainer settings;
        WriteSettings(settings, Odd());
        const auto bytes = settings.Content();
        constexpr std::size_t toNoise = 43, toThreshold = 2, anchor = 8;
        out.WriteBytes(bytes.subspan(0, toNoise));
        if (version < 3)
            out.WriteU16(0xFFFF);
        out.WriteBytes(bytes.subspan(toNoise, toThreshold));
        if (version >= 2)
            out.WriteBytes(bytes.subspan(toNoise + toThreshold, anchor));
        if (version >= 3)
            out.WriteBytes(bytes.subspan(toNoise + toThreshold + anchor));
        out.WriteU32(1);
        out.WriteF32(0.5f);
        if (version > 1)
            out.WriteBool(readOnly);
        if (version > 3)
            for (const float number : {7.0f, 8.0f, end.x, end.y})
                out.WriteF32(number);
    }

    /// No field has its default or its neighbour's value.
    KernelSettings Odd() const
    {
        return {2, 77, 5, 0.25f, 0.75f, 2.0f, false, true, false, true, 0.125f, 0.8f, 0.9f, 30, 1, 17, -1234, 5678};
    }
};

TEST_F(TraceRecord, RoundTripsAndTruncations)
{
    PEstimatedKernel estimated(traces, {31, 2, 63, 40}, Settings(5)), empty(traces, {}, Settings(5));
    PManualKernel line(traces, {}, Settings(5));
    line.SetLine({100.25f, 50}, {111, 57.5f});
    estimated.Settings() = line.Settings() = Odd();
    estimated.SetKernel(TestSupport::noiseImage(9, 9, 4));
    const auto fixed = PReadOnlyKernel::Of(estimated);

    for (const PKernel *trace : {static_cast<PKernel *>(&estimated), static_cast<PKernel *>(&empty),
                                 static_cast<PKernel *>(&line), static_cast<PKernel *>(fixed.get())})
    {
        CMemoryContainer bytes = Bytes(*trace);
        const auto read = ReadTrace(traces, bytes);
        EXPECT_EQ(bytes.Remaining(), 0u);
        ASSERT_EQ(read->KernelType(), trace->KernelType());
        EXPECT_EQ(read->Settings(), read->PreviousSettings());
        EXPECT_EQ(read->CommittedRegion(), trace->Region());
        EXPECT_EQ(read->HasKernel(), trace->HasKernel());
        const CMemoryContainer again = Bytes(*read);
        EXPECT_TRUE(std::ranges::equal(again.Content(), bytes.Content()));

        for (std::size_t length = 0; length < bytes.Size(); length += length < 100 ? 1 : 13)
        {
            CMemoryContainer cut(bytes.Content().first(length));
            EXPECT_THROW(ReadTrace(traces, cut), Sarnik::CError) << length;
        }
    }
    EXPECT_EQ(Bytes(empty).Size(), 4 + 16 + 57 + 4u);
}

TEST_F(TraceRecord, OlderVersions)
{
    for (const int version : {0, 1, 2, 3, 4})
    {
        CMemoryContainer bytes;
        WriteOld(bytes, version, true, {7.0f, 9.0f});
        bytes.Seek(0);
        traces.SetVersion(static_cast<std::uint16_t>(version));
        const auto trace = ReadTrace(traces, bytes);
        EXPECT_EQ(bytes.Remaining(), 0u) << version;
        EXPECT_EQ(trace->KernelType(), version == 4  ? PKernelKind::Manual // the line tells more than the flag
                                       : version > 1 ? PKernelKind::ReadOnly
                                                     : PKernelKind::Estimated);
        KernelSettings expected = Odd();
        if (version < 2)
            expected.anchorX = expected.anchorY = 0;
        if (version < 3)
            expected.suppression = 0.3f;
        EXPECT_EQ(trace->Settings(), expected) << version;
        EXPECT_EQ(trace->Region(), (Sarnik::CRect{31, 2, 63, 4}));
        EXPECT_EQ(trace->KernelImage().at(0, 0), 0.5f);
    }
}

/// Bytes that nobody wrote end in an error or in a trace, and never ask for more memory than they fill.
TEST_F(TraceRecord, HostileRecords)
{
    PEstimatedKernel trace(traces, {31, 2, 63, 40}, Settings(5));
    trace.SetKernel(TestSupport::noiseImage(5, 5, 4));
    constexpr std::size_t kernelAt = 4 + 16 + 57, smoothingAt = 20 + 31;
    const auto with = [&](std::size_t place, std::uint32_t word) {
        CMemoryContainer bytes = Bytes(trace);
        bytes.Seek(place);
        bytes.WriteU32(word);
        bytes.Seek(0);
        return bytes;
    };
    for (const std::uint32_t side : {6u, 0x10000u, 0x80000000u, 0xFFFFFFFFu})
    {
        CMemoryContainer bytes = with(kernelAt, side);
        EXPECT_THROW(ReadTrace(traces, bytes), Sarnik::CError) << side;
    }
    CMemoryContainer notANumber = with(kernelAt + 8, 0x7FC00000u), unknown = with(0, 9), smooth = with(smoothingAt, 0);
    EXPECT_THROW(ReadTrace(traces, notANumber), Sarnik::CError);
    EXPECT_EQ(ReadTrace(traces, unknown), nullptr);
    EXPECT_EQ(unknown.Remaining(), 0u);
    EXPECT_EQ(ReadTrace(traces, smooth)->Settings().smoothing, 0.0f);
    for (const auto &[word, smoothing] : {std::pair{0x7FC00000u, 0.3f}, {0x41000000u, 1.0f}, {0xC1000000u, 0.0f}})
    {
        CMemoryContainer bytes = with(smoothingAt, word);
        EXPECT_EQ(ReadTrace(traces, bytes)->Settings().smoothing, smoothing);
    }

    std::mt19937 random(1);
    const CMemoryContainer good = Bytes(trace);
    for (int i = 0; i < 3000; ++i)
    {
        traces.SetVersion(static_cast<std::uint16_t>(random() % 8));
        std::vector<std::byte> bytes(good.Content().begin(), good.Content().end());
        for (unsigned n = random() % 6; n > 0; --n)
            bytes[random() % bytes.size()] = static_cast<std::byte>(random());
        bytes.resize(bytes.size() - random() % 9);
        CMemoryContainer in(bytes);
        try
        {
            const auto read = ReadTrace(traces, in);
            const floatArray kernel = read ? read->KernelImage() : floatArray();
            for (int y = 0; y < kernel.rows; ++y)
                for (int x = 0; x < kernel.cols; ++x)
                    ASSERT_TRUE(std::isfinite(kernel.at(y, x)));
        }
        catch (const Sarnik::CError &)
        {
        }
    }
}

} // namespace
} // namespace Project
