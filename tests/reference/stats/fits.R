# Reference fits in base R, in a way of their own: the equations are solved for the theoretical
# moments and L-moments of each distribution as integrals over its quantile function (integrate),
# not for their closed forms, and the unknowns are found by uniroot. Sample moments are taken from
# their definitions.
#
#     Rscript fits.R > fits.csv
#
# Columns: series, combination, xi, alpha, kappa (NA where there is none), and the quantile at the
# exceedance probability 0.01.

read_series <- function(name) scan(file.path("series", paste0(name, ".txt")), comment.char = "#",
                                   quiet = TRUE)

standard <- function(y, k) if (abs(k) < 1e-12) y else -expm1(-k * y) / k

# Reduced variates by the lower tail (F) and by the upper tail (e = 1 - F).
gev <- list(lower = function(f) -log(-log(f)), upper = function(e) -log(-log1p(-e)))
pareto <- list(lower = function(f) -log1p(-f), upper = function(e) -log(e))

# The mean of weight(F, x(F)): both halves of [0, 1] with the tail probability exp(-t)/2, which
# turns the algebraic ends of heavy tails into exponential ones.
integral <- function(family, k, weight) {
  half <- function(t) {
    p <- exp(-t) / 2
    p * (weight(p, standard(family$lower(p), k)) + weight(1 - p, standard(family$upper(p), k)))
  }
  cuts <- c(0, 2, 6, 16, 40, 100, 250)
  sum(sapply(seq_len(length(cuts) - 1), function(i) {
    integrate(half, cuts[i], cuts[i + 1], rel.tol = 1e-12, subdivisions = 2000L,
              stop.on.error = FALSE)$value
  }))
}

# Mean, standard deviation and skewness of the standard distribution (xi 0, alpha 1).
moments <- function(family, k) {
  m <- integral(family, k, function(f, x) x)
  v <- integral(family, k, function(f, x) (x - m)^2)
  c(m, sqrt(v), integral(family, k, function(f, x) (x - m)^3) / v^1.5)
}

# First two L-moments and L-skewness of the standard distribution.
l_moments <- function(family, k) {
  l2 <- integral(family, k, function(f, x) x * (2 * f - 1))
  c(integral(family, k, function(f, x) x), l2,
    integral(family, k, function(f, x) x * (6 * f^2 - 6 * f + 1)) / l2)
}

sample_moments <- function(x) {
  n <- length(x)
  c(mean(x), sd(x), n * sum((x - mean(x))^3) / ((n - 1) * (n - 2) * sd(x)^3))
}

# Straight from the definition: l_r as a mean over all subsamples, by sums over ranks (choose).
sample_l_moments <- function(x) {
  x <- sort(x)
  n <- length(x)
  i <- seq_len(n)
  l2 <- sum((choose(i - 1, 1) - choose(n - i, 1)) * x) / 2 / choose(n, 2)
  l3 <- sum((choose(i - 1, 2) - 2 * choose(i - 1, 1) * choose(n - i, 1) + choose(n - i, 2)) * x) /
    3 / choose(n, 3)
  c(mean(x), l2, l3 / l2)
}

fit3 <- function(target, theory, family, range) {
  k <- uniroot(function(k) theory(family, k)[3] - target[3], range, tol = 1e-13)$root
  t <- theory(family, k)
  alpha <- target[2] / t[2]
  c(target[1] - alpha * t[1], alpha, k)
}

# Location xi known: shape from the ratio of the second measure to the mean.
fit2 <- function(target, theory, family, range, xi) {
  ratio <- target[2] / (target[1] - xi)
  off <- function(k) {
    t <- theory(family, k)
    t[2] / t[1] - ratio
  }
  k <- uniroot(off, range, tol = 1e-13)$root
  c(xi, (target[1] - xi) / theory(family, k)[1], k)
}

fit_scale <- function(target, theory, family) {
  t <- theory(family, 0)
  alpha <- target[2] / t[2]
  c(target[1] - alpha * t[1], alpha, NA)
}

row <- function(series, combination, p, family) {
  k <- if (is.na(p[3])) 0 else p[3]
  q <- p[1] + p[2] * standard(family$upper(0.01), k)
  cells <- trimws(formatC(c(p, q), digits = 12, format = "e"))
  cat(paste(c(series, combination, cells), collapse = ","), "\n", sep = "")
}

cat("series,combination,xi,alpha,kappa,x_at_0.01\n")
for (series in c("portpirie", "floyd", "fishkill", "nile60")) {
  x <- read_series(series)
  m <- sample_moments(x)
  l <- sample_l_moments(x)
  row(series, "GEV/MOM", fit3(m, moments, gev, c(-0.3, 3)), gev)
  row(series, "GUM/MOM", fit_scale(m, moments, gev), gev)
  row(series, "GEV/LMOM", fit3(l, l_moments, gev, c(-0.8, 3)), gev)
  row(series, "GUM/LMOM", fit_scale(l, l_moments, gev), gev)
  # A three-parameter Pareto lies above too many of floyd's small values by moments.
  if (series != "floyd") row(series, "GP/MOM", fit3(m, moments, pareto, c(-0.3, 8)), pareto)
  row(series, "GP/LMOM", fit3(l, l_moments, pareto, c(-0.8, 8)), pareto)
}
for (series in list(c("rain40", 40), c("rain30", 30))) {
  name <- series[1]
  x <- read_series(name)
  xi <- as.numeric(series[2])
  m <- sample_moments(x)
  l <- sample_l_moments(x)
  row(name, "GP2/MOM", fit2(m, moments, pareto, c(-0.4, 2), xi), pareto)
  row(name, "GP2/LMOM", fit2(l, l_moments, pareto, c(-0.8, 2), xi), pareto)
  row(name, "GP3/MOM", fit3(m, moments, pareto, c(-0.3, 2)), pareto)
  row(name, "GP3/LMOM", fit3(l, l_moments, pareto, c(-0.8, 2)), pareto)
  # The likelihood of the exponential, maximised numerically: good to half the digits.
  ml <- optimise(function(a) sum(dexp(x - xi, 1 / a, log = TRUE)), c(1, 100), maximum = TRUE,
                 tol = 1e-12)$maximum
  row(name, "EXP1/ML", c(xi, ml, NA), pareto)
  row(name, "EXP2/MOM", fit_scale(m, moments, pareto), pareto)
  row(name, "EXP2/LMOM", fit_scale(l, l_moments, pareto), pareto)
}
