#include "host/plugin/descriptorTable.h"

#include <cstring>
#include <string>

namespace Stillmark
{
namespace
{

/// A value of the type that is asked for; null where the key is missing or has another.
template <class Value> const Value *valueOf(const recordedAction &action, std::uint32_t key)
{
    const recordedAction::value *found = action.find(key);
    return found ? std::get_if<Value>(found) : nullptr;
}

/// Answers a get: raving overrides what is there, a null output is refused.
template <class Out, class Value> TNError give(hostLie lie, Out *out, Out nonsense, const Value *value)
{
    if (!out || (!value && !lie.raves()))
        return TNErrParameter;
    *out = lie.raves() ? nonsense : static_cast<Out>(*value);
    return TNNoError;
}

} // namespace

/// Work on a descriptor that lives: TNError work(descriptorTable &, recordedAction &, hostLie).
template <class Work>
TNError descriptorTable::on(void *context, TNDescriptor descriptor, const char *function, Work work)
{
    descriptorTable &all = *static_cast<descriptorTable *>(context);
    return all.state.code(function, [&]() -> TNError {
        const hostLie lie = all.state.lie(hostCall::descriptor, function);
        if (lie.fails())
            return lie.code;
        const auto place = all.open.find(descriptor);
        if (place == all.open.end())
        {
            all.state.misuse(std::string(function) + " of a descriptor that does not live");
            return TNErrParameter;
        }
        return work(all, *place->second, lie);
    });
}

/// A new descriptor of what made(descriptorTable &) gives; none where that is null.
template <class Made> TNError descriptorTable::make(void *context, TNDescriptor *out, const char *function, Made made)
{
    descriptorTable &all = *static_cast<descriptorTable *>(context);
    return all.state.code(function, [&]() -> TNError {
        const hostLie lie = all.state.lie(hostCall::descriptor, function);
        if (lie.fails() || !out)
            return lie.fails() ? lie.code : TNError{TNErrParameter};
        *out = nullptr;
        if (lie.raves())
            return TNNoError;
        std::unique_ptr<recordedAction> action = made(all);
        if (!action)
            return TNErrParameter;
        const TNDescriptor descriptor = reinterpret_cast<TNDescriptor>(action.get());
        all.open.emplace(descriptor, std::move(action));
        *out = descriptor;
        return TNNoError;
    });
}

descriptorTable::descriptorTable(runState &run, handleTable &hostMemory) : state(run), handles(hostMemory)
{
    table.context = this;
    table.create = [](void *context, TNDescriptor *out) {
        return make(context, out, "create", [](descriptorTable &) { return std::make_unique<recordedAction>(); });
    };
    table.fromHandle = [](void *context, TNHandle handle, TNDescriptor *out) {
        return make(context, out, "fromHandle", [&](descriptorTable &all) -> std::unique_ptr<recordedAction> {
            if (!all.handles.lives(handle))
                return nullptr;
            try
            {
                return std::make_unique<recordedAction>(recordedAction::fromBytes(all.handles.bytes(handle)));
            }
            catch (const recordedAction::formatError &) // bytes of the plug-in's own making
            {
                return nullptr;
            }
        });
    };
    table.toHandle = [](void *context, TNDescriptor descriptor, TNHandle *handle) {
        return on(context, descriptor, "toHandle", [&](descriptorTable &all, recordedAction &action, hostLie lie) {
            if (!handle)
                return TNErrParameter;
            *handle = lie.raves() ? nullptr : all.handles.create(action.bytes());
            return *handle || lie.raves() ? TNNoError : TNErrMemoryFull;
        });
    };
    table.free = [](void *context, TNDescriptor descriptor) {
        const TNError error =
            on(context, descriptor, "free", [](descriptorTable &, recordedAction &, hostLie) { return TNNoError; });
        static_cast<descriptorTable *>(context)->close(descriptor); // asked for, even where it is told to fail
        return error;
    };
    fillReaders();
    fillWriters();
}

void descriptorTable::close(TNDescriptor descriptor) noexcept
{
    state.code("free", [&] {
        open.erase(descriptor);
        return TNNoError;
    });
}

void descriptorTable::fillReaders()
{
    table.count = [](void *context, TNDescriptor descriptor, std::uint32_t *keys) {
        return on(context, descriptor, "count", [&](descriptorTable &, recordedAction &action, hostLie lie) {
            const std::size_t count = action.entries().size();
            return give(lie, keys, UINT32_MAX, &count);
        });
    };
    table.key = [](void *context, TNDescriptor descriptor, std::uint32_t index, std::uint32_t *key) {
        return on(context, descriptor, "key", [&](descriptorTable &, recordedAction &action, hostLie lie) {
            const auto &list = action.entries();
            return give(lie, key, TN_CODE('?', '?', '?', '?'), index < list.size() ? &list[index].key : nullptr);
        });
    };
    table.getInteger = [](void *context, TNDescriptor descriptor, std::uint32_t key, std::int32_t *value) {
        return on(context, descriptor, "getInteger", [&](descriptorTable &, recordedAction &action, hostLie lie) {
            return give(lie, value, INT32_MIN, valueOf<std::int32_t>(action, key));
        });
    };
    table.getBoolean = [](void *context, TNDescriptor descriptor, std::uint32_t key, std::uint8_t *value) {
        return on(context, descriptor, "getBoolean", [&](descriptorTable &, recordedAction &action, hostLie lie) {
            return give(lie, value, std::uint8_t{0xFF}, valueOf<bool>(action, key));
        });
    };
    table.getDataLength = [](void *context, TNDescriptor descriptor, std::uint32_t key, std::uint64_t *bytes) {
        return on(context, descriptor, "getDataLength", [&](descriptorTable &, recordedAction &action, hostLie lie) {
            const auto *data = valueOf<std::vector<std::uint8_t>>(action, key);
            const std::uint64_t size = data ? data->size() : 0;
            return give(lie, bytes, UINT64_MAX, data ? &size : nullptr);
        });
    };
    table.getData = [](void *context, TNDescriptor descriptor, std::uint32_t key, void *data) {
        return on(context, descriptor, "getData", [&](descriptorTable &, recordedAction &action, hostLie lie) {
            const auto *found = valueOf<std::vector<std::uint8_t>>(action, key);
            if (!found || (!data && !found->empty()))
                return TNErrParameter;
            if (lie.raves())
                std::memset(data, 0xA5, found->size());
            else if (!found->empty())
                std::memcpy(data, found->data(), found->size());
            return TNNoError;
        });
    };
}

void descriptorTable::fillWriters()
{
    table.putInteger = [](void *context, TNDescriptor descriptor, std::uint32_t key, std::int32_t value) {
        return on(context, descriptor, "putInteger", [&](descriptorTable &, recordedAction &action, hostLie lie) {
            if (!lie.raves())
                action.put(key, value);
            return TNNoError;
        });
    };
    table.putBoolean = [](void *context, TNDescriptor descriptor, std::uint32_t key, std::uint8_t value) {
        return on(context, descriptor, "putBoolean", [&](descriptorTable &, recordedAction &action, hostLie lie) {
            if (!lie.raves())
                action.put(key, value != 0);
            return TNNoError;
        });
    };
    table.putData = [](void *context, TNDescriptor descriptor, std::uint32_t key, std::uint64_t bytes,
                       const void *data) {
        return on(context, descriptor, "putData", [&](descriptorTable &, recordedAction &action, hostLie lie) {
            if (!data && bytes > 0)
                return TNErrParameter;
            if (bytes > recordedAction::mostBytes)
                return TNErrMemoryFull;
            const auto *first = static_cast<const std::uint8_t *>(data);
            if (!lie.raves())
                action.put(key, std::vector<std::uint8_t>(first, first + bytes));
            return TNNoError;
        });
    };
}

} // namespace Stillmark
