# Prints the processor time, in seconds, of 1000 replicates of a GEV fit by L-moments: draw a sample
# from the fitted distribution, take its L-moments, fit, take the 100-year quantile. First line: "lmom"
# where that package is installed and was used, otherwise "plain_R" for the same estimator written in
# R below. Last line: kappa of the fit to the series.
#
# usage: Rscript lmom_speed.R SERIES COUNT
arguments <- commandArgs(trailingOnly = TRUE)
values <- head(scan(arguments[1], comment.char = "#", quiet = TRUE), as.integer(arguments[2]))

repetitions <- 7
replicates <- 1000
period <- 100

# l1, l2 and t3 by weights of the order statistics (Landwehr et al. 1979; Hosking 1990).
n <- length(values)
i <- seq_len(n)
weight1 <- (i - 1) / (n - 1)
weight2 <- weight1 * (i - 2) / (n - 2)

own_l_moments <- function(x) {
    x <- sort(x)
    b0 <- mean(x)
    b1 <- mean(weight1 * x)
    l2 <- 2 * b1 - b0
    c(b0, l2, (6 * mean(weight2 * x) - 6 * b1 + b0) / l2)
}

# Hosking, Wallis and Wood (1985): their approximation, brought to the root by Newton's method.
own_fit <- function(moments) {
    c0 <- 2 / (3 + moments[3]) - log(2) / log(3)
    k <- 7.8590 * c0 + 2.9554 * c0^2
    for (step in 1:20) {
        two <- 2^-k
        three <- 3^-k
        ratio <- (1 - three) / (1 - two)
        slope <- 2 * (log(3) * three - ratio * log(2) * two) / (1 - two)
        change <- (2 * ratio - 3 - moments[3]) / slope
        k <- k - change
        if (abs(change) < 1e-10) break
    }
    g <- gamma(1 + k)
    alpha <- moments[2] * k / (g * (1 - 2^-k))
    c(moments[1] - alpha * (1 - g) / k, alpha, k)
}

own_quantile <- function(f, p) p[1] + p[2] / p[3] * (1 - (-log(f))^p[3])

if (requireNamespace("lmom", quietly = TRUE)) {
    l_moments <- function(x) lmom::samlmu(x, nmom = 3)
    fit <- lmom::pelgev
    quantile_of <- lmom::quagev
    cat("code lmom\n")
} else {
    l_moments <- own_l_moments
    fit <- own_fit
    quantile_of <- own_quantile
    cat("code plain_R\n")
}

fitted <- fit(l_moments(values))
replicate_once <- function() {
    sample <- quantile_of(runif(n), fitted)
    quantile_of(1 - 1 / period, fit(l_moments(sample)))
}

times <- replicate(repetitions, {
    set.seed(12345)
    used <- system.time(for (j in seq_len(replicates)) replicate_once())
    used[["user.self"]] + used[["sys.self"]]
})
cat("replicates", median(times), "\n")
cat("kappa", fitted[3], "\n")
