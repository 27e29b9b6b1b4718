# Fits in R, made from the definitions and, where a package has one, by it.
#
#     Rscript fit.R < tasks.csv > fits.csv
#
# Tasks: name,kind,series,file,threshold,exceedance (kind AMS or PDS; threshold empty for AMS).
# Fits: name,kind,series,peer,p1,p2,p3,event,logLikelihood, of the estimated parameters in the order
# of the program's results; a fit that cannot be made gives a row with NA in place of all numbers.

here <- dirname(sub("^--file=", "", grep("^--file=", commandArgs(), value = TRUE)))
for (part in c("distributions", "moments", "likelihood", "combinations", "peers"))
  source(file.path(here, paste0(part, ".R")))

base_r <- paste0("base R ", R.version$major, ".", R.version$minor)

# The written-out family of a name, and which of its parameters the program estimates and lists.
family_of <- function(name) {
  code <- sub("/.*", "", name)
  families <- c(GEV = "GEV", GUM = "GEV", WEI = "WEI", WEI2 = "WEI", WEI3 = "WEI", FRE = "FRE",
                GP = "GP", GP2 = "GP", GP3 = "GP", P3 = "P3", GAM = "P3", LP3 = "LP3", LN2 = "LN",
                LN3 = "LN", SQE = "SQE", EXP1 = "GP", EXP2 = "GP", TGUM = "TGUM")
  listed <- switch(code, GUM = , EXP2 = , FRE = , SQE = , TGUM = 1:2,
                   WEI2 = , GP2 = , GAM = , LN2 = 2:3, EXP1 = 2, 1:3)
  list(family = families[[code]], listed = listed)
}

row_of <- function(task, x, p) {
  f <- family_of(task$name)
  xi <- task$threshold
  if (f$family == "TGUM") {
    q <- event$TGUM(task$exceedance, p, xi)
    ll <- sum(log_density$TGUM(x, p, xi))
  } else {
    q <- event[[f$family]](task$exceedance, p)
    ll <- sum(log_density[[f$family]](x, p))
  }
  c(p[f$listed], rep(NA, 3 - length(f$listed)), q, if (is.finite(ll)) ll else NA)
}

# A truncated Gumbel distribution without a maximum is the exponential one, whose xi has no meaning.
exponential_row <- function(task, x) {
  y <- x - task$threshold
  event <- task$threshold - mean(y) * log(task$exceedance)
  c(NA, mean(y), NA, event, sum(dexp(y, 1 / mean(y), log = TRUE)))
}

emit <- function(task, peer, numbers) {
  cat(paste(c(task$name, task$kind, task$series, peer, format(numbers, digits = 17, trim = TRUE)),
            collapse = ","), "\n", sep = "")
}

fit_task <- function(task) {
  x <- scan(task$file, comment.char = "#", quiet = TRUE)
  xi <- if (is.na(task$threshold)) 0 else task$threshold
  if (is.null(combinations[[task$name]])) stop("no definition of ", task$name)
  p <- tryCatch(combinations[[task$name]](x, xi), error = function(e) NA)
  if (is.null(p)) emit(task, base_r, exponential_row(task, x))
  else if (anyNA(p)) emit(task, base_r, rep(NA, 5))
  else emit(task, base_r, row_of(task, x, p))
  if (task$name %in% names(peer_fit)) {
    fit <- peer_fit[[task$name]](x, xi)
    emit(task, paste0(peer_version(fit[[1]]), " ", fit[[2]]), row_of(task, x, fit[[3]]))
  }
}

tasks <- read.csv(file("stdin"), stringsAsFactors = FALSE)
cat("name,kind,series,peer,p1,p2,p3,event,logLikelihood\n")
for (i in seq_len(nrow(tasks))) fit_task(tasks[i, ])
