#include "tests/support/npy.h"

#include <bit>
#include <cstring>
#include <fstream>
#include <sstream>
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
    std::string path;
    std::string type; ///< as "<f4"
    int rows = 1;
    int cols = 1;
    std::string samples;

    std::size_t count() const { return static_cast<std::size_t>(rows) * static_cast<std::size_t>(cols); }
};

[[noreturn]] void refuse(const std::string &path, const char *why)
{
    throw std::runtime_error(path + ": " + why);
}

/// The text between two marks of the header.
std::string between(const std::string &header, const std::string &path, const char *open, const char *close)
{
    const std::size_t from = header.find(open);
    if (from == std::string::npos)
        refuse(path, "incomplete header");
    const std::size_t first = from + std::strlen(open);
    const std::size_t last = header.find(close, first);
    if (last == std::string::npos)
        refuse(path, "incomplete header");
    return header.substr(first, last - first);
}

void readShape(npyFile &file, std::string shape)
{
    for (char &c : shape)
        if (c == ',')
            c = ' ';
    std::istringstream numbers(shape);
    std::vector<int> sizes;
    for (int size = 0; numbers >> size;)
        sizes.push_back(size);
    if (sizes.empty() || sizes.size() > 2)
        refuse(file.path, "neither one nor two dimensions");
    file.cols = sizes.back();
    file.rows = sizes.size() == 2 ? sizes.front() : 1;
}

npyFile readNpy(const char *caseName, const char *arrayName)
{
    npyFile file;
    file.path = std::string(STILLMARK_TEST_DATA) + "/vectors/" + caseName + "/" + arrayName + ".npy";

    std::ifstream in(file.path, std::ios::binary);
    if (!in)
        refuse(file.path, "cannot be opened");
    std::ostringstream all;
    all << in.rdbuf();
    const std::string bytes = all.str();

    if (bytes.size() < 10 || bytes.compare(0, 8, std::string("\x93NUMPY\x01\x00", 8)) != 0)
        refuse(file.path, "not an array file of version 1.0");
    const std::size_t headerLength = static_cast<unsigned char>(bytes[8]) + 256u * static_cast<unsigned char>(bytes[9]);
    if (bytes.size() < 10 + headerLength)
        refuse(file.path, "incomplete header");
    const std::string header = bytes.substr(10, headerLength);

    if (header.find("'fortran_order': False") == std::string::npos)
        refuse(file.path, "not in C order");
    file.type = between(header, file.path, "'descr': '", "'");
    readShape(file, between(header, file.path, "'shape': (", ")"));
    file.samples = bytes.substr(10 + headerLength);
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
    if (file.type == "<f4")
        copySamples(file, a.data);
    else if (file.type == "<f8")
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
    if (file.type != "|u1")
        refuse(file.path, "not an array of bytes");
    const byteArray a = byteArray::allocate(file.rows, file.cols);
    copySamples(file, a.data);
    return a;
}

std::vector<std::int64_t> readInts(const char *caseName, const char *arrayName)
{
    const npyFile file = readNpy(caseName, arrayName);
    if (file.type != "<i8")
        refuse(file.path, "not an array of 64-bit integers");
    std::vector<std::int64_t> values(file.count());
    copySamples(file, values.data());
    return values;
}

} // namespace TestSupport
