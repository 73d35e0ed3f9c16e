#pragma once

#include "host/plugin/runState.h"
#include "shell/tintorel.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <unordered_map>

namespace Stillmark
{

/// Bytes that a single request can have at most: the machine's memory.
std::uint64_t mostHostMemory();

/// The buffer suite of one run. Buffers begin on a cache line.
class bufferTable
{
public:
    /// limit: bytes that all buffers together may take.
    bufferTable(runState &run, std::optional<std::uint64_t> limit);
    bufferTable(const bufferTable &) = delete;
    bufferTable &operator=(const bufferTable &) = delete;
    ~bufferTable();

    const TNBufferSuite *suite() const { return &table; }

    std::uint64_t count() const { return buffers.size(); }
    std::uint64_t totalBytes() const { return used; }

private:
    void *allocate(std::uint64_t bytes);
    void dispose(void *buffer);

    runState &state;
    TNBufferSuite table;
    std::uint64_t most;
    std::uint64_t used = 0;
    std::unordered_map<void *, std::uint64_t> buffers;
};

} // namespace Stillmark
