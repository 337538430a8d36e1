#!/usr/bin/env Rscript
# Fits a classification tree with rpart to the student survey of the package MASS (Debian: r-cran-mass), in which
# answers are missing. Most splits have surrogates, up to five.
source("../fit/rpart.R")
library(rpart)

answers <- MASS::survey[!is.na(MASS::survey$Sex), c(setdiff(names(MASS::survey), "Sex"), "Sex")]
fitted <- rpart(Sex ~ ., data = answers, control = rpart.control(cp = 0.001, minsplit = 5))
write_rpart("model.xml", "sex of a student by hands, height and habits", fitted, answers, "Sex")
write_table("data.csv", as.list(answers))
write_tree_answers("expected.csv", predict(fitted, answers, type = "class"), predict(fitted, answers, type = "prob"))
