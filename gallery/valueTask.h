#pragma once

#include "framework/tasks/task.h"

#include <functional>
#include <string>
#include <utility>

namespace Stillmark
{

/// A number that the user has changed.
class valueTask final : public Sarnik::CTask
{
public:
    valueTask(std::string what, double valueBefore, double valueAfter, std::function<void(double)> setter)
        : CTask(true), name(std::move(what)), before(valueBefore), after(valueAfter), set(std::move(setter))
    {
    }

    bool GetName(std::string &text) const override
    {
        text = name;
        return true;
    }

private:
    void PerformUndo() override { set(before); }
    void PerformRedo() override { set(after); }

    std::string name;
    double before, after;
    std::function<void(double)> set;
};

} // namespace Stillmark
