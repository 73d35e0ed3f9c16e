#pragma once

#include "shell/tintorel.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

namespace Sarnik
{

/// One of the host's descriptors: typed values by key, freed with the object. Every answer tells whether the host did
/// as asked. Main thread; the suite outlives it.
class CDescriptor
{
public:
    explicit CDescriptor(const TNDescriptorSuite &table) : suite(table) {}
    CDescriptor(const CDescriptor &) = delete;
    CDescriptor &operator=(const CDescriptor &) = delete;
    ~CDescriptor() { Free(); }

    bool Open(TNHandle handle);
    bool Create();
    /// The recorded form; null where the host fails. The caller's.
    TNHandle ToHandle();
    void Free() noexcept;

    /// In the host's order; none where the host fails.
    std::optional<std::vector<std::uint32_t>> Keys();
    std::optional<std::int32_t> Integer(std::uint32_t key);
    std::optional<bool> Boolean(std::uint32_t key);
    /// None, too, for more bytes than `limit`.
    std::optional<std::vector<std::byte>> Data(std::uint32_t key, std::uint64_t limit);

    bool PutInteger(std::uint32_t key, std::int32_t value);
    bool PutBoolean(std::uint32_t key, bool value);
    bool PutData(std::uint32_t key, std::span<const std::byte> bytes);

private:
    const TNDescriptorSuite &suite;
    TNDescriptor descriptor = nullptr;
};

} // namespace Sarnik
