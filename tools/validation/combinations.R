# Each combination's fit by its definition: a function of the values and the known lower bound xi (0
# for annual maxima) that gives all parameters of the family, in the order of distributions.R.

# In h = 1/kappa the standard Weibull variable is the power h of an exponential one.
of_h <- function(p) c(p[1], p[2], 1 / p[3])
h_range <- c(0.02, 5)

# mu in place of the scale of exp(sigma w).
of_scale <- function(p) c(p[1], log(p[2]), p[3])
sigma_range <- c(0.005, 4)

lognormal_from_skewness <- function(x, g) {
  if (g <= 0) stop("skewness not positive")
  of_scale(fit_shape(c(mean(x), sd(x), g), moments, lognormal, sigma_range))
}

biased_skewness <- function(x) mean((x - mean(x))^3) / mean((x - mean(x))^2)^1.5

# The polynomial of Bobee and Robitaille (1975); its cube for skewness above 0 alone.
corrected_skewness <- function(x) {
  n <- length(x)
  g <- biased_skewness(x)
  g * (1.01 + 7.01 / n + 14.66 / n^2 + (1.69 / n + 74.66 / n^2) * max(0, g)^3)
}

# xi + b = 0 where (low + b)(high + b) = (centre + b)^2: linear in b, so that two points tell it.
symmetric_bound <- function(low, high, centre) {
  off <- function(b) (low + b) * (high + b) - (centre + b)^2
  if (off(1) == off(0)) return(NA)
  off(0) / (off(1) - off(0))
}

with_bound <- function(x, xi) {
  if (!is.finite(xi) || xi >= min(x)) stop("lower bound not below the values")
  c(xi, mean(log(x - xi)), sd(log(x - xi)))
}

bound_by_pairs <- function(x) {
  x <- sort(x)
  n <- length(x)
  i <- seq_len(max(1, floor(n / 10 + 0.5)))
  with_bound(x, mean(mapply(symmetric_bound, x[i], x[n + 1 - i], exp(mean(log(x)))), na.rm = TRUE))
}

bound_by_median <- function(x) {
  if (max(x) - median(x) <= median(x) - min(x)) stop("no lower bound")
  with_bound(x, symmetric_bound(min(x), max(x), median(x)))
}

# Three moments of x = exp(xi + alpha w), w gamma of shape kappa: for each alpha the kappa that
# gives the ratio of the second, then alpha from that of the third.
log_pearson_of_real_moments <- function(x) {
  centre <- mean(log(x))
  x <- x / exp(centre)
  m <- sapply(1:3, function(r) mean(x^r))
  raw <- function(r, alpha, kappa) {
    integral(gamma1, kappa, function(p, w) exp(r * alpha * (w - kappa)))
  }
  ratio <- function(r, alpha, kappa) log(raw(r, alpha, kappa)) - r * log(raw(1, alpha, kappa))
  # kappa alpha^2 is the variance of ln x.
  near <- log(var(log(x)))
  kappa_of <- function(alpha) {
    exp(root(function(v) ratio(2, alpha, exp(v) / alpha^2) - log(m[2] / m[1]^2), near + c(-2, 2))) /
      alpha^2
  }
  off <- function(alpha) ratio(3, alpha, kappa_of(alpha)) - log(m[3] / m[1]^3)
  # The sign of alpha is that of the skewness beyond the log-normal's with the same variance.
  side <- if (log(m[3] / m[1]^3) > 3 * log(m[2] / m[1]^2)) c(1e-3, 0.3) else c(-0.5, -1e-3)
  alpha <- root(off, side)
  kappa <- kappa_of(alpha)
  c(centre + log(m[1]) - log(raw(1, alpha, kappa)) - alpha * kappa, alpha, kappa)
}

gumbel_corrected <- function(x) {
  n <- length(x)
  y <- -log(-log(seq_len(n) / (n + 1)))
  alpha <- sd(x) / sqrt(mean((y - mean(y))^2))
  c(mean(x) - mean(y) * alpha, alpha, 0)
}

