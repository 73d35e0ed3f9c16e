#include "bench/scenes.h"
#include "bench/timing.h"
#include "deblur/deconv/fastSize.h"
#include "deblur/deconv/hyperLaplacianDeconvolver.h"
#include "deblur/deconv/latentEstimatorWiener.h"
#include "deblur/estimate/fastDeconvolver.h"
#include "deblur/estimate/filters.h"
#include "deblur/estimate/kernelSolver.h"
#include "deblur/estimate/resample.h"

/// The steps that jobs are made of, one thread, each with its floor ratio: what a step spends between its transforms,
/// above all in its loops over the spectrum.
namespace
{

using namespace Bench;
using namespace CorvaneDeblur;

constexpr unsigned seed = 23;

/// One level of an estimation: its picture on the grid, its kernel, its gradients.
struct level
{
    explicit level(const benchmark::State &state)
        : side(static_cast<int>(state.range(0))), size(static_cast<int>(state.range(1))),
          grown(fastSize(side + size - 1)), image(shakenScene(side, side, 1, size, seed)[0]), kernel(shake(size, seed)),
          padded(floatArray::allocate(grown, grown)), out(floatArray::allocate(side, side)),
          gradX(floatArray::allocate(side, side)), gradY(floatArray::allocate(side, side))
    {
        taperedExtension(image, padded, size, size);
        forwardDiffX(image, gradX);
        forwardDiffY(image, gradY);
    }

    double pixels() const { return static_cast<double>(side) * side; }

    threadLimit one{1};
    int side, size, grown;
    floatArray image, kernel, padded, out, gradX, gradY;
};

void levels(benchmark::internal::Benchmark *bench)
{
    bench->ArgNames({"side", "size"})->Args({600, 31})->Args({600, 99})->Args({1500, 45});
    bench->UseRealTime()->Unit(benchmark::kMillisecond);
}

template <typename Body> void timeStep(benchmark::State &state, const level &l, transformCount job, const Body &body)
{
    const floorRatio floor({job});
    body();
    const double seconds = timeLoop(state, body);
    reportPixels(state, l.pixels(), seconds);
    floor.report(state, seconds);
}

void stepLatent(benchmark::State &state)
{
    const level l(state);
    const blurredGrid blurred(l.padded, workers::one);
    fastDeconvolver deconvolver(blurred, derivativeOrder::first);
    deconvolver.setLowPass(gaussianLowPass(blurred.grid, 0.8f));
    timeStep(state, l, {l.grown, l.grown, 1, 1}, [&] { deconvolver.solve(l.kernel, l.out, 0.1f); });
}
BENCHMARK(stepLatent)->Apply(levels);

void stepPrepareKernelSolver(benchmark::State &state)
{
    const level l(state);
    const blurredGrid blurred(l.padded, workers::one);
    kernelSolver solver(blurred, l.size, l.size, derivativeOrder::first);
    timeStep(state, l, {l.grown, l.grown, 2, 2}, [&] { solver.prepare(l.gradX, l.gradY); });
}
BENCHMARK(stepPrepareKernelSolver)->Apply(levels);

/// The preparation and the passes of the conjugate gradients; the floor is that of the preparation.
void stepSolveKernel(benchmark::State &state)
{
    const level l(state);
    const blurredGrid blurred(l.padded, workers::one);
    kernelSolver solver(blurred, l.size, l.size, derivativeOrder::first);
    const floatArray kernel = floatArray::allocate(l.size, l.size);
    timeStep(state, l, {l.grown, l.grown, 2, 2}, [&] {
        gaussianFill(kernel, 2.0f);
        solver.solve(l.gradX, l.gradY, kernel, 1.0f, 1.0f);
    });
}
BENCHMARK(stepSolveKernel)->Apply(levels);

/// One pass of the conjugate gradients: kernel-sized transforms only.
void stepApplyOperator(benchmark::State &state)
{
    const level l(state);
    const blurredGrid blurred(l.padded, workers::one);
    kernelSolver solver(blurred, l.size, l.size, derivativeOrder::first);
    solver.prepare(l.gradX, l.gradY);
    const floatArray product = floatArray::allocate(l.size, l.size);
    const int small = fastSize(2 * l.size - 1);
    timeStep(state, l, {small, small, 1, 1}, [&] { solver.applyOperator(product, l.kernel, 1.0f, 1.0f); });
}
BENCHMARK(stepApplyOperator)->Apply(levels);

void stepWiener(benchmark::State &state)
{
    const level l(state);
    timeStep(state, l, {l.grown, l.grown, 2, 1},
             [&] { wienerDeconvolve(l.padded, l.kernel, 0.3f, l.out, workers::one); });
}
BENCHMARK(stepWiener)->Apply(levels);

void stepHyperLaplacian(benchmark::State &state)
{
    const level l(state);
    const shrinkageTableStore tables("");
    hyperLaplacianDeconvolver deconvolver(l.padded, tables, workers::one);
    deconvolver.run(l.out, l.kernel, 0.3f, 0.3f);
    timeStep(state, l, {l.grown, l.grown, 2 + deconvolver.gradientRounds(), 6},
             [&] { deconvolver.run(l.out, l.kernel, 0.3f, 0.3f); });
}
BENCHMARK(stepHyperLaplacian)->Apply(levels);

} // namespace
