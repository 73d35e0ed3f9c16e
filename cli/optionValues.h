#pragma once

#include "deblur/deconv/latentEstimator.h"
#include "deblur/estimate/kernelEstimator.h"
#include "host/photo.h"

#include <stdexcept>
#include <string>
#include <utility>

/// Words of the command line as values. All throw usageError with what is wrong, to be put after the option's name.
namespace Stillmark
{

/// Wrong usage: the program answers 2.
class usageError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// Sides of the kernels that are looked for.
constexpr int smallestBlurSize = 3, largestBlurSize = 199;

/// A whole number from `least` to `most`; nothing before or after it.
int parseInt(const std::string &text, int least, int most);
/// A number from `least` to `most`, in C notation; no NaN.
double parseReal(const std::string &text, double least, double most);
/// 0 to 100, answered as a share of 1.
float parsePercent(const std::string &text);
/// An odd number of pixels from smallestBlurSize to largestBlurSize.
int parseBlurSize(const std::string &text);
/// "x,y,width,height" with x and y not negative and a width and height of at least 1.
rectangle parseRectangle(const std::string &text);
/// "x,y", not negative.
std::pair<int, int> parsePoint(const std::string &text);
/// "WxH", both from 1 to 2000000.
std::pair<int, int> parseSize(const std::string &text);
/// "i/n": the i-th of n parts, 1 <= i <= n <= 100000.
std::pair<int, int> parseShard(const std::string &text);
/// auto, low, medium or high.
CorvaneDeblur::noiseMode parseNoiseMode(const std::string &text);
/// wiener, classic or fast.
CorvaneDeblur::deconvolutionMethod parseMethod(const std::string &text);

} // namespace Stillmark
