#pragma once

#include "framework/base/container.h"
#include "store/files/collectionStream.h"
#include "store/files/fileHeader.h"
#include "store/files/traceFile.h"
#include "store/files/workspaceFile.h"
#include "tests/store/storeFixture.h"
#include "tests/store/traces/traceFixture.h"

#include <random>

namespace Project
{

struct fileEvents : testEvents
{
    bool AddLoadedTrace(const PKernel &, int at) override
    {
        offeredAt = at;
        return takesTraces;
    }
    void WorkspaceLoaded() override { ++workspaces; }
    std::uintptr_t UndoPosition() const override { return undoPosition; }
    bool MultiPreview() const override { return multiPreview; }

    bool takesTraces = false, multiPreview = false;
    int offeredAt = -2, workspaces = 0;
    std::uintptr_t undoPosition = 0;
};

/// A folder of its own, and a collection for a picture of the size of the sample files'.
class traceFileTest : public storeTest
{
protected:
    static std::string Sample(const std::string &name)
    {
        std::ifstream file(std::string(STILLMARK_TEST_DATA "/files/") + name, std::ios::binary);
        EXPECT_TRUE(file) << name;
        return {std::istreambuf_iterator<char>(file), {}};
    }
    /// Loads bytes by the loader of the extension.
    bool Loading(const std::string &bytes, const std::string &extension)
    {
        // Some file systems wait for the disk when a file is emptied and written anew.
        std::filesystem::remove(directory + "/file" + extension);
        Put("file" + extension, bytes);
        const std::string path = directory + "/file" + extension;
        if (extension == ".dbw")
            return LoadWorkspace(traces, path);
        return extension == ".knl" ? LoadTrace(traces, path, -1) : LoadPngTrace(traces, path, -1);
    }
    /// What SaveWorkspace writes, without waiting for a disk.
    static std::string WorkspaceBytes(const PKernelCollection &collection)
    {
        Sarnik::CMemoryContainer out;
        WriteHeader(collection, out);
        WriteCollection(collection, out);
        return {reinterpret_cast<const char *>(out.Content().data()), out.Size()};
    }
    const std::string &Error() const { return traces.GetLastError(); }

    /// Any kind of trace that fits the picture, with a kernel of side `size`.
    std::unique_ptr<PKernel> RandomTrace(std::mt19937 &random, int size)
    {
        const auto number = [&](int low, int high) { return std::uniform_int_distribution(low, high)(random); };
        PTraceRecord record;
        record.region = {number(0, 100), number(0, 100), number(100, 400), number(100, 300)};
        record.settings = {static_cast<std::uint32_t>(number(0, 3)),
                           number(3, 199),
                           static_cast<std::uint32_t>(number(0, 3)),
                           0.25f,
                           0.75f,
                           2.0f,
                           number(0, 1) == 1,
                           number(0, 1) == 1,
                           number(0, 1) == 1,
                           true,
                           0.125f,
                           static_cast<float>(number(0, 100)) / 100.0f,
                           static_cast<float>(number(0, 100)) / 100.0f,
                           static_cast<std::uint32_t>(number(0, 99)),
                           static_cast<std::uint32_t>(number(0, 3)),
                           number(0, 255),
                           number(-9, 9),
                           number(-9, 9)};
        if (size > 0)
            record.kernel = TestSupport::shakeKernel(size, size, random());
        record.lineStart = {static_cast<float>(number(0, 99)), 2.5f};
        record.lineEnd = {3.5f, static_cast<float>(number(0, 99))};
        switch (number(1, 3))
        {
        case 1:
            return std::make_unique<PEstimatedKernel>(traces, record);
        case 2:
            return std::make_unique<PManualKernel>(traces, record);
        default:
            return std::make_unique<PReadOnlyKernel>(traces, record);
        }
    }

    static constexpr const char *kUnrecognized = "Unrecognized file format.";
    static constexpr const char *kSomeLeftOut =
        "Some of the traces were not loaded because their estimation regions are out of image bounds.";

    testPicture picture{CorvaneDeblur::floatArray::allocate(300, 400), 0, 0};
    PParams params;
    fileEvents events;
    PKernelCollection traces{picture, params, events, ""};
};

} // namespace Project
