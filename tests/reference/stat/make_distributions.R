#!/usr/bin/Rscript
# Writes distributions.csv beside this script: distribution, its degrees of freedom (0 where there are fewer than two),
# quantile, lower-tail probability, from R's own distribution functions. Made with R 4.2.2.

set.seed(1)
script <- sub("--file=", "", grep("--file=", commandArgs(), value = TRUE))

freedoms <- c(1, 2, 3, 5, 8, 13, 30, 61, 100, 250, 1000)
probabilities <- c(1e-6, 1e-3, 0.01, 0.05, 0.1, 0.25, 0.4, 0.5, 0.6, 0.75, 0.9, 0.95, 0.99, 0.999, 1 - 1e-6)

lines <- character()
add <- function(name, n, m, x, p) {
    lines <<- c(lines, sprintf("%s,%d,%d,%.17g,%.17g", name, as.integer(n), as.integer(m), x, p))
}
for (p in probabilities) {
    x <- qnorm(p)
    add("normal", 0, 0, x, pnorm(x))
    for (n in freedoms) {
        x <- qt(p, n)
        add("t", n, 0, x, pt(x, n))
        x <- qchisq(p, n)
        add("chi-square", n, 0, x, pchisq(x, n))
        m <- sample(freedoms, 1)
        x <- qf(p, n, m)
        add("f", n, m, x, pf(x, n, m))
    }
    for (n in c(5000, 20000)) {
        x <- qchisq(p, n)
        add("chi-square", n, 0, x, pchisq(x, n))
    }
    for (n in c(10000, 1000000)) {
        x <- qt(p, n)
        add("t", n, 0, x, pt(x, n))
    }
}
writeLines(unique(lines), file.path(dirname(script), "distributions.csv"))
