# Prints the processor time, in seconds, of one GEV fit by maximum likelihood with evd::fgev: with
# its standard errors (the default), and without. Last line: kappa of the fit.
#
# usage: Rscript evd_speed.R SERIES COUNT
suppressPackageStartupMessages(library(evd))
arguments <- commandArgs(trailingOnly = TRUE)
values <- head(scan(arguments[1], comment.char = "#", quiet = TRUE), as.integer(arguments[2]))

repetitions <- 7
fits <- 200 # a repetition: far longer than the step of the clock

seconds_a_fit <- function(std.err) {
    times <- replicate(repetitions, {
        used <- system.time(for (i in seq_len(fits)) fgev(values, std.err = std.err))
        used[["user.self"]] + used[["sys.self"]]
    })
    median(times) / fits
}

cat("with_standard_errors", seconds_a_fit(TRUE), "\n")
cat("without_standard_errors", seconds_a_fit(FALSE), "\n")
# Its shape has the other sign.
cat("kappa", -fgev(values)$estimate[["shape"]], "\n")
