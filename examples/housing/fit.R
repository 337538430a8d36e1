#!/usr/bin/env Rscript
# Fits a proportional-odds model (an ordinal target with the cumulative logit) to the Copenhagen housing survey of
# the package MASS (Debian: r-cran-mass).
source("../fit/pmml.R")
library(MASS)

fitted <- polr(Sat ~ Infl + Type + Cont, weights = Freq, data = housing, control = list(reltol = 1e-14, maxit = 1000))
weights <- coef(fitted)
# polr's cumulative equation is zeta - eta, so the coefficients change their sign.
terms <- unlist(lapply(c("Infl", "Type", "Cont"), function(name) lapply(levels(housing[[name]])[-1], function(level)
  level_term(name, level, -weights[[paste0(name, level)]]))))
satisfaction <- levels(housing$Sat)
tables <- c(table_lines(fitted$zeta[[1]], terms, satisfaction[1]), table_lines(fitted$zeta[[2]], terms, satisfaction[2]),
  table_lines(0, NULL, satisfaction[3]))
write_model("model.xml", "satisfaction with housing",
  c(categorical_field("Sat", satisfaction, "ordinal"), categorical_field("Infl", levels(housing$Infl)),
    categorical_field("Type", levels(housing$Type)), categorical_field("Cont", levels(housing$Cont))), 4,
  c("Infl", "Type", "Cont"), "Sat", "logit", tables, "classification")

cases <- unique(housing[, c("Infl", "Type", "Cont")])
chances <- predict(fitted, cases, type = "probs")
best <- apply(chances, 1, which.max)
write_table("data.csv", as.list(cases))
write_table("expected.csv", list(prediction = satisfaction[best], probability = apply(chances, 1, max),
  probability_Low = chances[, 1], probability_Medium = chances[, 2], probability_High = chances[, 3]))
