"""Reference values of the distributions beyond the GEV and Pareto families, far in both tails and at
extreme shapes, with mpmath at 50 digits: distribution functions from their definitions (incomplete
gamma functions by their integral for large shapes), quantiles by root finding on the logarithm of
the smaller tail.

    python3 families.py > families.csv

Columns: family, up to three parameters, exceedance probability, the quantile at it, the quantile at
that non-exceedance probability, and the natural logarithm of the density at the first quantile. The
truncated Gumbel's third parameter is the threshold. Parameters and probabilities are doubles.
"""
from mpmath import (mp, mpf, exp, log, sqrt, erfc, erfinv, gammainc, loggamma, pi, quad, inf, findroot,
                    expm1, log1p, lambertw)

mp.dps = 50
PROBABILITIES = ["1e-12", "1e-6", "0.01", "0.5", "0.99"]


def weibull(xi, alpha, kappa):
    density = lambda x: log(kappa / alpha) + (kappa - 1) * log((x - xi) / alpha) \
        - ((x - xi) / alpha) ** kappa
    return (lambda p: xi + alpha * (-log(1 - p)) ** (1 / kappa),
            lambda e: xi + alpha * (-log(e)) ** (1 / kappa), density)


def frechet(alpha, kappa):
    density = lambda x: log(kappa / alpha) - (kappa + 1) * log(x / alpha) - (x / alpha) ** -kappa
    return (lambda p: alpha * (-log(p)) ** (-1 / kappa),
            lambda e: alpha * (-log(1 - e)) ** (-1 / kappa), density)


def gamma_tail(k, z, upper):
    if k < 5000:
        return gammainc(k, z, inf, regularized=True) if upper else gammainc(k, 0, z, regularized=True)
    density = lambda t: exp((k - 1) * log(t) - t - loggamma(k))
    s = sqrt(k)
    steps = [0, 1, 2, 4, 7, 11, 16, 22]
    ends = [z + j * s for j in steps] if upper else [z - j * s for j in reversed(steps)]
    return quad(density, ends)


def gamma_quantile(k, p, upper):
    """z with P(k, z) = p, or Q(k, z) = p."""
    if p > mpf("0.5"):
        p, upper = 1 - p, not upper
    w = sqrt(mpf(2)) * erfinv(1 - 2 * p) * (1 if upper else -1)
    start = k * (1 - 1 / (9 * k) + w / (3 * sqrt(k))) ** 3
    if start <= 0 or k < 1:
        start = exp((log((1 - p if upper else p)) + loggamma(k + 1)) / k)
        start = max(start, -log(p)) if upper and p < mpf("0.1") else start
    if k < 5000:
        f = lambda y: log(gamma_tail(k, exp(y), upper) / p)
        return exp(findroot(f, log(start)))
    # Newton, since each evaluation is an integral.
    z = start
    for _ in range(12):
        tail = gamma_tail(k, z, upper)
        density = exp((k - 1) * log(z) - z - loggamma(k))
        z += log(tail / p) * tail / density * (1 if upper else -1)
    return z


def pearson(xi, alpha, kappa):
    def density(x):
        z = (x - xi) / alpha
        return (kappa - 1) * log(z) - z - loggamma(kappa) - log(abs(alpha))
    up = alpha > 0
    return (lambda p: xi + alpha * gamma_quantile(kappa, p, not up),
            lambda e: xi + alpha * gamma_quantile(kappa, e, up), density)


def log_pearson(xi, alpha, kappa):
    lower, upper, density = pearson(xi, alpha, kappa)
    return (lambda p: exp(lower(p)), lambda e: exp(upper(e)), lambda x: density(log(x)) - log(x))


def normal_quantile(p):
    start = sqrt(mpf(2)) * erfinv(2 * mpf(float(p)) - 1) if p > mpf("1e-3") else -sqrt(-2 * log(p))
    return findroot(lambda w: log(erfc(-w / sqrt(mpf(2))) / 2 / p), start)


def log_normal(xi, mu, sigma):
    def density(x):
        w = (log(x - xi) - mu) / sigma
        return -log(x - xi) - log(sigma) - log(2 * pi) / 2 - w * w / 2
    return (lambda p: xi + exp(mu + sigma * normal_quantile(p)),
            lambda e: xi + exp(mu - sigma * normal_quantile(e)), density)


def square_root(a, b):
    def of_hazard(h):
        if h >= a:
            return mpf(0)
        t = (-1 - lambertw(-h / a * exp(mpf(-1)), -1)).real
        return t * t / b
    def density(x):
        r = sqrt(b * x)
        return log(a * b / 2) - r - a * (1 + r) * exp(-r)
    return (lambda p: of_hazard(-log(p)), lambda e: of_hazard(-log(1 - e)), density)


def truncated_gumbel(xi, alpha, threshold):
    s0 = -expm1(-exp(-(threshold - xi) / alpha))
    def density(x):
        z = (x - xi) / alpha
        return -log(alpha) - z - exp(-z) - log(s0)
    upper = lambda e: xi - alpha * log(-log1p(-e * s0))
    return (lambda p: upper(1 - p), upper, density)


CASES = [
    ("WEI", weibull, [("0", "1", "0.3"), ("40", "11.7", "0.958"), ("3.5", "0.5", "1.9"),
                      ("-3000", "5000", "30")]),
    ("FRE", frechet, [("1", "0.5"), ("2000", "2.9"), ("3.9", "22")]),
    ("P3", pearson, [("0", "1", "0.05"), ("41", "15", "0.73"), ("1", "2", "3"), ("1", "-2", "3"),
                     ("0", "1", "19.99"), ("0", "1", "20.01"), ("0", "1", "199"), ("0", "1", "201"),
                     ("-200", "0.1", "10000"), ("2000", "-0.0005", "4000000")]),
    ("LP3", log_pearson, [("6.2", "0.2", "7.5"), ("16", "-0.053", "155"), ("13.5", "-0.49", "12")]),
    ("LN3", log_normal, [("30", "2.5", "0.7"), ("0", "0", "4"), ("-300", "8", "0.06")]),
    ("SQE", square_root, [("72", "13.27"), ("4.16", "0.0026"), ("0.5", "1"), ("4e16", "450")]),
    ("TGUM", truncated_gumbel, [("3.935", "0.1712", "3.8"), ("0", "1", "20"), ("0", "1", "690"),
                                ("0", "1", "-6")]),
]


def main():
    print("family,first,second,third,probability,quantile_of_exceedance,quantile,log_density")
    for family, make, members in CASES:
        for member in members:
            lower, upper, density = make(*[mpf(float(text)) for text in member])
            for text in PROBABILITIES:
                p = mpf(float(text))
                x = upper(p)
                cells = list(member) + ["NA"] * (3 - len(member)) + [text] + \
                    [mp.nstr(v, 20) for v in (x, lower(p), density(x))]
                print(",".join([family] + cells))


main()