by_theory <- function(method, theory) {
  at <- function(x) measures_of(x, theory)
  heaviest <- if (identical(theory, moments)) -0.32 else -0.9
  fits <- list(
    GEV = function(x, xi) fit_shape(at(x), theory, gev, c(heaviest, 3)),
    GUM = function(x, xi) place(at(x), theory(gev, 0, 2), 0),
    GP = function(x, xi) fit_shape(at(x), theory, pareto, c(heaviest, 8)),
    GP2 = function(x, xi) fit_above(at(x), theory, pareto, c(-0.45, 3), xi),
    WEI = function(x, xi) of_h(fit_shape(at(x), theory, weibull, h_range)),
    WEI2 = function(x, xi) of_h(fit_above(at(x), theory, weibull, h_range, xi)),
    P3 = function(x, xi) fit_pearson(at(x), theory),
    GAM = function(x, xi) {
      in_logarithm <- list(lower = function(p, v) gamma1$lower(p, exp(v)),
                           upper = function(e, v) gamma1$upper(e, exp(v)))
      p <- fit_above(at(x), theory, in_logarithm, c(-5, 9), xi)
      c(p[1:2], exp(p[3]))
    },
    LN2 = function(x, xi) of_scale(fit_above(at(x), theory, lognormal, sigma_range, xi)),
    EXP1 = function(x, xi) c(xi, (mean(x) - xi) / theory(pareto, 0, 2)[1], 0),
    EXP2 = function(x, xi) place(at(x), theory(pareto, 0, 2), 0),
    LP3 = function(x, xi) fit_pearson(measures_of(log(x), theory), theory))
  fits$GP3 <- fits$GP
  fits$WEI3 <- fits$WEI
  setNames(fits, paste0(names(fits), "/", method))
}

by_likelihood <- list(
  "GEV/ML" = function(x, xi) fit_gev(x),
  "GUM/ML" = function(x, xi) fit_gumbel(x),
  # Beyond kappa = 1 the likelihood has no limit.
  "GP2/ML" = function(x, xi) fit_above_by_likelihood(log_density$GP, x, xi, 0.05, 1),
  "WEI2/ML" = function(x, xi) fit_above_by_likelihood(log_density$WEI, x[x > xi], xi, 1.05),
  "GAM/ML" = function(x, xi) fit_above_by_likelihood(log_density$P3, x[x > xi], xi, 1.05),
  "LN2/ML" = function(x, xi) {
    y <- log(x[x > xi] - xi)
    c(xi, maximise(function(p) sum(dnorm(y, p[1], p[2], log = TRUE)), c(mean(y) + 0.1, 1.2 * sd(y)),
                   rep(sd(y), 2)))
  },
  "LN3/ML" = function(x, xi) fit_lognormal3(x),
  "EXP1/ML" = function(x, xi) {
    start <- log(mean(x - xi)) + 0.3
    ll <- function(v) sum(log_density$GP(x, c(xi, exp(v), 0)))
    c(xi, exp(maximise_in_one(ll, start)), 0)
  },
  "SQE/ML" = function(x, xi) fit_square_root(x),
  "TGUM/ML" = function(x, xi) fit_truncated_gumbel(x, xi))

by_order <- list(
  "LN3/MOM/BI" = function(x, xi) lognormal_from_skewness(x, sample_moments(x)[3]),
  "LN3/MOM/BII" = function(x, xi) lognormal_from_skewness(x, corrected_skewness(x)),
  "LN3/MOM/LBQI" = function(x, xi) bound_by_pairs(x),
  "LN3/MOM/LBQII" = function(x, xi) bound_by_median(x),
  "LP3/MOM/REAL" = function(x, xi) log_pearson_of_real_moments(x),
  "GUM/MOM (sample size correction)" = function(x, xi) gumbel_corrected(x))

combinations <- c(by_theory("MOM", moments), by_theory("LMOM", l_moments), by_likelihood, by_order)
combinations[["LP3/MOM/LOG"]] <- combinations[["LP3/MOM"]]
combinations[["LP3/MOM"]] <- NULL
combinations[["FRE/MOM"]] <- function(x, xi) {
  p <- fit_above(sample_moments(x), moments, frechet, c(0.01, 0.475), 0)
  c(p[2], 1 / p[3])
}
