#!/usr/bin/env Rscript
# Fits a Poisson regression of yarn breaks on wool and tension (R's own data set): counts through the exponential.
source("../fit/pmml.R")

fitted <- glm(breaks ~ wool + tension, data = warpbreaks, family = poisson, control = list(epsilon = 1e-14, maxit = 100))
weights <- coef(fitted)
terms <- unlist(lapply(c("wool", "tension"), function(name) lapply(levels(warpbreaks[[name]])[-1], function(level)
  level_term(name, level, weights[[paste0(name, level)]]))))
write_model("model.xml", "breaks in yarn during weaving",
  c(continuous_field("breaks"), categorical_field("wool", levels(warpbreaks$wool)),
    categorical_field("tension", levels(warpbreaks$tension), "ordinal")), 3,
  c("wool", "tension"), "breaks", "exp", table_lines(weights[["(Intercept)"]], terms), "regression")

write_table("data.csv", as.list(warpbreaks))
write_table("expected.csv", list(prediction = predict(fitted, warpbreaks, type = "response")))
