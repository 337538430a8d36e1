#!/usr/bin/env Rscript
# Fits a logistic regression with three categorical inputs to the Titanic's passenger list (R's own data set).
source("../fit/pmml.R")

counts <- as.data.frame(Titanic)
people <- counts[rep(seq_len(nrow(counts)), counts$Freq), c("Class", "Sex", "Age", "Survived")]
fitted <- glm(Survived ~ Class + Sex + Age, data = people, family = binomial, control = list(epsilon = 1e-14, maxit = 100))

weights <- coef(fitted)
terms <- unlist(lapply(c("Class", "Sex", "Age"), function(name) lapply(levels(people[[name]])[-1], function(level)
  level_term(name, level, weights[[paste0(name, level)]]))))
write_model("model.xml", "who survived the Titanic",
  c(unlist(lapply(names(people), function(name) categorical_field(name, levels(people[[name]]))))), 4,
  c("Class", "Sex", "Age"), "Survived", "logit",
  c(table_lines(weights[["(Intercept)"]], terms, "Yes"), table_lines(0, NULL, "No")), "classification")

# Probabilities depend on the three inputs alone, so one row of each combination that occurs shows them all.
cases <- unique(people[, c("Class", "Sex", "Age")])
yes <- predict(fitted, cases, type = "response")
no <- predict(fitted, cases, type = "link")
no <- plogis(no, lower.tail = FALSE)
write_table("data.csv", as.list(cases))
write_table("expected.csv", list(prediction = ifelse(yes >= no, "Yes", "No"), probability = pmax(yes, no),
  probability_No = no, probability_Yes = yes))
