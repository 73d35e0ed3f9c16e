#include "tests/support/npy.h"

#include "tests/support/temporaryFolder.h"

#include <algorithm>
#include <bit>
#include <cstdio>
#include <cstring>
#include <stdexcept>
#include <string>

using CorvaneDeblur::byteArray;
using CorvaneDeblur::floatArray;

namespace TestSupport
{
namespace
{

static_assert(std::endian::native == std::endian::little, "the samples are read as they lie in the file");

struct npyFile
{
    std::string path, header, samples;
    int rows = 1, cols = 1;

    std::size_t count() const { return static_cast<std::size_t>(rows) * static_cast<std::size_t>(cols); }
    bool holds(const char *type) const { return header.find(std::string("'descr': '") + type) != std::string::npos; }
};

[[noreturn]] void refuse(const std::string &path, const char *why)
{
    throw std::runtime_error(path + ": " + why);
}

npyFile readNpy(const char *caseName, const char *arrayName)
{
    npyFile file;
    file.path = std::string(STILLMARK_TEST_DATA) + "/vectors/" + caseName + "/" + arrayName + ".npy";
    const std::string bytes = bytesOf(file.path);
    if (bytes.size() < 10 || bytes.compare(0, 8, std::string("\x93NUMPY\x01\x00", 8)) != 0)
        refuse(file.path, "missing, or not an array file of version 1.0");
    const std::size_t headerLength = static_cast<unsigned char>(bytes[8]) + 256u * static_cast<unsigned char>(bytes[9]);
    file.header = bytes.substr(10, headerLength);
    file.samples = bytes.substr(std::min(bytes.size(), 10 + headerLength));

    const std::size_t shape = file.header.find("'shape': (");
    if (shape == std::string::npos || file.header.find("'fortran_order': False") == std::string::npos)
        refuse(file.path, "no shape, or not in C order");
    if (std::sscanf(file.header.c_str() + shape, "'shape': (%d, %d)", &file.rows, &file.cols) == 1)
        std::swap(file.rows, file.cols); // one dimension is one row
    return file;
}

template <typename Sample> void copySamples(const npyFile &file, Sample *to)
{
    if (file.samples.size() != file.count() * sizeof(Sample))
        refuse(file.path, "not as many samples as its shape tells");
    std::memcpy(to, file.samples.data(), file.samples.size());
}

} // namespace

floatArray readFloats(const char *caseName, const char *arrayName)
{
    const npyFile file = readNpy(caseName, arrayName);
    const floatArray a = floatArray::allocate(file.rows, file.cols);
    if (file.holds("<f4"))
        copySamples(file, a.data);
    else if (file.holds("<f8"))
    {
        std::vector<double> wide(file.count());
        copySamples(file, wide.data());
        for (std::size_t i = 0; i < wide.size(); ++i)
            a.data[i] = static_cast<float>(wide[i]);
    }
    else
        refuse(file.path, "not an array of floats");
    return a;
}

byteArray readBytes(const char *caseName, const char *arrayName)
{
    const npyFile file = readNpy(caseName, arrayName);
    if (!file.holds("|u1"))
        refuse(file.path, "not an array of bytes");
    const byteArray a = byteArray::allocate(file.rows, file.cols);
    copySamples(file, a.data);
    return a;
}

std::vector<std::int64_t> readInts(const char *caseName, const char *arrayName)
{
    const npyFile file = readNpy(caseName, arrayName);
    if (!file.holds("<i8"))
        refuse(file.path, "not an array of 64-bit integers");
    std::vector<std::int64_t> values(file.count());
    copySamples(file, values.data());
    return values;
}

} // namespace TestSupport
