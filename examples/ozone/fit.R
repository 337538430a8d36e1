#!/usr/bin/env Rscript
# Fits a linear regression to the air of New York in 1973 (R's own data set). The document tells how far the true ozone is
# from the predicted one, and predicts the mean of the days whose sunshine is not known.
source("../fit/pmml.R")

inputs <- c("Solar.R", "Wind", "Temp")
days <- airquality[, c(inputs, "Ozone")]
fitted <- lm(Ozone ~ Solar.R + Wind + Temp, data = days)
weights <- coef(fitted)
mean_ozone <- mean(days$Ozone, na.rm = TRUE)

write_model("model.xml", "ozone in the air", vapply(names(days), continuous_field, ""), 4, inputs, "Ozone", "none",
  table_lines(weights[["(Intercept)"]], vapply(inputs, function(name) numeric_term(name, weights[[name]]), "")),
  "regression", behind_schema = c(
    output_lines(output_field("predicted", "predictedValue"), output_field("residual", "residual"),
      output_field("warning", "warning", dataType = "integer")),
    targets_lines("Ozone", default_value(mean_ozone))))
write_table("data.csv", as.list(days))

predicted <- unname(predict(fitted, days))
unknown <- is.na(predicted)
residual <- days$Ozone - predicted
stopifnot(abs(residual[as.integer(names(residuals(fitted)))] - residuals(fitted)) < 1e-11)
predicted[unknown] <- mean_ozone
write_table("outputs.csv", list(predicted = predicted, residual = days$Ozone - predicted,
  warning = ifelse(unknown, 90027, NA)))
