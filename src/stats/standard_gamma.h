#pragma once

namespace ryn::stats {

/// The gamma distribution with scale 1 and a shape kappa > 0, which Pearson 3 and log-Pearson 3
/// are made of. z is never negative. Keeps its digits up to shapes of 1e11, where it is all but
/// normal.
class StandardGamma {
  public:
    /// `kappa` must be finite and > 0.
    explicit StandardGamma(double kappa);

    double Shape() const { return kappa; }

    /// ln(z^(kappa-1) e^-z/Gamma(kappa)). At z = 0 plus infinity for kappa < 1, 0 for kappa = 1,
    /// minus infinity beyond.
    double LogDensity(double z) const;
    /// P(kappa, z), the probability of a value not above z.
    double Lower(double z) const;
    /// Q(kappa, z) = 1 - P, by its own formula.
    double Upper(double z) const;
    /// z with P(kappa, z) = `probability`: 0 for 0, infinity for 1. Accurate for small ones.
    double InverseOfLower(double probability) const;
    /// z with Q(kappa, z) = `exceedance`, likewise.
    double InverseOfUpper(double exceedance) const;

  private:
    enum class Tail { Lower, Upper };

    double LogKernel(double z) const;
    double Start(Tail tail, double probability) const;
    double Solve(Tail tail, double probability) const;

    double kappa;
    double offset; ///< the part of LogKernel that does not depend on z
};

} // namespace ryn::stats
