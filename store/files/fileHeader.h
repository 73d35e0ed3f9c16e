#pragma once

#include <cstddef>
#include <cstdint>

namespace Sarnik
{
class CContainer;
}

/// The 18 bytes that workspaces and trace files begin with (docs/files/traces.md).
namespace Project
{

class PKernelCollection;

inline constexpr std::size_t kHeaderLength = 18;

/// The newest version, and the size of the collection's picture.
void WriteHeader(const PKernelCollection &collection, Sarnik::CContainer &out);
void WriteHeader(std::int32_t width, std::int32_t height, Sarnik::CContainer &out);

/// Reads the version into the collection, where it says how trace records are read from here on, and compares the size
/// with that of the collection's picture. What is not as it should be is told in the collection's last error, which
/// stays as it was otherwise. Throws CError at the end of the data.
void ReadHeader(PKernelCollection &collection, Sarnik::CContainer &in);

} // namespace Project
