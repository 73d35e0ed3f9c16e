#pragma once

#include "platform/math/complexSample.h"
#include "platform/math/sampleMemory.h"

#include <algorithm>
#include <cassert>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <type_traits>

namespace CorvaneDeblur
{

/// A row-major view of shared samples: images, kernels, masks, gradients, spectra.
///
/// Copying an array copies the view and shares the samples; a deep copy is an explicit copyTo (arrayOps.h). A
/// default-constructed array is empty (null data, 0 x 0), which several algorithms read as "not given". Samples are
/// released with the last array or view that holds them, on any thread; they may be read by several threads at once
/// and are written by one owner at a time. An allocation that fails throws std::bad_alloc.
///
/// Intensities are 0..1 everywhere in the engine: 1/255 is one level of an 8-bit picture.
template <typename Sample> class sampleArray
{
public:
    sampleArray() = default;

    /// A fresh array of rows x cols, stride == cols. Samples are uninitialised, but zero for complex samples.
    static sampleArray allocate(int rows, int cols)
    {
        assert(rows >= 0 && cols >= 0);
        sampleArray a;
        const std::size_t count = static_cast<std::size_t>(rows) * static_cast<std::size_t>(cols);
        const std::size_t bytes = count * sizeof(Sample);
        a.samples = std::shared_ptr<Sample[]>(static_cast<Sample *>(takeSampleMemory(bytes)),
                                              [bytes](Sample *memory) { returnSampleMemory(memory, bytes); });
        if constexpr (std::is_same_v<Sample, complexSample>)
            std::fill_n(a.samples.get(), count, complexSample{0.0f, 0.0f});
        a.data = a.samples.get();
        a.rows = rows;
        a.cols = cols;
        a.stride = cols;
        return a;
    }

    /// View of the rectangle whose first sample is at row y, column x; shares the samples.
    sampleArray subRect(int y, int x, int rectRows, int rectCols) const
    {
        assert(y >= 0 && x >= 0 && rectRows >= 0 && rectCols >= 0 && y + rectRows <= rows && x + rectCols <= cols);
        sampleArray a(*this);
        a.data = data + static_cast<std::ptrdiff_t>(y) * stride + x;
        a.rows = rectRows;
        a.cols = rectCols;
        return a;
    }

    sampleArray rowView(int y) const { return subRect(y, 0, 1, cols); }
    sampleArray colView(int x) const { return subRect(0, x, rows, 1); }

    /// The first sample of row y; `cols` samples follow.
    Sample *row(int y) const
    {
        assert(y >= 0 && y < rows);
        return data + static_cast<std::ptrdiff_t>(y) * stride;
    }

    Sample &at(int y, int x) const
    {
        assert(x >= 0 && x < cols);
        return row(y)[x];
    }

    bool empty() const { return data == nullptr || rows == 0 || cols == 0; }

    template <typename Other> bool sameShape(const sampleArray<Other> &other) const
    {
        return rows == other.rows && cols == other.cols;
    }

    std::shared_ptr<Sample[]> samples; ///< owner of the allocation, shared by all views of it
    Sample *data = nullptr;            ///< the view's first sample
    int rows = 0;
    int cols = 0;
    int stride = 0; ///< samples from one row start to the next; equals cols in a fresh array
};

using floatArray = sampleArray<float>;
using complexArray = sampleArray<complexSample>;
using byteArray = sampleArray<std::uint8_t>;
using intArray = sampleArray<std::int32_t>;

/// The half spectrum of a real rows x cols grid has rows x halfSpectrumCols(cols) samples.
inline int halfSpectrumCols(int cols)
{
    return cols / 2 + 1;
}

} // namespace CorvaneDeblur
