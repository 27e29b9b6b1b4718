"""Reference values of A(kappa), B(kappa) and SK(kappa) of the GEV, and of its L-skewness, in decimal
arithmetic of 80 digits from the definitions. The gamma function is Stirling's series after the
argument has been raised above 80.

    python3 shape_functions.py > shape_functions.csv
"""
from decimal import Decimal, getcontext
from fractions import Fraction
from math import comb

getcontext().prec = 80
SHAPES = ["-0.33", "-0.3", "-0.1", "-0.0101", "-0.01", "-0.00999", "-0.005", "-1e-4", "-1e-8", "1e-8",
          "1e-4", "0.005", "0.00999", "0.01", "0.0101", "0.1", "0.3", "1", "2.5", "9"]


def bernoulli(count):
    numbers = [Fraction(1)]
    for m in range(1, count):
        total = sum(Fraction(comb(m + 1, k)) * numbers[k] for k in range(m))
        numbers.append(-total / (m + 1))
    return numbers


BERNOULLI = [Decimal(b.numerator) / Decimal(b.denominator) for b in bernoulli(81)]


def arctan_inverse(n):
    total, term, k, square = Decimal(0), Decimal(1) / n, 0, n * n
    while abs(term) > Decimal(10) ** -90:
        total += term / (2 * k + 1) if k % 2 == 0 else -term / (2 * k + 1)
        term /= square
        k += 1
    return total


PI = 4 * (4 * arctan_inverse(5) - arctan_inverse(239))


def gamma(x):
    divisor = Decimal(1)
    while x < 80:
        divisor *= x
        x += 1
    log = (x - Decimal("0.5")) * x.ln() - x + (2 * PI).ln() / 2
    power = x
    for m in range(2, 81, 2):
        log += BERNOULLI[m] / (m * (m - 1) * power)
        power *= x * x
    return log.exp() / divisor


def main():
    print("kappa,variance_factor,mean_factor,skewness,l_skewness")
    for text in SHAPES:
        k = Decimal(float(text))
        g1, g2, g3 = gamma(1 + k), gamma(1 + 2 * k), gamma(1 + 3 * k)
        variance = g2 - g1 * g1
        sign = 1 if k > 0 else -1
        skewness = sign * (-g3 + 3 * g1 * g2 - 2 * g1 ** 3) / (variance * variance.sqrt())
        l_skewness = 2 * (1 - (-k * Decimal(3).ln()).exp()) / (1 - (-k * Decimal(2).ln()).exp()) - 3
        print(f"{text},{variance / (k * k):.20e},{(1 - g1) / k:.20e},{skewness:.20e},"
              f"{l_skewness:.20e}")


main()
