#pragma once

namespace CorvaneDeblur
{

/// Size of a transform grid for n samples: the smallest product of 2, 3, 5, 7, 11 and 13 that is not less than n, found
/// in a table of those below 10,000; above the largest entry, the smallest such product strictly greater than n.
/// n is at least 1. Any thread.
int fastSize(int n);

} // namespace CorvaneDeblur
