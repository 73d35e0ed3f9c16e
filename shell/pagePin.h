#pragma once

#include <cassert>
#include <cstddef>
#include <span>
#include <utility>

namespace Sarnik
{

class CVirtualHeap;
struct VirtualTile;

/// What a pin is for.
enum class CPageAccess
{
    read,     ///< the bytes stay as they are
    change,   ///< the bytes are kept when the page leaves memory
    overwrite ///< the same, and the holder writes every byte of it: what was there need not be read from disk
};

/// The only way to a page's bytes: while it lives they are in memory and stay where they are. Any number of pins of one
/// page may live at once; that nobody reads what another writes is the holders' business. The heap outlives its pins.
class CPagePin
{
public:
    CPagePin() = default;
    CPagePin(CPagePin &&other) noexcept { swap(other); }
    CPagePin &operator=(CPagePin &&other) noexcept
    {
        CPagePin(std::move(other)).swap(*this);
        return *this;
    }
    ~CPagePin() { Release(); }

    explicit operator bool() const { return heap != nullptr; }

    /// The page, of the size of its class; empty for an empty pin. Aligned to 64 bytes, or to whatever the installed
    /// allocator does.
    std::span<const std::byte> bytes() const { return {memory, size}; }
    std::span<std::byte> writableBytes() const
    {
        assert(access != CPageAccess::read);
        return {memory, size};
    }

    /// The same as samples of a plain type.
    template <typename T> std::span<const T> samples() const
    {
        return {reinterpret_cast<const T *>(memory), size / sizeof(T)};
    }
    template <typename T> std::span<T> writableSamples() const
    {
        assert(access != CPageAccess::read);
        return {reinterpret_cast<T *>(memory), size / sizeof(T)};
    }

    /// Unpins before the end; the pin is empty then.
    void Release() noexcept;

private:
    friend class CVirtualHeap;
    CPagePin(CVirtualHeap &owner, VirtualTile &page, CPageAccess wanted);

    void swap(CPagePin &other) noexcept
    {
        std::swap(heap, other.heap);
        std::swap(tile, other.tile);
        std::swap(memory, other.memory);
        std::swap(size, other.size);
        std::swap(access, other.access);
    }

    CVirtualHeap *heap = nullptr;
    VirtualTile *tile = nullptr;
    std::byte *memory = nullptr;
    std::size_t size = 0;
    CPageAccess access = CPageAccess::read;
};

} // namespace Sarnik
