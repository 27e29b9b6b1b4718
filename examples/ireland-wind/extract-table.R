# Makes wind.csv from the data set `wind` of the R package gstat (Debian package r-cran-gstat):
#   Rscript extract-table.R > wind.csv
load(system.file("data", "wind.rda", package = "gstat"))
write.csv(wind[, c("year", "month", "day", "VAL", "BEL", "MAL")], row.names = FALSE, quote = FALSE)
