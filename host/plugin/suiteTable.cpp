#include "host/plugin/suiteTable.h"

namespace Stillmark
{

suiteTable::suiteTable(runState &run) : state(run)
{
    table.context = this;
    table.acquire = [](void *context, const char *name, std::int32_t version, const void **suite) {
        suiteTable &all = *static_cast<suiteTable *>(context);
        return all.state.code("acquire of a suite", [&]() -> TNError {
            return name && suite ? all.acquire(name, version, suite) : TNError{TNErrParameter};
        });
    };
    table.release = [](void *context, const char *name, std::int32_t version) {
        suiteTable &all = *static_cast<suiteTable *>(context);
        return all.state.code("release of a suite",
                              [&]() -> TNError { return name ? all.release(name, version) : TNError{TNErrParameter}; });
    };
}

TNError suiteTable::acquire(const std::string &name, int version, const void **suite)
{
    *suite = nullptr;
    const hostLie lie = state.lie(hostCall::suite, name);
    if (lie.fails())
        return lie.code;
    const auto place = offered.find({name, version});
    if (place == offered.end())
        return TNErrParameter;
    if (lie.raves())
    {
        place->second.hollow++;
        return TNNoError;
    }
    place->second.held++;
    *suite = place->second.suite;
    return TNNoError;
}

/// A release that is told to fail has still been asked for: it counts as one.
TNError suiteTable::release(const std::string &name, int version)
{
    const hostLie lie = state.lie(hostCall::release, name);
    const auto place = offered.find({name, version});
    if (place != offered.end() && place->second.held == 0 && place->second.hollow > 0)
    {
        place->second.hollow--;
        return TNNoError;
    }
    if (place == offered.end() || place->second.held == 0)
    {
        state.misuse("release of " + name + ", version " + std::to_string(version) + ", which is not held");
        return TNErrParameter;
    }
    place->second.held--;
    return lie.fails() ? lie.code : TNError{TNNoError};
}

std::map<std::string, int> suiteTable::unreleased() const
{
    std::map<std::string, int> left;
    for (const auto &[suite, each] : offered)
        if (each.held > 0)
            left[suite.first + ", version " + std::to_string(suite.second)] = each.held;
    return left;
}

} // namespace Stillmark
