#include "fuzz/fuzzing.h"
#include "platform/files.h"

#include <iostream>

/// Stands in for the fuzzer where there is none: hands it the files that are named.
int main(int count, char **arguments)
{
    for (int i = 1; i < count; ++i)
    {
        std::cerr << arguments[i] << '\n'; // the last line tells which one failed
        const auto bytes = Platform::readWholeFile(arguments[i], std::size_t{1} << 24);
        LLVMFuzzerTestOneInput(bytes.data(), bytes.size());
    }
    return count > 1 ? 0 : 1;
}
