#include "shell/plugin/descriptor.h"

#include <utility>

namespace Sarnik
{

bool CDescriptor::Open(TNHandle handle)
{
    Free();
    return suite.fromHandle(suite.context, handle, &descriptor) == TNNoError && descriptor != nullptr;
}

bool CDescriptor::Create()
{
    Free();
    return suite.create(suite.context, &descriptor) == TNNoError && descriptor != nullptr;
}

TNHandle CDescriptor::ToHandle()
{
    TNHandle handle = nullptr;
    return suite.toHandle(suite.context, descriptor, &handle) == TNNoError ? handle : nullptr;
}

void CDescriptor::Free() noexcept
{
    if (TNDescriptor old = std::exchange(descriptor, nullptr))
        suite.free(suite.context, old);
}

std::optional<std::vector<std::uint32_t>> CDescriptor::Keys()
{
    std::uint32_t count = 0;
    if (suite.count(suite.context, descriptor, &count) != TNNoError)
        return std::nullopt;
    std::vector<std::uint32_t> keys;
    for (std::uint32_t i = 0; i < count; ++i)
    {
        std::uint32_t key = 0;
        if (suite.key(suite.context, descriptor, i, &key) != TNNoError)
            return std::nullopt;
        keys.push_back(key);
    }
    return keys;
}

std::optional<std::int32_t> CDescriptor::Integer(std::uint32_t key)
{
    std::int32_t value = 0;
    if (suite.getInteger(suite.context, descriptor, key, &value) != TNNoError)
        return std::nullopt;
    return value;
}

std::optional<bool> CDescriptor::Boolean(std::uint32_t key)
{
    std::uint8_t value = 0;
    if (suite.getBoolean(suite.context, descriptor, key, &value) != TNNoError)
        return std::nullopt;
    return value == 1;
}

std::optional<std::vector<std::byte>> CDescriptor::Data(std::uint32_t key, std::uint64_t limit)
{
    std::uint64_t length = 0;
    if (suite.getDataLength(suite.context, descriptor, key, &length) != TNNoError || length > limit)
        return std::nullopt;
    std::vector<std::byte> bytes(static_cast<std::size_t>(length));
    if (length != 0 && suite.getData(suite.context, descriptor, key, bytes.data()) != TNNoError)
        return std::nullopt;
    return bytes;
}

bool CDescriptor::PutInteger(std::uint32_t key, std::int32_t value)
{
    return suite.putInteger(suite.context, descriptor, key, value) == TNNoError;
}

bool CDescriptor::PutBoolean(std::uint32_t key, bool value)
{
    return suite.putBoolean(suite.context, descriptor, key, value ? 1 : 0) == TNNoError;
}

bool CDescriptor::PutData(std::uint32_t key, std::span<const std::byte> bytes)
{
    return suite.putData(suite.context, descriptor, key, bytes.size(), bytes.data()) == TNNoError;
}

} // namespace Sarnik
