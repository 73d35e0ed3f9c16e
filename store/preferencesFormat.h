#pragma once

namespace Sarnik
{
class CContainer;
}

/// The bytes of the preferences file. docs/files/preferences.md is their description.
namespace Project
{

struct PPreferences;
struct PWindowPlacement;

/// Reads a whole file, of either byte order, into fresh preferences. False for what is not such a file, which leaves
/// them as they are. Throws CError when the data end before the zero word that closes them; the object is then of no
/// use.
bool ReadPreferences(Sarnik::CContainer &in, PPreferences &preferences);

/// Writes a whole file in the native form, little-endian, from the container's start.
void WritePreferences(Sarnik::CContainer &out, const PPreferences &preferences);

void ReadPlacement(Sarnik::CContainer &in, PWindowPlacement &frame);
void WritePlacement(Sarnik::CContainer &out, const PWindowPlacement &frame);

} // namespace Project
