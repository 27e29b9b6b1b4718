"""Maximum likelihood fits to 15 digits, in a way of their own.

The log-likelihood is the sum of ln f by the definition of the density, in 40 digits, as a function
of all parameters at once. Its gradient (mpmath's numerical derivatives) is brought to 0 by Newton's
method from parameters known to four digits, and the point is checked to be a maximum: the negative
Hessian must have a Cholesky decomposition. Nothing is profiled, transformed or scaled.

    python3 likelihood.py > likelihood.csv     (mpmath 1.3.0)

Columns: series, combination, the estimated parameters in the order of the results (empty where
there are fewer than three), log-likelihood.
"""

import os

import mpmath as mp

mp.mp.dps = 40
HERE = os.path.dirname(os.path.abspath(__file__))
THRESHOLD = {"rain40": mp.mpf(40), "rain30": mp.mpf(30), "pp38": mp.mpf("3.8")}


def series(name):
    with open(os.path.join(HERE, "series", name + ".txt"), encoding="utf-8") as file:
        return [mp.mpf(line.strip()) for line in file if not line.startswith("#")]


def gev(x, _, xi, alpha, kappa):
    q = 1 - kappa * (x - xi) / alpha
    return -mp.log(alpha) + (1 / kappa - 1) * mp.log(q) - q ** (1 / kappa)


def gumbel(x, _, xi, alpha):
    z = (x - xi) / alpha
    return -mp.log(alpha) - z - mp.exp(-z)


def pareto(x, x0, alpha, kappa):
    return -mp.log(alpha) + (1 / kappa - 1) * mp.log(1 - kappa * (x - x0) / alpha)


def weibull(x, x0, alpha, kappa):
    z = (x - x0) / alpha
    return mp.log(kappa / alpha) + (kappa - 1) * mp.log(z) - z**kappa


def gamma(x, x0, alpha, kappa):
    z = (x - x0) / alpha
    return (kappa - 1) * mp.log(z) - z - mp.loggamma(kappa) - mp.log(alpha)


def lognormal2(x, x0, mu, sigma):
    return lognormal3(x, x0, x0, mu, sigma)


def lognormal3(x, _, xi, mu, sigma):
    w = (mp.log(x - xi) - mu) / sigma
    return -mp.log(x - xi) - mp.log(sigma) - mp.log(2 * mp.pi) / 2 - w * w / 2


def square_root_exponential(x, _, a, b):
    r = mp.sqrt(b * x)
    return mp.log(a * b / 2) - r - a * (1 + r) * mp.exp(-r)


def truncated_gumbel(x, x0, xi, alpha):
    survival = 1 - mp.exp(-mp.exp(-(x0 - xi) / alpha))
    return gumbel(x, x0, xi, alpha) - mp.log(survival)


CASES = [
    ("portpirie", "GEV/ML", gev, [3.8747, 0.1980, 0.0501]),
    ("floyd", "GEV/ML", gev, [2405.1, 2172.6, -0.6901]),
    ("fishkill", "GEV/ML", gev, [1818, 812, -0.38]),
    ("nile60", "GEV/ML", gev, [879.2, 175.8, 0.300]),
    ("portpirie", "GUM/ML", gumbel, [3.8694, 0.1949]),
    ("fishkill", "GUM/ML", gumbel, [2035.6, 1086.8]),
    ("rain40", "GP2/ML", pareto, [11.783, -0.01341]),
    ("rain30", "GP2/ML", pareto, [7.4403, -0.1845]),
    ("pp38", "GP2/ML", pareto, [0.36044, 0.33347]),
    ("rain40", "WEI2/ML", weibull, [12.003, 1.0117]),
    ("rain30", "WEI2/ML", weibull, [8.649, 0.9086]),
    ("rain40", "GAM/ML", gamma, [11.465, 1.0417]),
    ("rain30", "GAM/ML", gamma, [10.134, 0.8964]),
    ("portpirie", "LN2/ML", lognormal2, [1.3797, 0.05894]),
    ("rain30", "LN2/ML", lognormal2, [1.554, 1.2574]),
    ("portpirie", "LN3/ML", lognormal3, [3.216, -0.3161, 0.3101]),
    ("fishkill", "LN3/ML", lognormal3, [767.66, 7.2279, 0.8852]),
    ("floyd", "LN3/ML", lognormal3, [127.99, 8.1222, 1.1199]),
    ("rain40", "LN3/ML", lognormal3, [39.161, 2.1378, 0.9385]),
    ("fishkill", "SQE/ML", square_root_exponential, [22.85, 0.01248]),
    ("floyd", "SQE/ML", square_root_exponential, [4.159, 0.002605]),
    ("pp38", "TGUM/ML", truncated_gumbel, [3.9351, 0.17122]),
]


def fit(name, density, start):
    values = series(name)
    x0 = THRESHOLD.get(name, mp.mpf(0))
    # Parameters in units of their starts: differences and Newton's steps then suit them all.
    unit = [mp.mpf(s) for s in start]

    def likelihood(*shares):
        parameters = [u * s for u, s in zip(unit, shares)]
        return sum(density(x, x0, *parameters) for x in values)

    size = len(start)

    def order(*indices):
        return tuple(indices.count(i) for i in range(size))

    point = [mp.mpf(1)] * size
    for _ in range(12):
        gradient = mp.matrix([mp.diff(likelihood, tuple(point), order(i)) for i in range(size)])
        hessian = mp.matrix(size, size)
        for i in range(size):
            for j in range(size):
                hessian[i, j] = mp.diff(likelihood, tuple(point), order(i, j))
        step = mp.lu_solve(-hessian, gradient)
        point = [p + s for p, s in zip(point, step)]
        if max(abs(s) for s in step) < mp.mpf("1e-17"):
            break
    else:
        raise ArithmeticError(name + ": Newton's method does not converge")
    mp.cholesky(-hessian)
    return [u * s for u, s in zip(unit, point)], likelihood(*point)


def main():
    print("series,combination,first,second,third,logLikelihood")
    for name, combination, density, start in CASES:
        parameters, value = fit(name, density, start)
        cells = [mp.nstr(p, 15) for p in parameters] + [""] * (3 - len(parameters))
        print(",".join([name, combination] + cells + [mp.nstr(value, 15)]))


if __name__ == "__main__":
    main()
