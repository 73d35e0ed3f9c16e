#include "host/plugin/bufferTable.h"

#include "platform/physicalMemory.h"

#include <algorithm>
#include <cstring>
#include <new>

namespace Stillmark
{
namespace
{

constexpr std::align_val_t cacheLine{64};

bufferTable &self(void *context)
{
    return *static_cast<bufferTable *>(context);
}

} // namespace

std::uint64_t mostHostMemory()
{
    static const std::uint64_t memory = Platform::physicalMemory();
    return memory > 0 ? memory : std::uint64_t{1} << 32;
}

bufferTable::bufferTable(runState &run, std::optional<std::uint64_t> limit)
    : state(run), most(limit.value_or(mostHostMemory()))
{
    table.context = this;
    table.allocate = [](void *context, std::uint64_t bytes) {
        bufferTable &all = self(context);
        return all.state.value("allocate of the buffer suite", static_cast<void *>(nullptr), [&]() -> void * {
            const hostLie lie = all.state.lie(hostCall::buffer);
            void *buffer = lie.fails() ? nullptr : all.allocate(bytes);
            if (buffer && lie.raves())
                std::memset(buffer, 0xA5, static_cast<std::size_t>(bytes));
            return buffer;
        });
    };
    table.dispose = [](void *context, void *buffer) {
        bufferTable &all = self(context);
        all.state.code("dispose of the buffer suite", [&] {
            all.dispose(buffer);
            return TNNoError;
        });
    };
    table.space = [](void *context) {
        bufferTable &all = self(context);
        return all.state.value("space of the buffer suite", std::uint64_t{0}, [&]() -> std::uint64_t {
            const hostLie lie = all.state.lie(hostCall::space);
            if (lie.fails())
                return 0;
            return lie.raves() ? UINT64_MAX : all.most - all.used;
        });
    };
}

bufferTable::~bufferTable()
{
    for (const auto &[buffer, bytes] : buffers)
        ::operator delete(buffer, cacheLine);
}

void *bufferTable::allocate(std::uint64_t bytes)
{
    if (bytes > most - used || bytes > mostHostMemory())
        return nullptr;
    void *buffer = ::operator new(static_cast<std::size_t>(std::max<std::uint64_t>(bytes, 1)), cacheLine, std::nothrow);
    if (!buffer)
        return nullptr;
    try
    {
        buffers.emplace(buffer, bytes);
    }
    catch (...)
    {
        ::operator delete(buffer, cacheLine);
        throw;
    }
    used += bytes;
    return buffer;
}

void bufferTable::dispose(void *buffer)
{
    if (!buffer)
        return;
    const auto place = buffers.find(buffer);
    if (place == buffers.end())
        return state.misuse("dispose of a buffer that does not live");
    used -= place->second;
    buffers.erase(place);
    ::operator delete(buffer, cacheLine);
}

} // namespace Stillmark
