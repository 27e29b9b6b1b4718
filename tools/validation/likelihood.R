# Maximum likelihood by general optimisers on the written-out log density, in all parameters at
# once. The parameters come in units of their own, so that one tolerance suits them all.

maximise <- function(ll, start, unit) {
  shares <- start / unit
  off <- function(s) {
    value <- suppressWarnings(-ll(s * unit))
    if (is.finite(value)) value else 1e10
  }
  for (i in 1:4)
    shares <- optim(shares, off, control = list(reltol = 1e-15, maxit = 5000))$par
  polished(off, shares) * unit
}

# One parameter, by golden sections and then the same polish.
maximise_in_one <- function(ll, start) {
  found <- optimise(ll, start + c(-1, 1), maximum = TRUE, tol = 1e-10)$maximum
  polished(function(v) -ll(v), found)
}

# Newton's method on differences of fourth order: an optimiser that sees values alone stops half
# way down in digits.
polished <- function(off, s) {
  n <- length(s)
  for (round in 1:6) {
    h <- 1e-3
    unit_step <- function(i) replace(numeric(n), i, h)
    gradient <- sapply(seq_len(n), function(i) {
      d <- unit_step(i)
      (8 * (off(s + d) - off(s - d)) - off(s + 2 * d) + off(s - 2 * d)) / (12 * h)
    })
    hessian <- matrix(0, n, n)
    for (i in seq_len(n)) for (j in seq_len(n)) {
      a <- unit_step(i)
      b <- unit_step(j)
      hessian[i, j] <- (off(s + a + b) - off(s + a - b) - off(s - a + b) + off(s - a - b)) /
        (4 * h^2)
    }
    step <- solve(hessian, gradient)
    if (!all(is.finite(step)) || max(abs(step)) > 0.1) break
    s <- s - step
  }
  s
}

gumbel_start <- function(x) c(mean(x) - 0.45 * sd(x), 0.78 * sd(x))

fit_gev <- function(x) {
  g <- gumbel_start(x)
  maximise(function(p) sum(log_density$GEV(x, p)), c(g, 0.05), c(g[2], g[2], 1))
}

fit_gumbel <- function(x) {
  g <- gumbel_start(x)
  c(maximise(function(p) sum(log_density$GEV(x, c(p, 0))), g, rep(g[2], 2)), 0)
}

fit_above_by_likelihood <- function(density, x, xi, shape, largest = Inf) {
  m <- mean(x - xi)
  ll <- function(p) if (p[2] < largest) sum(density(x, c(xi, p))) else -Inf
  c(xi, maximise(ll, c(m, shape), c(m, 1)))
}

# The highest local maximum over a fine walk of the lower bound: towards the smallest value the
# likelihood has no limit.
fit_lognormal3 <- function(x) {
  scores <- function(v) {
    y <- log(x - (min(x) - sd(x) * exp(v)))
    variance <- mean((y - mean(y))^2)
    c(-log(variance) / 2 - mean(y), mean(y), sqrt(variance))
  }
  v <- seq(log(1e-4), log(1e3), length.out = 2000)
  profile <- sapply(v, function(v) scores(v)[1])
  inner <- 2:(length(v) - 1)
  peaks <- inner[profile[inner] > profile[inner - 1] & profile[inner] > profile[inner + 1]]
  if (length(peaks) == 0) stop("no maximum inside")
  best <- peaks[which.max(profile[peaks])]
  v <- optimise(function(v) scores(v)[1], v[best + c(-1, 1)], maximum = TRUE, tol = 1e-10)$maximum
  start <- c(min(x) - sd(x) * exp(v), scores(v)[2:3])
  # With the lower bound in units of its distance to the data.
  unit <- c(min(x) - start[1], start[3], start[3])
  off <- function(s) {
    value <- -sum(log_density$LN(x, s * unit))
    if (is.finite(value)) value else 1e10
  }
  polished(off, start / unit) * unit
}

# By the profile over b for a start, then both.
fit_square_root <- function(x) {
  a_of <- function(b) {
    r <- sqrt(b * x)
    1 / mean((1 + r) * exp(-r))
  }
  ll <- function(p) sum(log_density$SQE(x, p))
  grid <- exp(seq(log(1e-3), log(1e5), length.out = 400)) / mean(x)
  best <- which.max(sapply(grid, function(b) ll(c(a_of(b), b))))
  b <- optimise(function(b) ll(c(a_of(b), b)), grid[best + c(-1, 1)], maximum = TRUE,
                tol = 1e-12)$maximum
  maximise_log(ll, c(a_of(b), b))
}

# In logarithms, for parameters of any size; in small units, since for a narrow sample a is so large
# that b must be right to many digits.
maximise_log <- function(ll, start) {
  exp(maximise(function(v) ll(exp(v)), log(start), rep(0.02, length(start))))
}

# NULL where the likelihood rises towards the exponential distribution for ever.
fit_truncated_gumbel <- function(x, threshold) {
  y <- x - threshold
  m <- mean(y)
  if (mean(exp(-y / m)) >= 0.5) return(NULL)
  ll <- function(p) sum(log_density$TGUM(x, p, threshold))
  maximise(ll, c(threshold, m), c(m, m))
}
