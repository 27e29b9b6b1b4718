# The distributions from their definitions. Each standard form (location 0, scale 1) is a record of
#   lower(p, k)  its quantile at the probability p
#   upper(e, k)  its quantile at the exceedance probability e
# and each density is written out as ln f, minus infinity outside the support.

standard <- function(y, k) if (abs(k) < 1e-12) y else -expm1(-k * y) / k

gev <- list(lower = function(p, k) standard(-log(-log(p)), k),
            upper = function(e, k) standard(-log(-log1p(-e)), k))
pareto <- list(lower = function(p, k) standard(-log1p(-p), k),
               upper = function(e, k) standard(-log(e), k))
# In h = 1/kappa.
weibull <- list(lower = function(p, h) (-log1p(-p))^h, upper = function(e, h) (-log(e))^h)
frechet <- list(lower = function(p, h) (-log(p))^-h, upper = function(e, h) (-log1p(-e))^-h)
gamma1 <- list(lower = function(p, k) qgamma(p, k),
               upper = function(e, k) qgamma(e, k, lower.tail = FALSE))
# The gamma distribution turned left for right.
mirrored <- list(lower = function(p, k) -gamma1$upper(p, k),
                 upper = function(e, k) -gamma1$lower(e, k))
lognormal <- list(lower = function(p, s) exp(s * qnorm(p)),
                  upper = function(e, s) exp(s * qnorm(e, lower.tail = FALSE)))

inside <- function(ok, value) {
  value[!ok] <- -Inf
  value
}

log_density <- list(
  GEV = function(x, p) {
    z <- (x - p[1]) / p[2]
    q <- 1 - p[3] * z
    y <- if (p[3] == 0) z else -log1p(pmax(-p[3] * z, 1e-300 - 1)) / p[3]
    inside(p[2] > 0 & q > 0, -log(p[2]) - (1 - p[3]) * y - exp(-y))
  },
  GP = function(x, p) {
    z <- (x - p[1]) / p[2]
    q <- 1 - p[3] * z
    y <- if (p[3] == 0) z else -log1p(pmax(-p[3] * z, 1e-300 - 1)) / p[3]
    inside(p[2] > 0 & q > 0 & z >= 0, -log(p[2]) - (1 - p[3]) * y)
  },
  WEI = function(x, p) {
    z <- (x - p[1]) / p[2]
    v <- pmax(z, 0)
    inside(p[2] > 0 & p[3] > 0 & z >= 0, log(p[3] / p[2]) + (p[3] - 1) * log(v) - v^p[3])
  },
  FRE = function(x, p) {
    w <- x / p[1]
    v <- pmax(w, 1e-300)
    inside(p[1] > 0 & w > 0, log(p[2] / p[1]) - (p[2] + 1) * log(v) - v^-p[2])
  },
  P3 = function(x, p) {
    z <- (x - p[1]) / p[2]
    inside(p[3] > 0 & z >= 0, (p[3] - 1) * log(pmax(z, 0)) - z - lgamma(p[3]) - log(abs(p[2])))
  },
  LP3 = function(x, p) log_density$P3(log(x), p) - log(x),
  LN = function(x, p) {
    y <- pmax(x - p[1], 1e-300)
    w <- (log(y) - p[2]) / p[3]
    inside(p[3] > 0 & x > p[1], -log(y) - log(p[3]) - log(2 * pi) / 2 - w^2 / 2)
  },
  SQE = function(x, p) {
    r <- sqrt(p[2] * x)
    inside(p[1] > 0 & p[2] > 0 & x >= 0, log(p[1] * p[2] / 2) - r - p[1] * (1 + r) * exp(-r))
  },
  TGUM = function(x, p, threshold) {
    z <- (x - p[1]) / p[2]
    inside(p[2] > 0, -log(p[2]) - z - exp(-z) - log(-expm1(-exp(-(threshold - p[1]) / p[2]))))
  })

# Value at the exceedance probability e of a fit with all its parameters.
event <- list(
  GEV = function(e, p) p[1] + p[2] * gev$upper(e, p[3]),
  GP = function(e, p) p[1] + p[2] * pareto$upper(e, p[3]),
  WEI = function(e, p) p[1] + p[2] * weibull$upper(e, 1 / p[3]),
  FRE = function(e, p) p[1] * frechet$upper(e, 1 / p[2]),
  P3 = function(e, p) p[1] + abs(p[2]) * (if (p[2] > 0) gamma1 else mirrored)$upper(e, p[3]),
  LP3 = function(e, p) exp(event$P3(e, p)),
  LN = function(e, p) p[1] + exp(p[2]) * lognormal$upper(e, p[3]),
  # By the distribution function itself, since there is no closed form of its inverse.
  SQE = function(e, p) {
    missing <- function(t) log(p[1]) + log1p(t) - t - log(-log1p(-e))
    uniroot(missing, c(0, 1e4), tol = 1e-13)$root^2 / p[2]
  },
  TGUM = function(e, p, threshold) {
    kept <- -expm1(-exp(-(threshold - p[1]) / p[2]))
    p[1] + p[2] * gev$upper(e * kept, 0)
  })
