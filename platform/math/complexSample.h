#pragma once

namespace CorvaneDeblur
{

/// One complex value of a spectrum, real part first, laid out as FFTW's and std::complex's.
/// A plain pair: products of std::complex<float> check for NaN and stay scalar under g++, these vectorise.
struct complexSample
{
    float re, im;
};

inline complexSample operator+(complexSample a, complexSample b)
{
    return {a.re + b.re, a.im + b.im};
}

inline complexSample operator-(complexSample a, complexSample b)
{
    return {a.re - b.re, a.im - b.im};
}

inline complexSample operator*(complexSample a, complexSample b)
{
    return {a.re * b.re - a.im * b.im, a.re * b.im + a.im * b.re};
}

inline complexSample operator*(complexSample a, float b)
{
    return {a.re * b, a.im * b};
}

inline complexSample conj(complexSample a)
{
    return {a.re, -a.im};
}

/// Squared magnitude.
inline float norm(complexSample a)
{
    return a.re * a.re + a.im * a.im;
}

} // namespace CorvaneDeblur
