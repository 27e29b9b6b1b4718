# Fits by R packages: peers with a likelihood and an optimiser of their own. Each is run again from
# where it stopped until it gains nothing, since one run of its optimiser stops at half the digits.
suppressMessages({
  library(evd)
  library(fitdistrplus)
})

peer_version <- function(package) paste(package, packageDescription(package)$Version)

tight <- list(reltol = 1e-15, maxit = 5000)

# Restarts `run` (start values in, list of estimates and log-likelihood out) from its own result.
settled <- function(run, start) {
  best <- run(start)
  for (i in 1:5) {
    again <- run(best$par)
    gain <- again$value - best$value
    if (gain > 0) best <- again
    if (gain < 1e-12) break
  }
  best
}

evd_gev <- function(x, fixed_shape) {
  scale <- sd(x)
  y <- x / scale
  run <- function(start) {
    arguments <- list(y, start = as.list(start), std.err = FALSE, method = "Nelder-Mead",
                      control = tight)
    if (fixed_shape) arguments$shape <- 0
    fit <- suppressWarnings(do.call(fgev, arguments))
    list(par = fit$estimate, value = -fit$deviance / 2)
  }
  start <- c(loc = mean(y) - 0.45, scale = 0.78)
  if (!fixed_shape) start <- c(start, shape = 0.05)
  fit <- settled(run, start)
  shape <- if (fixed_shape) 0 else -fit$par[["shape"]]
  c(fit$par[["loc"]] * scale, fit$par[["scale"]] * scale, shape)
}

evd_pareto <- function(x, threshold) {
  scale <- mean(x - threshold)
  y <- (x - threshold) / scale
  run <- function(start) {
    fit <- suppressWarnings(fpot(y, 0, start = as.list(start), std.err = FALSE,
                                 method = "Nelder-Mead", control = tight))
    list(par = fit$estimate, value = -fit$deviance / 2)
  }
  fit <- settled(run, c(scale = 1, shape = 0.05))
  c(threshold, fit$par[["scale"]] * scale, -fit$par[["shape"]])
}

# Parameters of fitdist's own naming, of y divided by its mean.
fitdist_of <- function(y, distribution, start) {
  run <- function(start) {
    fit <- suppressWarnings(fitdist(y / mean(y), distribution, start = as.list(start),
                                    optim.method = "Nelder-Mead", control = tight))
    list(par = fit$estimate, value = fit$loglik)
  }
  settled(run, start)$par
}

peer_fit <- list(
  "GEV/ML" = function(x, xi) list("evd", "fgev", evd_gev(x, FALSE)),
  "GUM/ML" = function(x, xi) list("evd", "fgev", evd_gev(x, TRUE)),
  "GP2/ML" = function(x, xi) list("evd", "fpot", evd_pareto(x, xi)),
  "WEI2/ML" = function(x, xi) {
    y <- x[x > xi] - xi
    p <- fitdist_of(y, "weibull", c(shape = 1, scale = 1))
    list("fitdistrplus", "fitdist", c(xi, p[["scale"]] * mean(y), p[["shape"]]))
  },
  "GAM/ML" = function(x, xi) {
    y <- x[x > xi] - xi
    p <- fitdist_of(y, "gamma", c(shape = 1, rate = 1))
    list("fitdistrplus", "fitdist", c(xi, mean(y) / p[["rate"]], p[["shape"]]))
  },
  "LN2/ML" = function(x, xi) {
    y <- x[x > xi] - xi
    p <- fitdist_of(y, "lnorm", c(meanlog = -0.5, sdlog = 1))
    list("fitdistrplus", "fitdist", c(xi, p[["meanlog"]] + log(mean(y)), p[["sdlog"]]))
  })
