#include "host/plugin/handleTable.h"

#include "host/plugin/bufferTable.h"

#include <algorithm>
#include <cstring>
#include <new>
#include <string>

namespace Stillmark
{
namespace
{

handleTable &self(void *context)
{
    return *static_cast<handleTable *>(context);
}

} // namespace

handleTable::handleTable(runState &run) : state(run)
{
    table.context = this;
    table.create = [](void *context, std::uint64_t bytes) {
        handleTable &handles = self(context);
        return handles.state.value("create of a handle", TNHandle{}, [&]() -> TNHandle {
            const hostLie lie = handles.state.lie(hostCall::handle);
            if (lie.fails())
                return nullptr;
            const TNHandle made = handles.create(bytes);
            if (made && lie.raves())
                std::memset(made, 0xA5, bytes);
            return made;
        });
    };
    table.dispose = [](void *context, TNHandle handle) {
        handleTable &handles = self(context);
        handles.state.code("dispose of a handle", [&] {
            if (handle && handles.find(handle, "dispose of a handle"))
                handles.dispose(handle);
            return TNNoError;
        });
    };
    table.size = [](void *context, TNHandle handle) {
        handleTable &handles = self(context);
        return handles.state.value("size of a handle", std::uint64_t{0}, [&] {
            const block *found = handles.find(handle, "size of a handle");
            return found ? found->size : 0;
        });
    };
    table.lock = [](void *context, TNHandle handle) {
        handleTable &handles = self(context);
        return handles.state.value("lock of a handle", static_cast<void *>(nullptr), [&]() -> void * {
            block *found = handles.find(handle, "lock of a handle");
            if (!found)
                return nullptr;
            found->locks++;
            return found->data.get();
        });
    };
    table.unlock = [](void *context, TNHandle handle) {
        handleTable &handles = self(context);
        handles.state.code("unlock of a handle", [&] {
            block *found = handles.find(handle, "unlock of a handle");
            if (found && found->locks-- == 0)
            {
                found->locks = 0;
                handles.state.misuse("unlock of a handle that is not locked");
            }
            return TNNoError;
        });
    };
}

TNHandle handleTable::create(std::uint64_t bytes)
{
    if (bytes > mostHostMemory())
        return nullptr;
    block made;
    made.size = bytes;
    // One byte at least, so that each has an address of its own.
    made.data.reset(new (std::nothrow) std::uint8_t[std::max<std::uint64_t>(bytes, 1)]());
    if (!made.data)
        return nullptr;
    const TNHandle handle = reinterpret_cast<TNHandle>(made.data.get());
    blocks.emplace(handle, std::move(made));
    return handle;
}

TNHandle handleTable::create(std::span<const std::uint8_t> bytes)
{
    const TNHandle handle = create(bytes.size());
    if (handle && !bytes.empty())
        std::memcpy(handle, bytes.data(), bytes.size());
    return handle;
}

void handleTable::dispose(TNHandle handle)
{
    blocks.erase(handle);
}

std::span<const std::uint8_t> handleTable::bytes(TNHandle handle) const
{
    const block &found = blocks.at(handle);
    return {found.data.get(), static_cast<std::size_t>(found.size)};
}

std::uint64_t handleTable::totalBytes() const
{
    std::uint64_t total = 0;
    for (const auto &[handle, each] : blocks)
        total += each.size;
    return total;
}

handleTable::block *handleTable::find(TNHandle handle, const char *function)
{
    const auto place = blocks.find(handle);
    if (place != blocks.end())
        return &place->second;
    state.misuse(std::string(function) + (handle ? " that does not live" : " that is null"));
    return nullptr;
}

} // namespace Stillmark
