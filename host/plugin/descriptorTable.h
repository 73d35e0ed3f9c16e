#pragma once

#include "host/plugin/handleTable.h"
#include "host/plugin/recordedAction.h"
#include "host/plugin/runState.h"
#include "shell/tintorel.h"

#include <cstdint>
#include <map>
#include <memory>

namespace Stillmark
{

/// The descriptor suite of one run over recorded actions. A handle holds an action's bytes.
class descriptorTable
{
public:
    descriptorTable(runState &run, handleTable &hostMemory);
    descriptorTable(const descriptorTable &) = delete;
    descriptorTable &operator=(const descriptorTable &) = delete;

    const TNDescriptorSuite *suite() const { return &table; }
    std::uint64_t count() const { return open.size(); }

private:
    template <class Work> static TNError on(void *context, TNDescriptor descriptor, const char *function, Work work);
    template <class Made> static TNError make(void *context, TNDescriptor *out, const char *function, Made made);
    void close(TNDescriptor descriptor) noexcept;
    void fillReaders();
    void fillWriters();

    runState &state;
    handleTable &handles;
    TNDescriptorSuite table;
    std::map<TNDescriptor, std::unique_ptr<recordedAction>> open; ///< by the action's address
};

} // namespace Stillmark
