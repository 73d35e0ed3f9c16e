#pragma once

/// Functions marked STILLMARK_MULTIVERSION are compiled twice, for the x86-64 baseline and for x86-64-v3 (AVX2), and
/// the loader picks the one that the processor can run. Mark hot loops over plain `float *` only: what such a function
/// calls is not multiplied with it unless it is inlined. Fused multiply-add stays off (-ffp-contract=off), so both
/// versions round alike.
///
/// The macro is empty where the build turns it off: other processors, sanitizers (their runtime starts after the
/// loader has asked), and the baseline build of the tests.
#if defined(STILLMARK_MULTIVERSION) && STILLMARK_MULTIVERSION && defined(__x86_64__) && defined(__GNUC__) && \
    !defined(__clang__)
#undef STILLMARK_MULTIVERSION
#define STILLMARK_MULTIVERSION __attribute__((target_clones("default", "arch=x86-64-v3")))
#else
#undef STILLMARK_MULTIVERSION
#define STILLMARK_MULTIVERSION
#endif
