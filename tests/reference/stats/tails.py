"""Reference values of the GEV and generalised Pareto distributions far in both tails and at shapes
near 0, in decimal arithmetic of 60 digits straight from the definitions (no expm1, no log1p).

    python3 tails.py > tails.csv

Columns: family, kappa, probability as a text, quantile at that exceedance probability, quantile at
that non-exceedance probability (xi = 2, alpha = 3), and the natural logarithm of the density at
the first quantile. A double nearest to the probability text is what the tested code gets, so the
probability is taken as that double's exact value.
"""
from decimal import Decimal, getcontext

getcontext().prec = 60
XI, ALPHA = Decimal(2), Decimal(3)
SHAPES = ["-0.9", "-0.3", "-0.01", "-1e-6", "-1e-9", "-1e-12", "0", "1e-12", "1e-9", "1e-6",
          "0.01", "0.3", "1", "1.5"]
PROBABILITIES = ["1e-12", "1e-9", "1e-6", "0.001", "0.01", "0.1", "0.5", "0.9", "0.999"]


def standard(y, kappa):
    return y if kappa == 0 else (1 - (-kappa * y).exp()) / kappa


def reduced_gev(f):
    return -(-(f.ln())).ln()


def reduced_pareto(f):
    return -((1 - f).ln())


def log_density(family, kappa, x):
    z = (x - XI) / ALPHA
    y = z if kappa == 0 else -(1 - kappa * z).ln() / kappa
    value = -ALPHA.ln() - (1 - kappa) * y
    return value - (-y).exp() if family == "GEV" else value


def main():
    print("family,kappa,probability,quantile_of_exceedance,quantile,log_density")
    for family, reduced in (("GEV", reduced_gev), ("GP", reduced_pareto)):
        for shape in SHAPES:
            for text in PROBABILITIES:
                kappa, p = Decimal(float(shape)), Decimal(float(text))
                upper = XI + ALPHA * standard(reduced(1 - p), kappa)
                lower = XI + ALPHA * standard(reduced(p), kappa)
                density = log_density(family, kappa, upper)
                print(f"{family},{shape},{text},{upper:.20e},{lower:.20e},{density:.20e}")


main()
