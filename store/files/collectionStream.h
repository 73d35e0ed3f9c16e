#pragma once

#include <cstdint>
#include <set>

namespace Sarnik
{
class CContainer;
}

/// All traces of a collection as bytes, in workspaces and in recorded actions (docs/files/traces.md).
namespace Project
{

class PKernel;
class PKernelCollection;

/// What a stream says of selection and activation, for those who want to show it as it stands there. A collection keeps
/// only what makes sense: a selected trace that is none selects nothing, and no activated trace is none.
struct PStreamIndices
{
    std::int32_t selected = -1;    ///< lowered for each rejected trace up to it
    std::set<std::int32_t> active; ///< -1 stands for all that name no trace
};

/// The whole list in the newest version; the activated traces in the list's order. A run that found its one trace by
/// itself, without a dialog, has it beside an empty list: it is written as the list's only trace, activated if it
/// renders, so that whoever reads the record of such a run learns what was found. (Playing the record searches anew.)
void WriteCollection(const PKernelCollection &collection, Sarnik::CContainer &out);

/// Empties the collection and fills it from the stream, by the rules of the collection's version. Traces that the
/// picture does not contain, and those of an unknown kind, are left out, and the last error tells so. Throws CError
/// where the stream ends too early or makes no sense; what came before that place has been taken over then.
void ReadCollection(PKernelCollection &collection, Sarnik::CContainer &in, PStreamIndices *indices = nullptr);

/// Whether a trace's region is empty, which stands for the whole picture, or lies within the picture.
bool RegionFits(const PKernelCollection &collection, const PKernel &trace);

} // namespace Project
