#pragma once

#include "host/plugin/hostOptions.h"
#include "host/plugin/runState.h"
#include "shell/tintorel.h"

#include <vector>

namespace Stillmark
{

/// The alerts of one run: shown by the caller's sink, answered by the caller's list, and kept.
class alertTable
{
public:
    alertTable(runState &run, const hostOptions &hostOffers);
    alertTable(const alertTable &) = delete;
    alertTable &operator=(const alertTable &) = delete;

    const TNAlertProcs *procs() const { return &table; }
    const std::vector<hostAlert> &shown() const { return list; }

private:
    std::int32_t show(hostAlert alert);

    runState &state;
    const hostOptions &options;
    TNAlertProcs table;
    std::size_t questions = 0;
    std::vector<hostAlert> list;
};

} // namespace Stillmark
