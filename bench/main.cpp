#include "bench/floor.h"

#include <benchmark/benchmark.h>

int main(int argc, char **argv)
{
    benchmark::AddCustomContext("floor", Bench::floorLibrary());
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 2;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
}
