#pragma once

#include "dialog/tasks/task.h"

namespace Project
{

/// Artifact Suppression is switched on or off. The stages follow the parameter record's flag.
class PFineResultTask final : public PTask
{
public:
    PFineResultTask(PTaskHost &home, bool on) : PTask(home, false), enable(on) {}

    bool GetName(std::string &text) const override;

protected:
    void PerformUndo() override { Apply(!enable); }
    void PerformRedo() override { Apply(enable); }

private:
    void Apply(bool on);

    bool enable; ///< the state after the click
};

} // namespace Project
