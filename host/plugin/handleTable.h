#pragma once

#include "host/plugin/runState.h"
#include "shell/tintorel.h"

#include <cstdint>
#include <map>
#include <memory>
#include <span>

namespace Stillmark
{

/// The host memory of one run, by handle. A handle that does not live is refused and noted.
class handleTable
{
public:
    explicit handleTable(runState &run);
    handleTable(const handleTable &) = delete;
    handleTable &operator=(const handleTable &) = delete;

    const TNHandleProcs *procs() const { return &table; }

    /// The host's own use, beside the scripted faults. Null where there is no memory.
    TNHandle create(std::uint64_t bytes);
    TNHandle create(std::span<const std::uint8_t> bytes);
    void dispose(TNHandle handle);
    bool lives(TNHandle handle) const { return blocks.count(handle) != 0; }
    /// Of a handle that lives.
    std::span<const std::uint8_t> bytes(TNHandle handle) const;

    std::uint64_t count() const { return blocks.size(); }
    std::uint64_t totalBytes() const;

private:
    struct block
    {
        std::unique_ptr<std::uint8_t[]> data; ///< its address is the handle
        std::uint64_t size = 0;
        int locks = 0;
    };
    block *find(TNHandle handle, const char *function); ///< noted where it is null

    runState &state;
    TNHandleProcs table;
    std::map<TNHandle, block> blocks;
};

} // namespace Stillmark
