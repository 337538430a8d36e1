#!/usr/bin/env Rscript
# Fits a classification tree with rpart to the passengers of the Titanic (the package carData, Debian: r-cran-cardata).
# The age of every fifth is not known; of sex and class we forget every tenth, so that splits have to do without.
source("../fit/pmml.R")
source("../fit/tree.R")
library(rpart)

set.seed(1912)
people <- carData::TitanicSurvival[, c("sex", "age", "passengerClass", "survived")]
for (name in c("sex", "passengerClass")) people[[name]][sample(nrow(people), nrow(people) %/% 10)] <- NA

# A surrogate counts by its share of right guesses, as one that is itself often missing would hardly be kept else.
fitted <- rpart(survived ~ ., data = people,
  control = rpart.control(cp = 0.001, minsplit = 5, surrogatestyle = 1))
write_tree("model.xml", "who survived the Titanic, by sex, age and class", fitted, people, "survived")
write_table("data.csv", as.list(people))
write_tree_answers("expected.csv", fitted, people)
