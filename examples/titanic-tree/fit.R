#!/usr/bin/env Rscript
# Fits a classification tree with rpart to the passengers of the Titanic (the package carData, Debian: r-cran-cardata).
# The age of every fifth is not known; of sex and class we forget every tenth, so that splits have to do without.
source("../fit/rpart.R")
library(rpart)

set.seed(1912)
people <- carData::TitanicSurvival[, c("sex", "age", "passengerClass", "survived")]
for (name in c("sex", "passengerClass")) people[[name]][sample(nrow(people), nrow(people) %/% 10)] <- NA

# Surrogates are kept by their share of right guesses: counted by number, age would rarely be one, since it is so often
# missing itself.
fitted <- rpart(survived ~ ., data = people,
  control = rpart.control(cp = 0.001, minsplit = 5, surrogatestyle = 1))
write_rpart("model.xml", "who survived the Titanic, by sex, age and class", fitted, people, "survived")
write_table("data.csv", as.list(people))
write_tree_answers("expected.csv", predict(fitted, people, type = "class"), predict(fitted, people, type = "prob"))
