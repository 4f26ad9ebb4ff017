#!/usr/bin/env Rscript
# Makes anova.csv: balanced designs and what R's aov and pf say of them.
#
# Sums of squares are those of aov. What an effect is tested against is worked out from the expected mean squares of the
# restricted model: the mean square of an effect holds the variance of every interaction that adds only random factors to
# it, and the denominator is the effect whose mean square holds the same but the effect's own. The p value takes the degrees
# of freedom of the denominator, in two-way designs always those of the error.
#
# A line holds: factors, r, signed levels (3), observations, then per effect F and p, and per row sum of squares and degrees
# of freedom.

set.seed(20240611)
arguments <- commandArgs(trailingOnly = FALSE)
folder <- dirname(sub("--file=", "", arguments[grep("--file=", arguments)]))
out <- file(file.path(folder, "anova.csv"), "w")
number <- function(x) sprintf("%.17g", x)

contributes <- function(wider, effect, random) all(effect %in% wider) && all(setdiff(wider, effect) %in% random)

analyse <- function(signed, r) {
  factors <- c("A", "B", "C")[seq_along(signed)]
  levels <- abs(signed)
  random <- factors[signed < 0]
  design <- expand.grid(c(list(replicate = seq_len(r)), lapply(rev(levels), seq_len)))
  names(design)[-1] <- rev(factors)
  n <- nrow(design)
  y <- round(10 + rnorm(n) + design$A * 0.7 + (if ("C" %in% factors) design$C * design$B * 0.3 else design$B * 0.4), 3)
  design[factors] <- lapply(design[factors], factor)
  table <- summary(aov(reformulate(paste(factors, collapse = "*"), "y"), design))[[1]]
  effects <- strsplit(trimws(rownames(table)), ":")
  ss <- table[["Sum Sq"]]
  df <- table[["Df"]]
  error <- length(ss)
  terms <- effects[-error]
  held <- function(effect) c(Filter(function(w) contributes(w, effect, random), terms))
  results <- c()
  for (i in seq_along(terms)) {
    others <- Filter(function(w) !setequal(w, terms[[i]]), held(terms[[i]]))
    key <- function(l) paste(sort(sapply(l, paste, collapse = "")), collapse = ",")
    denominator <- NA
    if (length(others) == 0) denominator <- error
    else for (j in seq_along(terms)) if (key(held(terms[[j]])) == key(others)) denominator <- j
    if (is.na(denominator)) { results <- c(results, "-1", "-1"); next }
    f <- (ss[i] / df[i]) / (ss[denominator] / df[denominator])
    freedom <- if (length(signed) == 2) df[error] else df[denominator]
    results <- c(results, number(f), number(pf(f, df[i], freedom, lower.tail = FALSE)))
  }
  writeLines(paste(c(length(signed), r, signed, rep(0, 3 - length(signed)), number(y), results, number(ss), df),
                   collapse = ","), out)
}

for (levels in list(c(2, 2), c(3, 4), c(5, 2)))
  for (r in c(2, 3, 7))
    for (signs in list(c(1, 1), c(-1, 1), c(1, -1), c(-1, -1))) analyse(levels * signs, r)

one_each <- function(levels) {
  design <- expand.grid(rev(lapply(levels, seq_len)))
  names(design) <- c("B", "A")
  y <- round(5 + rnorm(nrow(design)) + design$A, 3)
  table <- summary(aov(y ~ A + B, transform(design, A = factor(A), B = factor(B))))[[1]]
  f <- table[["F value"]][1:2]
  p <- table[["Pr(>F)"]][1:2]
  writeLines(paste(c(2, 1, levels, 0, number(y), number(f[1]), number(p[1]), number(f[2]), number(p[2]), 0, 0,
                     number(table[["Sum Sq"]][1:2]), 0, number(table[["Sum Sq"]][3]), table[["Df"]][1:2], 0,
                     table[["Df"]][3]), collapse = ","), out)
}
one_each(c(3, 4))
one_each(c(2, 6))

for (levels in list(c(2, 2, 2), c(3, 2, 4)))
  for (r in c(2, 3))
    for (mask in 0:7) analyse(levels * ifelse(bitwAnd(mask, c(4, 2, 1)) > 0, -1, 1), r)
close(out)
