# The numbers of the bundled example's two text pages, from the formulas alone (base R).
# usage: Rscript pages.R wind.csv peaks.csv; peaks.csv is a table of the peaks above 30 knots, the
# values in its second column. The pages in tests/acceptance/two-text-pages were written from it.
arguments <- commandArgs(TRUE)

as_stored <- function(x) readBin(writeBin(x, raw(), size = 4), "numeric", n = length(x), size = 4)

weighted_moments <- function(x) {
    s <- sort(x); n <- length(s); i <- seq_len(n)
    c(mean(s), mean((i - 1) / (n - 1) * s), mean((i - 1) * (i - 2) / ((n - 1) * (n - 2)) * s),
      mean((i - 1) * (i - 2) * (i - 3) / ((n - 1) * (n - 2) * (n - 3)) * s))
}

l_moments <- function(b)
    c(b[1], 2 * b[2] - b[1], 6 * b[3] - 6 * b[2] + b[1],
      20 * b[4] - 30 * b[3] + 12 * b[2] - b[1])

test_line <- function(name, z) cat(sprintf("%s: z %.2f, %.2f%%\n", name, z, 200 * pnorm(-abs(z))))

run_test <- function(x) {
    y <- x[x != median(x)]; above <- y > median(x)
    n1 <- sum(above); n2 <- sum(!above); n <- n1 + n2
    runs <- 1 + sum(above[-1] != above[-n])
    v <- 2 * n1 * n2 * (2 * n1 * n2 - n) / (n^2 * (n - 1))
    test_line("run test", (runs - 1 - 2 * n1 * n2 / n) / sqrt(v))
}

trend_test <- function(x) {
    n <- length(x); s <- 0
    for (p in seq_len(n - 1)) s <- s + sum(sign(x[(p + 1):n] - x[p]))
    ties <- table(x)
    v <- (n * (n - 1) * (2 * n + 5) - sum(ties * (ties - 1) * (2 * ties + 5))) / 18
    test_line("trend", (s - sign(s)) / sqrt(v))
}

statistics <- function(x) {
    n <- length(x); d <- x - mean(x); m2 <- mean(d^2)
    skewness <- mean(d^3) / m2^1.5 * sqrt(n * (n - 1)) / (n - 2)
    kurtosis <- (n - 1) / ((n - 2) * (n - 3)) * ((n + 1) * (mean(d^4) / m2^2 - 3) + 6) + 3
    cat(sprintf("n %d, mean %.3f, variance %.3f, skewness %.3f, kurtosis %.3f\n", n, mean(x),
                var(x), skewness, kurtosis))
    b <- weighted_moments(x); l <- l_moments(b)
    cat(sprintf("beta %.3f %.3f %.3f %.3f\n", b[1], b[2], b[3], b[4]))
    cat(sprintf("L %.3f %.3f %.3f %.3f\n", l[1], l[2], l[3] / l[2], l[4] / l[2]))
    run_test(x); trend_test(x)
}

wind <- read.csv(arguments[1])
maxima <- as_stored(as.numeric(tapply(wind$MAL, wind$year, max)))
statistics(maxima)
l <- l_moments(weighted_moments(maxima))
kappa <- uniroot(function(k) 2 * (1 - 3^-k) / (1 - 2^-k) - 3 - l[3] / l[2], c(-0.9, 2.1),
                 tol = 1e-14)$root
alpha <- l[2] * kappa / ((1 - 2^-kappa) * gamma(1 + kappa))
cat(sprintf("GEV/LMOM xi %.3f, alpha %.3f, kappa %.3f\n",
            l[1] - alpha * (1 - gamma(1 + kappa)) / kappa, alpha, kappa))
alpha <- sd(maxima) * sqrt(6) / pi
cat(sprintf("GUM/MOM xi %.3f, alpha %.3f\n", mean(maxima) + digamma(1) * alpha, alpha))

peaks <- as_stored(read.csv(arguments[2])[[2]])
statistics(peaks)
l <- l_moments(weighted_moments(peaks - 30))
kappa <- l[1] / l[2] - 2
cat(sprintf("GP2/LMOM alpha %.3f, kappa %.3f\nEXP1/MOM alpha %.3f\nrate %.3f\n",
            l[1] * (1 + kappa), kappa, mean(peaks - 30), length(peaks) / 18))
