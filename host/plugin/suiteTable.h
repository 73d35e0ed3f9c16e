#pragma once

#include "host/plugin/runState.h"
#include "shell/tintorel.h"

#include <map>
#include <string>
#include <utility>

namespace Stillmark
{

/// The suites of one run by name and version, with an account of acquires and releases.
class suiteTable
{
public:
    explicit suiteTable(runState &run);
    suiteTable(const suiteTable &) = delete;
    suiteTable &operator=(const suiteTable &) = delete;

    /// From now on acquire finds it. What suite points to outlives the table.
    void offer(const char *name, int version, const void *suite) { offered[{name, version}].suite = suite; }

    const TNSuiteProcs *procs() const { return &table; }
    /// "name, version N" and how often it was not released.
    std::map<std::string, int> unreleased() const;

private:
    struct account
    {
        const void *suite = nullptr;
        int held = 0;
        int hollow = 0; ///< acquires that gave nothing and claimed success: to be released or not, as one sees it
    };
    TNError acquire(const std::string &name, int version, const void **suite);
    TNError release(const std::string &name, int version);

    runState &state;
    TNSuiteProcs table;
    std::map<std::pair<std::string, int>, account> offered;
};

} // namespace Stillmark
