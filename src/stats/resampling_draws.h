#pragma once

#include <cstddef>
#include <cstdint>
#include <random>

namespace ryn::stats {

/// The uniform numbers of the parametric bootstrap: the same on every machine and with every
/// compiler, since the generator is fixed by the language and the rest stands here (the library's
/// distribution classes differ between compilers).
class UniformDraws {
  public:
    explicit UniformDraws(std::uint64_t seed) : generator(seed) {}

    /// (k + 1/2) 2^-52 for the upper 52 bits k of the next output: never 0 and never 1.
    double Next() { return (static_cast<double>(generator() >> 12) + 0.5) * 0x1p-52; }

  private:
    std::mt19937_64 generator;
};

/// The number of events with Poisson distribution of mean `mean` that belongs to the uniform number
/// `u` in (0, 1), by inversion: of the distribution function up to a mean of 700, of its normal
/// approximation beyond, where exp(-mean) comes near the smallest double. Part of the results like
/// the generator: another method would draw other samples.
std::size_t PoissonCount(double mean, double u);

} // namespace ryn::stats
