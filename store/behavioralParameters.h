#pragma once

#include <iosfwd>
#include <string>

namespace Project
{

struct PParams;

/// A text file of key=value lines in the preferences directory that tunes a run for experiments. Nobody creates it but
/// a developer. docs/files/preferences.md has its keys and rules.
///
/// That it exists, empty or not, also switches off the test of the host's version.
bool BehavioralParametersExist(const std::string &directory);

/// Applies the file's lines to parameters, the later line winning. Without a file, or with one that cannot be opened,
/// nothing happens; a line with another key, too long for its key or beyond 254 characters is passed over in silence.
/// A line is held at a time, so the file may be of any length. Throws nothing but std::bad_alloc.
void ReadBehavioralParameters(const std::string &directory, PParams &parameters);
/// The same for the lines of a stream.
void ReadBehavioralParameters(std::istream &lines, PParams &parameters);

} // namespace Project
