#!/usr/bin/env Rscript
# Fits a logistic regression to the student survey of the package MASS (Debian: r-cran-mass), in which answers are
# missing: a missing number is replaced by the mean of the others, a missing category by the most frequent one.
source("../fit/pmml.R")
library(MASS)

numbers <- c("Wr.Hnd", "Pulse", "Height")
categories <- c("W.Hnd", "Exer", "Smoke")
inputs <- c(numbers, categories)
answers <- survey[!is.na(survey$Sex), c(inputs, "Sex")]

means <- lapply(answers[numbers], mean, na.rm = TRUE)
modes <- lapply(answers[categories], function(column) names(which.max(table(column))))
replacements <- c(means, modes)
filled <- answers
for (name in inputs) filled[[name]][is.na(filled[[name]])] <- replacements[[name]]

fitted <- glm(Sex ~ ., data = filled, family = binomial, control = list(epsilon = 1e-14, maxit = 100))
weights <- coef(fitted)
terms <- c(lapply(numbers, function(name) numeric_term(name, weights[[name]])),
  unlist(lapply(categories, function(name) lapply(levels(answers[[name]])[-1], function(level)
    level_term(name, level, weights[[paste0(name, level)]])))))
sexes <- levels(answers$Sex)  # glm's equation is for the second; the first is the reference with a table of its own
write_model("model.xml", "sex of a student by hand, pulse and height",
  c(vapply(numbers, continuous_field, ""),
    unlist(lapply(c(categories, "Sex"), function(name) categorical_field(name, levels(answers[[name]]))))), 7,
  inputs, "Sex", "logit",
  c(table_lines(weights[["(Intercept)"]], unlist(terms), sexes[2]), table_lines(0, NULL, sexes[1])),
  "classification", replacements)

score <- predict(fitted, filled, type = "link")
male <- plogis(score)
female <- plogis(score, lower.tail = FALSE)
write_table("data.csv", as.list(answers))
write_table("expected.csv", list(prediction = ifelse(male >= female, sexes[2], sexes[1]), probability = pmax(male, female),
  probability_Female = female, probability_Male = male))
